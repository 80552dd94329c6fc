#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""Each piece of Java in the documentation compiles, without a warning."""

import os
import pathlib
import tempfile
import unittest

import snippets

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
JAVAC = os.environ["ORV_JAVAC"]
JARS = snippets.read_jars(pathlib.Path(os.environ["ORV_BINARY"]) / "java/modules.txt")

PAGE = """# A page

<!-- java: MediaPlayer player,
    int place -->
```java
player.seekTo(place);
```

```java
import java.util.List;

public final class Names {
    List<String> names = List.of();
}
```

1. In a list:

   <!-- java members: MediaPlayer player -->
   ```java
   void go() {
       player.start();
   }
   ```
"""


class SnippetsTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def compile_page(self, text):
        page = self.folder / "page.md"
        page.write_text(text, "utf-8")
        said = snippets.compile_all(JAVAC, JARS, snippets.read(page), self.folder / "java")
        return said.replace(str(page), "page.md").splitlines()

    def test_those_of_this_project_compile(self):
        pages = [SOURCE / "README.md", *sorted((SOURCE / "docs").rglob("*.md"))]
        found = [snippet for page in pages for snippet in snippets.read(page)]
        self.assertGreater(len(found), 20)
        names = [jar.name for jar in JARS]
        there = [snippet for snippet in found
                 if snippet.jar is None or any(snippet.jar in name for name in names)]
        for snippet in found:
            if snippet not in there:
                print(f"{snippet.page}:{snippet.line}: not compiled without a JAR {snippet.jar}")
        self.assertEqual(snippets.compile_all(JAVAC, JARS, there, self.folder / "java"), "")

    def test_a_page_that_is_right_passes(self):
        self.assertEqual(self.compile_page(PAGE), [])

    def test_a_wrong_call_is_named_by_its_line_in_the_page(self):
        self.assertEqual(self.compile_page(PAGE.replace("player.start", "player.begin"))[0],
                         "page.md:22: error: cannot find symbol")

    def test_a_warning_fails_too(self):
        said = self.compile_page(PAGE.replace("List<String> names", "List names"))
        self.assertIn("page.md:13: warning: [rawtypes] found raw type: List", said)

    def test_what_is_assumed_must_be_said(self):
        said = self.compile_page(PAGE.replace("int place", "int other"))
        self.assertEqual(said[0], "page.md:6: error: cannot find symbol")


if __name__ == "__main__":
    unittest.main()
