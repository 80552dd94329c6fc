#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv docs for this project, and tools/docs for projects with planted faults."""

import importlib.util
import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
JAVADOC = os.environ["ORV_JAVADOC"]
LIMIT = 240
SKIPPED = 77

MODULE_INFO = """/** A module. */
module one {
    exports a;
}
"""
CLASS = """package a;

/** A box. <img src="doc-files/shape.svg" alt="two boxes">. */
public final class Box {
    private Box() {}
}
"""


class Project(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.root = pathlib.Path(folder.name) / "a project"
        self.out = pathlib.Path(folder.name) / "out"
        self.site = self.out / "site"
        self.write("README.md", "# One\n\nThe first sentence. Another.\n\n"
                                "[guide](docs/guide.md#a-second--part)\n")
        self.write("docs/guide.md", "# Guide\n\n## A second & part\n\n[up](../README.md#one)\n")

    def write(self, name, text):
        path = self.root / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(text, "utf-8")

    def write_module(self):
        self.write("java/module-info.java", MODULE_INFO)
        self.write("java/a/package-info.java", "/** A package. */\npackage a;\n")
        self.write("java/a/Box.java", CLASS)
        self.write("java/a/doc-files/shape.dot", "digraph { one -> two }\n")

    def build(self):
        return subprocess.run(
            [SOURCE / "tools/docs/docs.py", "--javadoc", JAVADOC, self.root, self.out],
            capture_output=True, encoding="utf-8", timeout=LIMIT, check=False)

    def page(self, name):
        return (self.site / name).read_text("utf-8")

    def assert_builds(self):
        done = self.build()
        self.assertEqual((done.returncode, done.stderr), (0, ""))

    def assert_fails(self, *lines):
        done = self.build()
        self.assertEqual((done.returncode, done.stderr.splitlines()), (1, list(lines)))


class PagesTest(Project):
    def test_pages_link_to_each_other_and_stand_in_the_index(self):
        self.assert_builds()
        self.assertIn('<a href="docs/guide.html#a-second--part">guide</a>',
                      self.page("README.html"))
        self.assertIn('<h2 id="a-second--part">', self.page("docs/guide.html"))
        self.assertIn('<a href="../README.html#one">up</a>', self.page("docs/guide.html"))
        index = self.page("index.html")
        self.assertIn('<a href="README.html">One</a><br>The first sentence.</li>', index)
        self.assertIn('<a href="docs/guide.html">Guide</a>', index)

    def test_files_and_pages_that_are_linked_to_come_along(self):
        self.write("LICENSE", "A licence.\n")
        self.write("samples/README.md", "# Samples\n")
        self.write("docs/plot.svg", "<svg/>")
        self.write("docs/more.md", "# More\n\n[a](../LICENSE) [b](../samples) ![c](plot.svg)\n")
        self.assert_builds()
        self.assertEqual(self.page("LICENSE"), "A licence.\n")
        self.assertEqual(self.page("docs/plot.svg"), "<svg/>")
        self.assertIn('href="../samples/README.html"', self.page("docs/more.html"))
        self.assertIn("Samples</h1>", self.page("samples/README.html"))

    def test_folders_that_are_linked_to_are_listed(self):
        self.write("samples/one/Sample.txt", "A sample.\n")
        self.write("samples/one/NOTES.md", "# Notes\n\n[gone](gone.md)\n")
        self.write("docs/more.md", "# More\n\n[samples](../samples)\n")
        self.assert_fails("samples/one/NOTES.md:3: gone.md: there is no such file")
        self.write("samples/one/NOTES.md", "# Notes\n")
        self.assert_builds()
        self.assertIn('href="../samples/index.html"', self.page("docs/more.html"))
        self.assertIn('<a href="one/index.html">one/</a>', self.page("samples/index.html"))
        self.assertIn('<a href="Sample.txt">Sample.txt</a>', self.page("samples/one/index.html"))
        self.assertEqual(self.page("samples/one/Sample.txt"), "A sample.\n")

    def test_addresses_elsewhere_are_listed(self):
        self.write("docs/more.md",
                   "# More\n\n[a](https://example.org/x#y) <https://example.org/>\n")
        self.assert_builds()
        self.assertEqual((self.out / "external-links.txt").read_text("utf-8").splitlines(),
                         ["https://example.org/", "https://example.org/x#y"])

    def test_diagrams_are_drawn_in_the_page(self):
        self.write("docs/more.md", "# More\n\n" + "```dot\ndigraph { left -> right }\n```\n\n" * 2)
        self.assert_builds()
        page = self.page("docs/more.html")
        self.assertEqual(page.count("<svg"), 2)
        self.assertNotIn("digraph", page)
        ids = re.findall(r' id="([^"]*)"', page)
        self.assertEqual(len(ids), len(set(ids)))


class FaultsTest(Project):
    def test_broken_links_and_anchors_are_named(self):
        self.write("docs/more.md", """# More

A [file](none.md) and, on
the next line, an [anchor](guide.md#none) and [one here](#none).

| [cell](none.html) |
|---|
| ![picture](none.png) |

- <a href="none.txt">raw</a>

[out](../../out.md)
""")
        self.assert_fails(
            "docs/more.md:3: none.md: there is no such file",
            "docs/more.md:4: guide.md#none: docs/guide.html has no anchor 'none'",
            "docs/more.md:4: #none: docs/more.html has no anchor 'none'",
            "docs/more.md:6: none.html: there is no such file",
            "docs/more.md:8: none.png: there is no such file",
            "docs/more.md:10: none.txt: there is no such file",
            "docs/more.md:12: ../../out.md: leads out of the documentation")

    def test_what_is_loaded_from_elsewhere_is_refused(self):
        self.write("docs/more.md", "# More\n\n![badge](https://example.org/badge.svg)\n")
        self.assert_fails(
            "docs/more.md:3: https://example.org/badge.svg: is loaded from elsewhere")

    def test_a_broken_diagram_is_named(self):
        self.write("docs/more.md", "# More\n\n```dot\ndigraph {\n  a -> -> b\n}\n```\n")
        done = self.build()
        self.assertEqual(done.returncode, 1)
        self.assertRegex(done.stderr, r"^docs/more\.md:5: .*syntax error")


class JavadocTest(Project):
    def test_modules_are_described_with_their_diagrams(self):
        self.write_module()
        self.write("docs/more.md", "# More\n\n[module](../java) [class](../java/a/Box.java)\n")
        self.assert_builds()
        self.assertIn('<a href="../api/one/module-summary.html">module</a> '
                      '<a href="../api/one/a/Box.html">class</a>', self.page("docs/more.html"))
        self.assertIn("<svg", self.page("api/one/a/doc-files/shape.svg"))
        self.assertIn('<a href="api/one/module-summary.html">one</a>', self.page("index.html"))

    def test_a_diagram_that_is_not_there_is_named(self):
        self.write_module()
        (self.root / "java/a/doc-files/shape.dot").unlink()
        done = self.build()
        self.assertEqual(done.returncode, 1)
        self.assertRegex(done.stderr, r"api/one/a/Box\.html:\d+: doc-files/shape\.svg: "
                                      "there is no such file")

    def test_a_broken_diagram_is_named(self):
        self.write_module()
        self.write("java/a/doc-files/shape.dot", "digraph {\n")
        done = self.build()
        self.assertEqual(done.returncode, 1)
        self.assertRegex(done.stderr, r"^java/a/doc-files/shape\.dot:\d+: .*syntax error")

    def test_a_broken_comment_is_named(self):
        self.write_module()
        self.write("java/a/Box.java", CLASS.replace("A box", "A {@link Circle}"))
        done = self.build()
        self.assertEqual(done.returncode, 1)
        self.assertIn("java/a/Box.java:3: error: reference not found", done.stderr)


class ThisProjectTest(unittest.TestCase):
    def test_the_site_is_whole_and_loads_nothing_from_elsewhere(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        done = subprocess.run(
            [SOURCE / "orv", "docs"], capture_output=True, encoding="utf-8", timeout=LIMIT,
            env={**os.environ, "ORV_BUILD": folder.name, "ORV_NO_INSTALL": "1"}, check=False)
        self.assertEqual((done.returncode, done.stderr), (0, ""))
        site = pathlib.Path(folder.name) / "docs/site"
        sources = [SOURCE / name for name in ("README.md", "CONTRIBUTING.md", "CHANGELOG.md")]
        sources += (SOURCE / "docs").rglob("*.md")
        index = (site / "index.html").read_text("utf-8")
        for source in sources:
            name = source.relative_to(SOURCE).with_suffix(".html")
            self.assertTrue((site / name).is_file(), name)
            self.assertIn(f'href="{name}"', index)
        self.assertTrue((site / "api/com.quintora.mmp.platform/module-summary.html").is_file())
        for page in site.rglob("*.html"):
            text = page.read_text("utf-8")
            self.assertNotRegex(text, r'<(?:script|img|iframe)[^>]* src="(?:https?:)?//', page)
            self.assertNotRegex(text, r'<link rel="(?!canonical)[^>]* href="(?:https?:)?//', page)
        for sheet in site.rglob("*.css"):
            self.assertNotRegex(sheet.read_text("utf-8"), r"(?:url\(|@import)\W*(?:https?:)?//")


if __name__ == "__main__":
    if importlib.util.find_spec("markdown_it") is None or shutil.which("dot") is None:
        print("python3-markdown-it and graphviz are not installed")
        sys.exit(SKIPPED)
    unittest.main()
