#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""tree.py TREE CHECKOUT: what the product's sources lack in a platform tree.

TREE is the root of an Android platform tree, or a folder of its headers;
CHECKOUT is this project's. Each source is compiled for 32-bit ARM as
Android.bp says, without making anything. Ends with 0 when nothing is lacking,
1 when something is, 2 when the input is unfit."""

import concurrent.futures
import os
import re
import shutil
import subprocess
import sys

import blueprint
import refusal
import tree_headers
import tree_slots
import tree_words
from refusal import Refusal

PLAYER = "orvtarn/TarnPlayer.h"


class Check:
    """One tree against one checkout. Findings are kept by the name that they
    are about: each is reported once."""

    def __init__(self, tree, checkout):
        self.tree = os.path.abspath(tree)
        self.checkout = os.path.abspath(checkout)
        self.product = os.path.join(self.checkout, "frameworks/playback/MediaPlayer")
        self.modules, self.folders, releases = tree_headers.read_page(
            os.path.join(self.checkout, "docs/platform-tree.md"))
        self.headers = tree_headers.Headers(self.tree, self.folders)
        self.words = tree_words.Words(self.product, self.tree, self.modules, releases)
        self.findings = {}
        self.unseen = ""  # why the slots could not be looked at
        with open(os.path.join(self.product, "Android.bp"), encoding="utf-8") as file:
            self.read_build_file(file.read())

    def read_build_file(self, text):
        self.sources = blueprint.strings_of(text, "srcs")
        self.flags = [
            *tree_headers.library_flags(self.tree),
            f"-std={blueprint.string_of(text, 'cpp_std')}",
            *blueprint.strings_of(text, "cflags"), *blueprint.strings_of(text, "cppflags"),
            *(f"-I{folder}" for folder in blueprint.strings_of(text, "local_include_dirs"))]

    def clang(self, *arguments, text=None):
        """A run of the compiler with the product's flags and the tree's folders."""
        return subprocess.run(
            ["clang++", *self.flags, *(f"-I{root}" for root in self.headers.roots),
             "-ferror-limit=0", "-fno-caret-diagnostics", "-fno-color-diagnostics", *arguments],
            cwd=self.product, input=text, capture_output=True, text=True, errors="replace")

    def find_headers(self):
        """Finds the folders of what the sources include, and of what that
        includes in turn."""
        included, optional = tree_headers.read_includes(self.product)
        self.modules.update((header, tree_headers.ENGINE) for header in sorted(included)
                            if header.startswith("orvtarn/"))
        own_engine = not self.headers.find(PLAYER)
        present = []
        for header, module in self.modules.items():
            if module == tree_headers.ENGINE and own_engine:
                continue
            if self.headers.find(header, module):
                present.append(header)
            elif header not in optional:
                self.findings[header] = self.lacking_header(header, module)
        if not present:
            raise Refusal(f"{self.tree}: holds no header that the sources include")
        if own_engine:
            self.findings[PLAYER] = (self.lacking_header(PLAYER, tree_headers.ENGINE)
                                     + "; the rest was checked with engine/include of this project")
            self.headers.roots.append(os.path.join(self.checkout, "engine/include"))
        self.headers.add_support()
        self.find_included(present)

    def lacking_header(self, header, module):
        folders = " or ".join(self.folders[module])
        origin = f"platform trees keep it in {folders}" if folders \
            else "it comes with the engine's vendor"
        return (f"header {header} is missing (module {module}): {origin}"
                f"{self.words.release_note(header)}")

    def find_included(self, present):
        """Each header that is found may include others that are not yet."""
        text = "".join(f"#include <{header}>\n" for header in present)
        lacking, found = self.lacking_of(text)
        while any([self.headers.find(header) for header in lacking]):
            lacking, found = self.lacking_of(text)
        for header in lacking:
            includer = next((self.words.path(path) for path in found
                             if tree_headers.includes(path, header)), "another header")
            self.findings.setdefault(header, f"header {header} is missing, which {includer} "
                                     f"includes{self.headers.generated_note(header)}")

    def lacking_of(self, text):
        """(headers that are not found, files that are): the compiler leaves a
        header that it does not find as it is included."""
        rule = self.clang("-w", "-M", "-MG", "-x", "c++", "-", text=text).stdout
        files = [re.sub(r"\\(.)", r"\1", file) for file in re.findall(
            r"(?:\\.|\S)+", rule.replace("\\\n", " "))][1:]
        return ([file for file in files if not os.path.isabs(file)],
                [file for file in files if os.path.isabs(file)])

    def check_slots(self, operations):
        """What is to be reported of the base class."""
        done = self.clang("-w", "-S", "-emit-llvm", "-o", os.devnull, "-x", "c++", "-",
                          "-Xclang", "-fdump-vtable-layouts", text=tree_slots.probe(operations))
        if done.returncode == 0:
            return list(tree_slots.said_of_slots(operations, done.stdout))
        diagnostics = tree_words.parse(done.stderr)
        said = list(tree_slots.said_of_results(operations, diagnostics))
        if not said:
            self.unseen = diagnostics[0].text if diagnostics else done.stderr.strip()
        return said

    def check_source(self, source):
        """Whether it compiles, what is to be reported of it otherwise."""
        done = self.clang("-fsyntax-only", source)
        everything = tree_words.parse(done.stderr)
        if done.returncode != 0 and not everything:
            return False, [("", f"{source}: {done.stderr.strip()}")]
        diagnostics = list(filter(self.words.concerns_sources, everything))
        if not diagnostics:
            return True, []
        said = [pair for diagnostic in diagnostics for pair in self.words.say(diagnostic)]
        return False, said or [self.words.as_it_is(diagnostics[0])]

    def compile(self, operations):
        """How many sources compile. Of two findings about one name that of
        the base class stays: the other follows from it."""
        with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
            slots = pool.submit(self.check_slots, operations)
            results = list(pool.map(self.check_source, self.sources))
        for said in [slots.result(), *(said for _, said in results)]:
            for name, sentence in said:
                self.findings.setdefault(name, sentence)
        if self.unseen and not self.findings:
            self.findings[tree_words.BASE] = (
                f"the slots of class {tree_words.BASE} could not be seen: {self.unseen}")
        return sum(compiles for compiles, _ in results)


def main(arguments):
    if len(arguments) != 2:
        raise Refusal(__doc__)
    tree = arguments[0]
    if not os.path.isdir(tree):
        why = "not a folder" if os.path.exists(tree) else "there is no such folder"
        raise Refusal(f"{tree}: {why}")
    if shutil.which("clang++") is None:
        raise Refusal("clang++ is not installed; it comes with the package clang")
    check = Check(*arguments)
    check.find_headers()
    operations = tree_slots.read_operations(
        os.path.join(check.checkout, "platform/include", tree_words.BASE_HEADER))
    compiling, total = check.compile(operations), len(check.sources)
    for sentence in check.findings.values():
        print(sentence)
    if check.findings:
        print(f"{tree}: findings: {len(check.findings)}; {compiling} of {total} sources compile")
        return 1
    print(f"{tree}: all {total} sources compile for 32-bit ARM, "
          f"the base class has its {len(operations)} operations in their slots")
    return 0


if __name__ == "__main__":
    refusal.exit_with(main, sys.argv[1:])
