#!/usr/bin/env python3
"""make_seeds.py FOLDER: writes small sound files as a start for audio_fuzz and tag_writing_fuzz
(first byte: options)."""

import struct
import sys
from pathlib import Path

FRAME = bytes([0xFF, 0xFB, 0x90, 0x64])
PADDING = bytes(50)


def frames(count, header=FRAME, size=417):
    return (header + bytes((i % 64) + 1 for i in range(size - 4))) * count


def synch_safe(value):
    return bytes((value >> shift) & 0x7F for shift in (21, 14, 7, 0))


def frame(name, body, version=3):
    if version == 2:
        return name + len(body).to_bytes(3, "big") + body
    size = synch_safe(len(body)) if version == 4 else struct.pack(">I", len(body))
    return name + size + b"\0\0" + body


def id3v2(content, version=3, flags=0):
    return b"ID3" + bytes([version, 0, flags]) + synch_safe(len(content)) + content


def id3v2_tags():
    texts = [(b"TIT2", b"\0Waterloo"), (b"TPE1", b"\1\xff\xfeA\0B\0"), (b"TRCK", b"\0003/12"),
             (b"TCON", b"\0(17)Rock (RX)"), (b"TYER", b"\x001974"), (b"TLEN", b"\000165000"),
             (b"COMM", b"\0deu\0Gut"), (b"TFLT", b"\0MPG/3"), (b"PCNT", b"\0\0\0\7"),
             (b"WXXX", b"\0d\0http://a.example"), (b"PRIV", b"owner\0data"), (b"TMED", b"\0(CD/DD)"),
             (b"APIC", b"\0image/png\0\3\0" + bytes(60)),
             (b"XRUK", bytes(243) + b"Wave\0" + bytes(29))]
    old = [(b"TT2", b"\0Waterloo"), (b"TP1", b"\0ABBA"), (b"TRK", b"\0003"), (b"COM", b"\0deu\0x")]
    yield "v23", id3v2(b"".join(frame(*text) for text in texts) + PADDING)
    yield "v24", id3v2(b"".join(frame(*text, 4) for text in texts) + PADDING, 4)
    yield "v24_unsync", id3v2(frame(b"TIT2", b"\3a") + frame(b"TPE1", b"\3\xff\0\xe0"), 4, 0x80)
    yield "v22", id3v2(b"".join(frame(*text, 2) for text in old), 2)


def id3v1():
    return (b"TAG" + b"Waterloo".ljust(30, b"\0") + b"ABBA".ljust(30, b"\0") + bytes(30) + b"1974" +
            bytes(29) + b"\7\x11")


def ape():
    def edge(flags):
        return b"APETAGEX" + struct.pack("<IIII", 2000, 32, 0, flags) + bytes(8)
    return edge(0xA0000000) + edge(0x80000000)


def vbr(text, offset, numbers, header=FRAME):
    return (header + bytes(offset - 4) + text + struct.pack(">III", *numbers)).ljust(417, b"\0")


def wave(data_size):
    form = struct.pack("<HHIIHH", 1, 2, 44100, 176400, 4, 16)
    return (b"RIFF\0\0\0\0WAVEfmt " + struct.pack("<I", 16) + form + b"LIST\3\0\0\0abc\0data" +
            struct.pack("<I", data_size) + bytes(64))


def guid(text):
    a, b, c, d, e = text.split("-")
    return struct.pack("<IHH", int(a, 16), int(b, 16), int(c, 16)) + bytes.fromhex(d + e)


def asf_object(name, body):
    return guid(name) + struct.pack("<Q", 24 + len(body)) + body


def asf():
    def text(value):
        return (value + "\0").encode("utf-16-le")
    content = [text(value) for value in ("Waterloo", "ABBA", "", "Gut", "")]
    attribute = text("WM/AlbumTitle"), text("Album")
    objects = [
        asf_object("75B22633-668E-11CF-A6D9-00AA0062CE6C",
                   struct.pack("<5H", *map(len, content)) + b"".join(content)),
        asf_object("D2D0A440-E307-11D2-97F0-00A0C95EA850",
                   struct.pack("<HH", 1, len(attribute[0])) + attribute[0] +
                   struct.pack("<HH", 0, len(attribute[1])) + attribute[1]),
        asf_object("8CABDCA1-A947-11CF-8EE4-00C00C205365",
                   bytes(24) + struct.pack("<QQQQQIIII", 0, 0, 300000000, 0, 3000, 2, 0, 0, 128000)),
        asf_object("B7DC0791-A9B7-11CF-8EE6-00C00C205365",
                   guid("F8699E40-5B4D-11CF-A8FD-00805F5C442B") + bytes(16) +
                   struct.pack("<QIIHI", 0, 18, 0, 1, 0) +
                   struct.pack("<HHIIHHH", 353, 2, 44100, 16000, 743, 16, 0)),
    ]
    body = b"".join(objects)
    return asf_object("75B22630-668E-11CF-A6D9-00AA0062CE6C",
                      struct.pack("<I", len(objects)) + b"\1\2" + body)


def trailing(audio, tag):
    return audio + tag + b"ID32" + struct.pack("<I", len(audio))


def files():
    tags = dict(id3v2_tags())
    for name, tag in tags.items():
        yield name, tag + frames(2) + id3v1()
    yield "xing", vbr(b"Xing", 36, (3, 100, 40000)) + frames(1)
    yield "info", vbr(b"Info", 36, (3, 100, 40000)) + frames(1)
    yield "xing_lsf", vbr(b"Xing", 21, (3, 100, 40000), bytes([0xFF, 0xF3, 0x80, 0x04])) + frames(1)
    yield "vbri", vbr(b"VBRI\0\1\0\0\0\0", 36, (40000, 100, 0)) + frames(1)
    yield "wave", wave(64)
    yield "wave_tag", trailing(wave(0xFFFFFFFF), tags["v23"])
    yield "asf", asf()
    yield "asf_tag", trailing(asf(), tags["v24"]) + b""
    yield "stacked", tags["v23"] * 3 + frames(2)
    yield "ape", tags["v24"] + frames(2) + ape() + id3v1()
    yield "mpeg_trailing", trailing(tags["v22"] + frames(2), tags["v24"])


def main():
    if len(sys.argv) != 2:
        sys.exit(__doc__)
    folder = Path(sys.argv[1])
    folder.mkdir(parents=True, exist_ok=True)
    for name, content in files():
        for options in (0, 7, 0x9E):
            (folder / f"{name}_{options}").write_bytes(bytes([options]) + content)


if __name__ == "__main__":
    main()
