#!/usr/bin/env python3
"""make_journal_seeds.py FOLDER: writes small journals with each kind of frame and step as a start for journal_fuzz,
each as a file and as frames whose sums the target puts right."""

import struct
import sys
import zlib
from pathlib import Path

BEGIN, STEP, OUTCOME, FINISH = 1, 2, 3, 4
PATCH, MOVE, TRASH, UNTRASH, RECORD, BAN = 1, 2, 3, 4, 5, 6
CHANGE, UNDO, REDO = 0, 1, 2


def text(value):
    return struct.pack("<I", len(value)) + value.encode("utf-16-le")


def texts(*values):
    return struct.pack("<I", len(values)) + b"".join(map(text, values))


def state(size=100):
    return struct.pack("<qqQQB", size, 10**18, 1, 2, 0)


def begin(number, kind=CHANGE, of=0):
    return BEGIN, struct.pack("<QBQq", number, kind, of, 10**12) + text("2 Tags") + text("/m.tsdb"), b""


def step(kind, body=b"", item=0, takes=-1, temporary="", folders=()):
    head = struct.pack("<BIi", kind, item, takes)
    if kind <= UNTRASH:
        head += text("/m/a") + text("/m/b") + text(temporary) + texts(*folders) + texts() + state() + state(120)
    return STEP, head, body


def outcome(batch, *results):
    entries = b"".join(struct.pack("<IB", number, result) + state(120) for number, result in results)
    return OUTCOME, struct.pack("<QI", batch, len(results)) + entries, b""


def finish(batch, drops=0, caption=""):
    return FINISH, struct.pack("<QqB", batch, 10**18, drops) + text(caption), b""


def member(name, value):
    return bytes([len(name)]) + name + value


PATCH_BACK = (struct.pack("<IBQ", 3, 1, 4) + b"old!" + struct.pack("<BQQ", 0, 4, 90) + struct.pack("<BQ", 1, 2) +
              b"hi")
OLD = member(b"title", text("T")) + member(b"artist", text("A")) + member(b"fileTime", struct.pack("<d", 4e4))
CHANGED = b"\3" + b"\3" + OLD + b"\2" + member(b"title", text("N")) + member(b"year", text("1984"))
BANNED = text("Artist - Title") + b"\1"

BATCH = [begin(1), step(PATCH, PATCH_BACK, temporary="/m/t"), step(MOVE, folders=("/m/n", "/m/n/o")), step(RECORD, CHANGED),
         step(TRASH, item=1), step(BAN, BANNED, item=1), outcome(1, (0, 1), (1, 1), (2, 1), (3, 2), (4, 4)), finish(1)]
JOURNALS = {
    "begun": BATCH[:4],
    "whole": BATCH,
    "undone": BATCH + [begin(2, UNDO, 1), step(RECORD, CHANGED, takes=2), step(UNTRASH, takes=3),
                       outcome(2, (0, 1), (1, 1)), finish(2, 1, "1 Tag")],
    "redone": BATCH + [begin(2, UNDO, 1), step(PATCH, PATCH_BACK, takes=0), outcome(2, (0, 1)), finish(2),
                       begin(3, REDO, 2), step(PATCH, PATCH_BACK, takes=0), outcome(3, (0, 1)), finish(3)],
}


def as_file(frames):
    file = b"TSJRNL\1\0"
    for kind, head, body in frames:
        header = struct.pack("<B3xIQI", kind, len(head), len(body), zlib.crc32(body))
        file += header + struct.pack("<I", zlib.crc32(header + head)) + head + body
    return file


folder = Path(sys.argv[1])
folder.mkdir(parents=True, exist_ok=True)
for name, frames in JOURNALS.items():
    (folder / (name + ".tsj")).write_bytes(as_file(frames))
    summed = b"".join(bytes([kind, len(head), len(body)]) + head + body for kind, head, body in frames)
    (folder / (name + ".frames")).write_bytes(b"B" + summed)
