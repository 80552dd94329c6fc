#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The list of what the library needs of an engine is what it really needs."""

import os
import unittest

import environment
import elf


class EngineNeedsTest(unittest.TestCase):
    def test_the_list_is_that_of_the_library(self):
        architecture = elf.Library(environment.PRODUCT).architecture
        listed = (environment.SOURCE / f"abi/engine.{architecture}.txt").read_text().splitlines()
        status, needed, _ = environment.run("engine.py", "list", environment.PRODUCT,
                                            os.environ["ORV_ENGINE_WHOLE"])
        self.assertEqual(status, 0)
        self.assertEqual(listed, needed, "./orv abi --accept records a change that is meant")

    def test_both_architectures_need_the_same_operations(self):
        def names(architecture):
            text = (environment.SOURCE / f"abi/engine.{architecture}.txt").read_text()
            # 64-bit numbers have another name on each.
            return sorted(line.split("# ")[-1].replace("long long", "long")
                          for line in text.splitlines())
        self.assertEqual(names("x86_64"), names("armhf"))


if __name__ == "__main__":
    unittest.main()
