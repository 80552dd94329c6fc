#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The platform tree builds what the desktop builds."""

import re
import subprocess
import unittest

import environment

BLUEPRINT = environment.PRODUCT_SOURCE / "Android.bp"


def strings_of(name):
    lists = re.findall(rf"^    {name}: \[(.*?)\]", BLUEPRINT.read_text(), re.MULTILINE | re.DOTALL)
    return re.findall(r'"([^"]*)"', lists[0])


class AndroidBpTest(unittest.TestCase):
    def test_the_sources_are_those_of_cmake(self):
        self.assertEqual(strings_of("srcs"), environment.cmake_sources())

    def test_the_flags_are_those_of_cmake(self):
        text = (environment.PRODUCT_SOURCE / "CMakeLists.txt").read_text()
        for flag in strings_of("cppflags") + ["-funsigned-char"]:
            self.assertIn(flag, text + " -fvisibility=hidden -fvisibility-inlines-hidden")
        self.assertIn("-funsigned-char", strings_of("cflags"))

    def test_the_export_list_is_there(self):
        script = re.search(r'version_script: "(.*)"', BLUEPRINT.read_text()).group(1)
        self.assertTrue((environment.PRODUCT_SOURCE / script).is_file())

    # bpfmt prints how it would lay the file out differently, or where it is no
    # blueprint at all.
    def test_it_is_a_well_laid_out_blueprint(self):
        done = subprocess.run(["bpfmt", "-d", BLUEPRINT], capture_output=True, text=True)
        self.assertEqual((done.returncode, done.stdout, done.stderr), (0, "", ""))


if __name__ == "__main__":
    unittest.main()
