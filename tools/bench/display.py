# SPDX-License-Identifier: Apache-2.0
"""A display without a screen, whose pixels can be looked at: Xvfb keeps them in
a file. So what is on it is observed from outside, alike for every player."""

import mmap
import os
import shutil
import struct
import subprocess
import tempfile

from figures import Failed
from tree import processor_seconds, require_program

WIDTH, HEIGHT = 2560, 1600
REACH = 50  # pixels from the middle to those that are looked at


class Display:
    """A running X server of one screen, 2560 x 1600 pixels of 32 bits."""

    def __init__(self):
        require_program("Xvfb")
        self._folder = tempfile.mkdtemp(prefix="orv-bench-display-")
        read_end, write_end = os.pipe()
        self._server = subprocess.Popen(
            ["Xvfb", "-displayfd", str(write_end), "-screen", "0", f"{WIDTH}x{HEIGHT}x24",
             "-fbdir", self._folder, "-nolisten", "tcp", "-noreset"], pass_fds=[write_end],
            stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        os.close(write_end)
        with open(read_end, encoding="ascii") as numbers:
            number = numbers.readline().strip()
        if not number:
            self.close()
            raise Failed("Xvfb does not start")
        self.name = f":{number}"
        self._map()

    def close(self):
        self._server.terminate()
        self._server.wait()
        shutil.rmtree(self._folder, ignore_errors=True)

    def environment(self):
        """For programs that shall show something on it."""
        kept = {name: value for name, value in os.environ.items() if name != "WAYLAND_DISPLAY"}
        return {**kept, "DISPLAY": self.name}

    def processor_seconds(self):
        return processor_seconds(self._server.pid)

    def pixel(self, x, y):
        """(red, green, blue), 0 to 255 each."""
        at = self._start + y * self._bytes_per_line + 4 * x
        blue, green, red, _ = self._pixels[at:at + 4]
        return red, green, blue

    def middle(self, matches):
        """Whether the pixels around the middle match, where the pointer is not."""
        return all(matches(*self.pixel(WIDTH // 2 + x, HEIGHT // 2 + y))
                   for x in (-REACH, REACH) for y in (-REACH, REACH))

    def extent(self, matches):
        """How many pixels of a line near the middle match, without a gap."""
        left = right = WIDTH // 2
        line = HEIGHT // 2 + REACH
        while left > 0 and matches(*self.pixel(left - 1, line)):
            left -= 1
        while right < WIDTH - 1 and matches(*self.pixel(right + 1, line)):
            right += 1
        return right - left + 1

    # The file is an X window dump: a header of big-endian words, the colours, the pixels.
    def _map(self):
        with open(os.path.join(self._folder, "Xvfb_screen0"), "rb") as file:
            self._pixels = mmap.mmap(file.fileno(), 0, prot=mmap.PROT_READ)
        header = struct.unpack(">25I", self._pixels[:100])
        self._start = header[0] + 12 * header[19]
        self._bytes_per_line = header[12]
        if header[11] != 32:
            raise Failed(f"Xvfb has {header[11]} bits a pixel, not 32")


def is_magenta(red, green, blue):
    return red > 200 and green < 60 and blue > 200


def is_green(red, green, blue):
    return red < 60 and green > 200 and blue < 60
