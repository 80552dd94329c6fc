#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The tests for a device are those of the desktop."""

import re
import subprocess
import unittest

import environment
import blueprint

BLUEPRINT = environment.SOURCE / "Android.bp"
# What only a desktop has: the surface of these tests.
DESKTOP = {"tests/engine-kit/SurfaceTest.cpp", "tests/engine/FrameSink.cpp"}
PRODUCT = "frameworks/playback/MediaPlayer/"


def module(name):
    """The text of the module of that name."""
    for text in re.findall(r"^\w+ \{\n(.*?)^\}", BLUEPRINT.read_text(), re.MULTILINE | re.DOTALL):
        if blueprint.string_of(text, "name") == name:
            return text
    raise AssertionError(f"{BLUEPRINT} has no module {name}")


def listed(folder, command):
    """The sources of a CMakeLists.txt behind that command, by their paths from the root."""
    text = (environment.SOURCE / folder / "CMakeLists.txt").read_text(encoding="utf-8")
    names = text.split(command)[1].split(")")[0].split()
    paths = [(environment.SOURCE / folder / name).resolve() for name in names]
    return [str(path.relative_to(environment.SOURCE)) for path in paths]


def wrapped():
    """The functions that the contract tests replace, wherever CMake names them."""
    found = set()
    for folder in ("contract", "support"):
        text = (environment.SOURCE / "tests" / folder / "CMakeLists.txt").read_text()
        found |= set(re.findall(r"--wrap=(\w+)[\s)]", text))
        for names, prefix in re.findall(
                r"foreach\(\w+((?:\s+\w+)+)\)\s*target_link_options\([^)]*--wrap=(\w*)\$\{\w+\}\)",
                text):
            found |= {prefix + name for name in names.split()}
    # It starts the emulator.
    return found - {"execv"}


class AndroidBpTestsTest(unittest.TestCase):
    def test_the_engine_suite_has_its_sources(self):
        sources = [source for source in listed("tests/engine-kit", "add_executable(engine_kit")
                   if source not in DESKTOP]
        self.assertEqual(blueprint.strings_of(module("orv_engine_tests"), "srcs"), sources)

    def test_the_contract_tests_have_theirs_and_the_products(self):
        sources = [*listed("tests/contract", "add_executable(contract_tests"),
                   *listed("tests/support", "add_library(orv_fakes OBJECT"),
                   *(PRODUCT + source for source in environment.cmake_sources())]
        self.assertEqual(blueprint.strings_of(module("orv_contract_tests"), "srcs"), sources)

    def test_the_same_functions_are_replaced(self):
        flags = blueprint.strings_of(module("orv_contract_tests"), "ldflags")
        self.assertGreater(len(flags), 30)
        self.assertEqual({flag.removeprefix("-Wl,--wrap=") for flag in flags}, wrapped())

    def test_the_page_names_modules_media_and_paths(self):
        page = (environment.SOURCE / "docs/device-tests.md").read_text()
        for name in ("orv_engine_tests", "orv_contract_tests"):
            module(name)
            self.assertIn(f"`{name}`", page)
        for file in re.findall(r'/data/local/tmp/orv/([\w.]+)\\"', module("orv_contract_tests")):
            self.assertIn(f"`{file}`", page)
        kit = "".join(file.read_text() for file in
                      (environment.SOURCE / "tests/engine-kit").glob("*.cpp"))
        self.assertEqual(set(re.findall(r"`(ORV_KIT_\w+)`", page)),
                         set(re.findall(r'"(ORV_KIT_\w+)"', kit)))

    def test_it_is_a_well_laid_out_blueprint(self):
        done = subprocess.run(["bpfmt", "-d", BLUEPRINT], capture_output=True, text=True)
        self.assertEqual((done.returncode, done.stdout, done.stderr), (0, "", ""))


if __name__ == "__main__":
    unittest.main()
