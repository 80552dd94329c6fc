# SPDX-License-Identifier: Apache-2.0
"""Copies an MP4 file with another display matrix for its only track.

set-display-matrix.py IN A B C D X Y OUT: a picture's point (p, q) is shown at
(A p + C q + X, B p + D q + Y); ISO/IEC 14496-12, 8.3.2 ("tkhd").
"""

import struct
import sys


def main() -> None:
    source, a, b, c, d, x, y, target = sys.argv[1:]
    with open(source, "rb") as file:
        data = bytearray(file.read())
    box = data.index(b"tkhd") + 4
    is_long = data[box] == 1
    place = box + (52 if is_long else 40)
    one, unit = 1 << 16, 1 << 30
    numbers = [int(a) * one, int(b) * one, 0, int(c) * one, int(d) * one, 0,
               int(x) * one, int(y) * one, unit]
    struct.pack_into(">9i", data, place, *numbers)
    with open(target, "wb") as file:
        file.write(data)


main()
