#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The sample engine's folder: its size, its symbols, and a build of its own."""

import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

sys.path.insert(0, str(pathlib.Path(__file__).parent.parent))
import environment  # noqa: E402

SAMPLE = environment.SOURCE / "samples/engine-pattern"
ENGINE = os.environ["ORV_PATTERN_ENGINE"]
PLATFORM = os.environ["ORV_PLATFORM"]


def lines_of(*names):
    return sum(len((SAMPLE / name).read_text(encoding="utf-8").splitlines()) for name in names)


def check(library):
    return environment.run("engine.py", "check", library, environment.SOURCE / "abi")


class SampleTest(unittest.TestCase):
    def test_it_is_small_enough_to_read(self):
        files = {file.name for file in SAMPLE.iterdir()}
        self.assertEqual(files, {"CMakeLists.txt", "README.md", "TarnPlayer.cpp"})
        self.assertLessEqual(lines_of("CMakeLists.txt", "TarnPlayer.cpp"), 300)
        self.assertLessEqual(lines_of("README.md"), 60)

    def test_it_has_all_that_the_library_needs(self):
        status, lines, _ = check(ENGINE)
        self.assertEqual((status, len(lines)), (0, 1), lines)

    @unittest.skipIf(check(ENGINE)[1][-1].endswith("(armhf)"), "the compiler is for another machine")
    def test_it_builds_alone_with_installed_headers(self):
        with tempfile.TemporaryDirectory() as name:
            folder = pathlib.Path(name)
            include = folder / "prefix/include"
            shutil.copytree(environment.SOURCE / "engine/include", include)
            shutil.copytree(environment.SOURCE / "platform/include", include, dirs_exist_ok=True)
            (include / "stream").mkdir()
            shutil.copy(environment.PRODUCT_SOURCE / "stream/IOrvStreamSource.h",
                        include / "stream")
            (folder / "prefix/lib").mkdir()
            shutil.copy(PLATFORM, folder / "prefix/lib/liborv_platform.so")
            shutil.copytree(SAMPLE, folder / "sample")
            for command in (["-G", "Ninja", "-S", folder / "sample", "-B", folder / "out",
                             f"-DCMAKE_PREFIX_PATH={folder}/prefix"],
                            ["--build", folder / "out"]):
                done = subprocess.run(["cmake", *command], capture_output=True, text=True)
                self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
            status, lines, _ = check(folder / "out/liborvtarn.so")
            self.assertEqual(status, 0, lines)


if __name__ == "__main__":
    unittest.main()
