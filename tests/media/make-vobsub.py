#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""make-vobsub.py IDX SUB [LANGUAGES]: a VobSub pair of ten pictures for each
language, one every two seconds.

Each picture is a white bar of 30 rows on a screen of 640 x 360. The first
language's is 200 pixels wide, the second one's 100.
"""
import struct
import sys

WIDTHS = {"en": 200, "de": 100}  # by language
HEIGHT = 30
LEFT, TOP = 220, 300
COUNT, INTERVAL = 10, 2  # pictures, seconds
BLOCK = 2048  # a pack of the program stream


def picture(width):
    """One subpicture unit: two fields of run lengths, then the control part."""
    line = bytes([0x00, 0x01])  # colour 1 to the end of the line
    field = line * (HEIGHT // 2)
    first = 4
    second = first + len(field)
    control = second + len(field)
    x2, y2 = LEFT + width - 1, TOP + HEIGHT - 1
    show = bytes([0x03, 0x32, 0x10])  # palette entries of colours 3..0
    show += bytes([0x04, 0xFF, 0xF0])  # all but the background opaque
    show += bytes([0x05, LEFT >> 4, (LEFT & 15) << 4 | x2 >> 8, x2 & 255,
                   TOP >> 4, (TOP & 15) << 4 | y2 >> 8, y2 & 255])
    show += bytes([0x06]) + struct.pack(">HH", first, second)
    show += bytes([0x01, 0xFF])
    hide_at = control + 4 + len(show)
    ticks = 90000 * INTERVAL // 1024 - 4
    body = field + field
    body += struct.pack(">HH", 0, hide_at) + show
    body += struct.pack(">HH", ticks, hide_at) + bytes([0x02, 0xFF])
    size = 4 + len(body)
    return struct.pack(">HH", size, control) + body


def timestamp(prefix, pts):
    return bytes([prefix << 4 | (pts >> 29 & 0x0E) | 1, pts >> 22 & 0xFF,
                  (pts >> 14 & 0xFE) | 1, pts >> 7 & 0xFF, (pts << 1 & 0xFE) | 1])


def pack(pts, substream, unit):
    """The unit in a private stream, in a pack filled up to the block size."""
    scr = bytes([0x44 | (pts >> 27 & 0x38) | (pts >> 28 & 3), pts >> 20 & 0xFF,
                 0x04 | (pts >> 12 & 0xF8) | (pts >> 13 & 3), pts >> 5 & 0xFF,
                 0x04 | (pts << 3 & 0xF8), 0x01, 0x01, 0x89, 0xC3, 0xF8])
    header = b"\x00\x00\x01\xBA" + scr
    payload = bytes([0x81, 0x80, 5]) + timestamp(2, pts) + bytes([0x20 + substream]) + unit
    stream = b"\x00\x00\x01\xBD" + struct.pack(">H", len(payload)) + payload
    rest = BLOCK - len(header) - len(stream) - 6
    return header + stream + b"\x00\x00\x01\xBE" + struct.pack(">H", rest) + b"\xFF" * rest


def index(languages):
    colours = ["000000", "ffffff", "808080", "404040"] + ["000000"] * 12
    lines = ["# VobSub index file, v7 (do not modify this line!)", "size: 640x360",
             "palette: " + ", ".join(colours), "langidx: 0"]
    for substream, language in enumerate(languages):
        lines.append("id: %s, index: %d" % (language, substream))
        for number in range(COUNT):
            lines.append("timestamp: 00:00:%02d:000, filepos: %09x"
                         % (number * INTERVAL, (substream * COUNT + number) * BLOCK))
    return "\n".join(lines) + "\n"


def main():
    languages = list(WIDTHS)[:int(sys.argv[3]) if len(sys.argv) > 3 else 1]
    with open(sys.argv[1], "w", encoding="ascii") as idx:
        idx.write(index(languages))
    with open(sys.argv[2], "wb") as sub:
        for substream, language in enumerate(languages):
            for number in range(COUNT):
                sub.write(pack(90000 * INTERVAL * number, substream, picture(WIDTHS[language])))


if __name__ == "__main__":
    main()
