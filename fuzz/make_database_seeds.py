#!/usr/bin/env python3
"""make_database_seeds.py FOLDER: writes small databases of each version as a start for database_fuzz."""

import struct
import sys
import zlib
from pathlib import Path

VERSIONS = [(2, 0), (1, 2), (1, 1), (1, 0)]


def number(value):
    return struct.pack("<i", value)


def rows(captions, block):
    return number(len(captions)) + b"".join(text.ljust(block, b"\0") + number(1) for text in captions)


FOLDERS = number(1) + b"/music".ljust(260, b"\0")
LISTS = (rows([b"A", b"B"], 512) + rows([b"Album"], 512) + rows([b"In den 80ern"], 128) +
         rows([b"2 bis 3 Minuten"], 128) + number(20) + number(1) * 20)


def song(*texts):
    fixed = struct.pack("<HH", 1984, 125) + bytes(27) + struct.pack("<d", 40000.5)
    return fixed + b"".join(number(len(text)) + text for text in texts)


def body(version):
    if version == (2, 0):
        return FOLDERS + LISTS + song(b"/a.mp3", b"T", b"A", b"Album", b"", b"Wave") + song(*[b"M\xf6\xc3\xb6"] * 6)
    record = b"/none.mp3".ljust(1297 if version == (1, 0) else 1337, b"\0")
    return FOLDERS + (LISTS if version == (1, 2) else b"") + record * 2


folder = Path(sys.argv[1])
folder.mkdir(parents=True, exist_ok=True)
for index, version in enumerate(VERSIONS):
    name = "%d.%d" % version
    header = b"TSDB By RUK" + bytes(version) + number(2)
    (folder / (name + ".tsdb")).write_bytes(header + zlib.compress(body(version), 1))
    (folder / (name + ".body")).write_bytes(b"B" + bytes([index, 2]) + body(version))
