#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""abi/java.txt is written from the lookups of one run. No class and no
method in the library's sources may have been left out of that run."""

import re
import unittest

import environment


class JavaNamesTest(unittest.TestCase):
    def test_every_class_and_signature_in_the_sources_is_listed(self):
        listed = set((environment.SOURCE / "abi/java.txt").read_text().split())
        descriptors = {word[1:-1] for word in listed if re.fullmatch(r"L[\w/$]+;", word)}
        found = 0
        for source in environment.PRODUCT_SOURCE.rglob("*.cpp"):
            text = re.sub(r'"\s*"', "", source.read_text(encoding="utf-8"))
            for literal in re.findall(r'"(com/quintora/[\w/$]+|\([\w/$;\[]*\)[\w/$;\[]+)"', text):
                found += 1
                self.assertIn(literal, listed | descriptors, source.name)
        self.assertGreater(found, 100)


if __name__ == "__main__":
    unittest.main()
