#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""docs/architecture.md: its diagrams, and the names that a reader will search for."""

import re
import shutil
import subprocess
import unittest

import environment

DOCUMENT = environment.SOURCE / "docs/architecture.md"
FOLDERS = ("frameworks", "engine", "platform", "java", "apps", "tests", "abi")
# What the text calls by a word that looks like a name of the sources, and is none.
WORDS = {"OpenGL", "TarnPlayer.h"}


def diagrams(text):
    return re.findall(r"```dot\n(.*?)```", text, re.DOTALL)


def names(text):
    """Identifiers in code spans and in the diagrams' labels, each part of A::b."""
    prose = re.sub(r"```dot\n.*?```", "", text, flags=re.DOTALL)
    spans = [span for span in re.findall(r"`([^`\n]+)`", prose) if "/" not in span]
    labels = [part for diagram in diagrams(text)
              for label in re.findall(r'label="([^"]*)"', diagram) for part in label.split("\\n")]
    # Of labels, words with a capital inside or an underscore: the rest is English.
    inside = [word for label in labels for word in re.findall(r"[A-Za-z_:]\w*(?:::\w+)*", label)
              if re.search(r"[a-z][A-Z]|_|::", word)]
    found = {part for name in spans + inside for part in name.split("::")}
    return {name for name in found if re.fullmatch(r"\w{4,}", name)} - WORDS


def words_of_the_sources():
    found = set()
    for folder in FOLDERS:
        for file in (environment.SOURCE / folder).rglob("*"):
            if file.suffix in {".cpp", ".h", ".java", ".txt"}:
                found.update(re.findall(r"\w+", file.read_text(encoding="utf-8")))
    return found


class ArchitectureDocumentTest(unittest.TestCase):
    def setUp(self):
        self.text = DOCUMENT.read_text(encoding="utf-8")

    def test_a_search_finds_each_name(self):
        wanted = names(self.text)
        self.assertGreater(len(wanted), 60)
        self.assertEqual(wanted - words_of_the_sources(), set())

    def test_a_search_finds_each_folder_and_file(self):
        paths = re.findall(r"`([\w.-]+/[\w./-]*)`", self.text)
        product = environment.PRODUCT_SOURCE
        lacking = [path for path in paths
                   if not (environment.SOURCE / path).exists() and not (product / path).exists()]
        self.assertGreater(len(paths), 4)
        self.assertEqual(lacking, [])

    def test_there_is_a_diagram_of_each_way(self):
        kinds = [re.match(r"digraph (\w+) \{", diagram)[1] for diagram in diagrams(self.text)]
        self.assertEqual(kinds, ["layers", "java", "call", "event", "read", "frame"])

    def test_an_arrow_leads_from_box_to_box(self):
        for diagram in diagrams(self.text):
            made = set(re.findall(r"^\s*(\w+) \[label=", diagram, re.MULTILINE))
            chains = re.findall(r"^\s*(\w+(?: -> \w+)+)", diagram, re.MULTILINE)
            self.assertEqual({end for chain in chains for end in chain.split(" -> ")} - made, set())

    @unittest.skipUnless(shutil.which("dot"), "graphviz is not installed")
    def test_graphviz_draws_each(self):
        for diagram in diagrams(self.text):
            done = subprocess.run(["dot", "-Tsvg"], input=diagram, capture_output=True, text=True)
            self.assertEqual((done.returncode, done.stderr), (0, ""))
            self.assertIn("</svg>", done.stdout)


if __name__ == "__main__":
    unittest.main()
