#!/usr/bin/env python3
"""make_midi_seeds.py FOLDER: writes small MIDI files as a start for midi_fuzz."""

import struct
import sys
from pathlib import Path

END = b"\0\xff\x2f\0"
NOTE = b"\0\x90\x3c\x64\x83\x60\x3c\0"  # the second event by running status
TEMPO = b"\x60\xff\x51\3\7\xa1\x20"
SYSEX = b"\0\xf0\5\x7e\x7f\x09\1\xf7"


def track(events):
    return b"MTrk" + struct.pack(">I", len(events)) + events


def midi(*tracks, division=480, header=b""):
    head = struct.pack(">IHHH", 6 + len(header), len(tracks) > 1, len(tracks), division) + header
    return b"MThd" + head + b"".join(map(track, tracks))


def rmi(content):
    chunks = b"RMIDLIST\3\0\0\0abc\0data" + struct.pack("<I", len(content)) + content
    return b"RIFF" + struct.pack("<I", len(chunks)) + chunks


def files():
    every_kind = (b"\0\xc0\5\0\xd0\5\0\xb0\7\x64\0\xe0\0\x40\0\xa0\x3c\x20" + NOTE + SYSEX +
                  b"\0\xf7\2\1\2\0\xff\1\4text")
    yield "one_track", midi(TEMPO + NOTE + END)
    yield "two_tracks", midi(TEMPO + TEMPO + END, NOTE * 3 + END)
    yield "every_kind", midi(every_kind + END)
    yield "film_frames", midi(NOTE + END, division=0xE728)
    yield "long_header", midi(NOTE + END, header=b"more")
    yield "no_end", midi(NOTE + b"\xff\xff\xff\x7f\x90\x3c\x64")
    yield "rmi", rmi(midi(NOTE + END))


def main():
    if len(sys.argv) != 2:
        sys.exit(__doc__)
    folder = Path(sys.argv[1])
    folder.mkdir(parents=True, exist_ok=True)
    for name, content in files():
        (folder / name).write_bytes(content)


if __name__ == "__main__":
    main()
