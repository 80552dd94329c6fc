#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The program of docs/getting-started.md shows what the page's screenshot shows.

With ORV_ACCEPT_SCREENSHOT set, the screenshot is written anew."""

import math
import os
import pathlib
import re
import shlex
import subprocess
import tempfile
import time
import unittest

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
BINARY = pathlib.Path(os.environ["ORV_BINARY"])
JAVA = pathlib.Path(os.environ["ORV_JAVA"])
PAGE = SOURCE / "docs/getting-started.md"
SCREENSHOT = SOURCE / "docs/getting-started.png"
ADVICE = ("the screenshot is another; if that is meant, ORV_ACCEPT_SCREENSHOT=1 ./orv test "
          "--filter docs.getting_started writes it")

WIDTH, HEIGHT = 640, 360
LIMIT = 90
# Coding and scaling of colours cost some; another picture has less than 20 dB.
ALIKE_DB = 30
MOST_BYTES = 60_000
# Where the bars of 75 % are, and what is seen there.
BARS = {46: (191, 191, 191), 137: (191, 191, 0), 229: (0, 191, 191), 320: (0, 191, 0),
        411: (191, 0, 191), 503: (191, 0, 0), 594: (0, 0, 191)}


def command_with(word):
    """The page's indented command that begins so, as words."""
    line = re.search(rf"^    ({word} .+)$", PAGE.read_text("utf-8"), re.MULTILINE)
    return shlex.split(line[1])


def run(*command, **options):
    return subprocess.run([*map(str, command)], check=True, stdout=subprocess.PIPE,
                          stderr=subprocess.PIPE, **options).stdout


def pixels(*source):
    """The first picture of an input of ffmpeg's, three bytes a pixel."""
    return run("ffmpeg", "-nostdin", "-v", "error", *source, "-frames:v", "1",
               "-f", "rawvideo", "-pix_fmt", "rgb24", "-")


def psnr(one, other):
    if len(one) != len(other):
        return 0
    squares = sum((a - b) ** 2 for a, b in zip(one, other)) / len(one)
    return 10 * math.log10(255 ** 2 / squares) if squares else math.inf


class GettingStartedTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        program = re.search(r"```java\n(.*?)```", PAGE.read_text("utf-8"), re.DOTALL)[1]
        (self.folder / "FirstPicture.java").write_text(program, "utf-8")
        (self.folder / "build").symlink_to(BINARY)
        self.display = self.open_display()

    def open_display(self):
        """A screen that nothing else shows anything on."""
        read, write = os.pipe()
        screen = subprocess.Popen(
            ["Xvfb", "-displayfd", str(write), "-screen", "0", f"{WIDTH}x{HEIGHT}x24",
             "-nolisten", "tcp"], pass_fds=[write], stderr=subprocess.DEVNULL)
        self.addCleanup(self.end, screen)
        os.close(write)
        with os.fdopen(read, encoding="ascii") as number:
            return f":{number.readline().strip()}"

    def start_program(self):
        name, *words = command_with("java")
        self.assertEqual(name, "java")
        with open(self.folder / "said", "w", encoding="utf-8") as said:
            program = subprocess.Popen(
                [JAVA, *words], cwd=self.folder, stdout=said, stderr=said,
                env={**os.environ, "DISPLAY": self.display, "LC_ALL": "C.UTF-8"})
        self.addCleanup(self.end, program)
        return program

    @staticmethod
    def end(process):
        process.terminate()
        process.wait()

    def capture(self):
        return pixels("-f", "x11grab", "-video_size", f"{WIDTH}x{HEIGHT}", "-draw_mouse", "0",
                      "-i", self.display)

    def await_picture(self, program, film):
        end = time.monotonic() + LIMIT
        while time.monotonic() < end:
            shown = self.capture()
            if psnr(shown, film) > ALIKE_DB:
                return shown
            self.assertIsNone(program.poll(), (self.folder / "said").read_text("utf-8"))
        self.fail(f"no picture came: {(self.folder / 'said').read_text('utf-8')}")

    def write_screenshot(self, shown):
        run("ffmpeg", "-nostdin", "-v", "error", "-y", "-f", "rawvideo", "-pix_fmt", "rgb24",
            "-s", f"{WIDTH}x{HEIGHT}", "-i", "-", "-compression_level", "9", SCREENSHOT,
            input=shown)

    def test_the_program_shows_what_the_page_shows(self):
        ffmpeg = command_with("ffmpeg")
        run(*ffmpeg, "-v", "error", "-nostdin", cwd=self.folder)
        film = pixels("-i", self.folder / ffmpeg[-1])
        shown = self.await_picture(self.start_program(), film)
        for x, colour in BARS.items():
            place = (HEIGHT // 4 * WIDTH + x) * 3
            for found, wanted in zip(shown[place:place + 3], colour):
                self.assertAlmostEqual(found, wanted, delta=12, msg=f"at {x}: {colour}")
        if os.environ.get("ORV_ACCEPT_SCREENSHOT"):
            self.write_screenshot(shown)
        self.assertGreater(psnr(shown, pixels("-i", SCREENSHOT)), ALIKE_DB, ADVICE)
        self.assertLess(SCREENSHOT.stat().st_size, MOST_BYTES)


if __name__ == "__main__":
    unittest.main()
