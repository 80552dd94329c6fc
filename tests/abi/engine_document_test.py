#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""docs/engine.md names the operations that an engine has, and no others."""

import collections
import re
import unittest

import environment

HEADER = environment.SOURCE / "engine/include/orvtarn/TarnPlayer.h"
DOCUMENT = environment.SOURCE / "docs/engine.md"


def parameters(text):
    """How many there are; commas inside of <> separate none."""
    while "<" in text:
        text = re.sub(r"<[^<>]*>", "", text)
    return len(text.split(",")) if text.strip() else 0


def declared(header):
    """Each public operation's name and number of parameters, and how often."""
    text = re.sub(r"//[^\n]*", "", header)
    public = text.split("class TarnPlayer :")[1].split("protected:")[0].split("public:")[1]
    found = re.findall(r"(\w+)\(([^()]*)\)\s*(?:override)?\s*;", public)
    return collections.Counter((name, parameters(rest)) for name, rest in found)


def documented(document):
    """The same of the tables' first columns."""
    section = document.split("\n## Operations\n")[1].split("\n## ")[0]
    cells = re.findall(r"^\| `(\w+)\(([^()`]*)\)` \|", section, re.MULTILINE)
    return collections.Counter((name, parameters(rest)) for name, rest in cells)


class EngineDocumentTest(unittest.TestCase):
    def setUp(self):
        self.header = HEADER.read_text(encoding="utf-8")
        self.document = DOCUMENT.read_text(encoding="utf-8")

    def test_its_tables_are_the_header(self):
        operations = declared(self.header)
        self.assertGreater(len(operations), 60)
        self.assertEqual(documented(self.document), operations)

    def test_each_row_of_the_tables_is_an_operation(self):
        section = self.document.split("\n## Operations\n")[1].split("\n## ")[0]
        rows = [line for line in section.splitlines() if line.startswith("|")]
        others = [row for row in rows if not re.match(r"\| `\w+\([^`]*\)` \|", row)]
        self.assertEqual(set(others),
                         {"| Operation | When | Blocks | In Java |", "|---|---|---|---|"})

    def test_an_operation_in_the_text_is_one_of_them(self):
        known = {name for name, _ in declared(self.header)}
        section = self.document.split("\n## Operations\n")[1].split("\n## ")[0]
        named = set(re.findall(r"`(\w+)\([^`]*\)`", section))
        self.assertEqual(named - known, set())

    def test_a_change_of_the_header_shows(self):
        for before, after in (("bool step(int amount);", ""),
                              ("bool step(int amount);", "bool step(int amount, bool fast);"),
                              ("bool step(int amount);", "bool step(int a);\nbool leap(int b);")):
            changed = self.header.replace(before, after)
            self.assertNotEqual(changed, self.header)
            self.assertNotEqual(documented(self.document), declared(changed))


if __name__ == "__main__":
    unittest.main()
