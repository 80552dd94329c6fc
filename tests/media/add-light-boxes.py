# SPDX-License-Identifier: Apache-2.0
"""Copies an MP4 file of HEVC, adding what its pictures were mastered for.

add-light-boxes.py IN MIN MAX CONTENT AVERAGE OUT: luminances in cd/m², as the
boxes "mdcv" and "clli" of ISO/IEC 14496-12. The index must be behind the media,
whose places in the file then stay.
"""

import struct
import sys

PARENTS = [b"moov", b"trak", b"mdia", b"minf", b"stbl", b"stsd", b"hvc1"]
# Green, blue, red and white of Display P3, in 1/50000.
CHROMATICITIES = [13250, 34500, 7500, 3000, 34000, 16000, 15635, 16450]


def main() -> None:
    source, least, most, content, average, target = sys.argv[1:]
    with open(source, "rb") as file:
        data = bytearray(file.read())
    mastering = struct.pack(">8H2I", *CHROMATICITIES,
                            round(float(most) * 10000), round(float(least) * 10000))
    light = struct.pack(">2H", int(content), int(average))
    added = (struct.pack(">I", 8 + len(mastering)) + b"mdcv" + mastering
             + struct.pack(">I", 8 + len(light)) + b"clli" + light)
    place = data.index(b"mdat")
    for name in PARENTS:
        place = data.index(name, place)
        size = struct.unpack_from(">I", data, place - 4)[0]
        struct.pack_into(">I", data, place - 4, size + len(added))
    end = place - 4 + size
    data[end:end] = added
    with open(target, "wb") as file:
        file.write(data)


main()
