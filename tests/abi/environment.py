# SPDX-License-Identifier: Apache-2.0
"""What ctest tells these tests, and the tools that they try."""

import os
import pathlib
import subprocess
import sys

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
BINARY = pathlib.Path(os.environ["ORV_BINARY"])
PRODUCT = os.environ["ORV_PRODUCT"]
STRIP = os.environ["ORV_STRIP"]
PRODUCT_SOURCE = SOURCE / "frameworks/playback/MediaPlayer"

sys.path.insert(0, str(SOURCE / "tools/inspect"))


def run(tool, *arguments):
    """(status, lines of standard output, lines of standard error)"""
    done = subprocess.run([SOURCE / "tools/inspect" / tool, *map(str, arguments)],
                          capture_output=True, text=True)
    return done.returncode, done.stdout.splitlines(), done.stderr.splitlines()


def cmake_sources():
    """The product's source files, as its CMakeLists.txt lists them."""
    text = (PRODUCT_SOURCE / "CMakeLists.txt").read_text(encoding="utf-8")
    return text.split("set(MEDIAPLAYER_ORV_SOURCES")[1].split(")")[0].split()
