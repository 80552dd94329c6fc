#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The platform tree builds what the desktop builds."""

import re
import subprocess
import unittest

import environment
import blueprint

BLUEPRINT = environment.PRODUCT_SOURCE / "Android.bp"


def strings_of(name):
    return blueprint.strings_of(BLUEPRINT.read_text(), name)


class AndroidBpTest(unittest.TestCase):
    def test_the_sources_are_those_of_cmake(self):
        self.assertEqual(strings_of("srcs"), environment.cmake_sources())

    def test_the_flags_are_those_of_the_desktop_build(self):
        flags = set(strings_of("cflags") + strings_of("cppflags"))
        self.assertEqual(flags, {
            "-Wall", "-Wextra", "-Werror", "-fno-exceptions", "-fno-rtti", "-funsigned-char",
            "-fvisibility=hidden", "-fvisibility-inlines-hidden"})
        text = BLUEPRINT.read_text()
        self.assertEqual(blueprint.string_of(text, "compile_multilib"), "32")
        self.assertEqual(blueprint.string_of(text, "cpp_std"), "c++17")

    def test_the_page_names_every_module_and_header(self):
        page = (environment.SOURCE / "docs/platform-tree.md").read_text()
        table = dict(re.findall(r"^\| `(lib\w+)` \| (.*) \|$", page, re.MULTILINE))
        self.assertEqual(sorted(table), sorted(strings_of("shared_libs") + strings_of("header_libs")))
        include = re.compile(r"#include <((?!sys/|orvtarn/)\w+/[\w/]+\.h|jni\.h)>")
        used = {header for file in environment.PRODUCT_SOURCE.rglob("*.[ch]*")
                for header in include.findall(file.read_text())}
        named = set(re.findall(r"`([\w/]+\.h)`", " ".join(table.values())))
        self.assertEqual(used, named - {"orvtarn/TarnPlayer.h"})

    def test_the_export_list_is_there(self):
        script = blueprint.string_of(BLUEPRINT.read_text(), "version_script")
        self.assertTrue((environment.PRODUCT_SOURCE / script).is_file())

    # bpfmt prints how it would lay the file out differently, or where it is no
    # blueprint at all.
    def test_it_is_a_well_laid_out_blueprint(self):
        done = subprocess.run(["bpfmt", "-d", BLUEPRINT], capture_output=True, text=True)
        self.assertEqual((done.returncode, done.stdout, done.stderr), (0, "", ""))


if __name__ == "__main__":
    unittest.main()
