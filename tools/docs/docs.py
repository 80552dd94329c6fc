#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""docs.py [--javadoc PROGRAM] ROOT OUT: the documentation of ROOT as a site.

Writes OUT/site and, as they are not fetched, the addresses that it links to
into OUT/external-links.txt. Exit status: 0, or 1 when a link, a diagram or a
Javadoc comment is broken, which stand on standard error as FILE:LINE: what."""

import argparse
import pathlib
import shutil
import sys

import api
import links
import pages
from problem import Problem


def arguments():
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("--javadoc", default="javadoc", metavar="PROGRAM")
    parser.add_argument("root", type=pathlib.Path)
    parser.add_argument("out", type=pathlib.Path)
    return parser.parse_args()


def build(root, out, javadoc):
    """The number of pages, of links and of external addresses."""
    site = out / "site"
    shutil.rmtree(site, ignore_errors=True)
    site.mkdir(parents=True)
    modules = api.find_modules(root)
    api.build(javadoc, root, modules, site)
    written = pages.build(root, modules, site)
    found = written.references + links.references_of(site, skip=written.files)
    problems = links.check(site, found)
    if problems:
        raise Problem(problems)
    external = links.external(found)
    (out / "external-links.txt").write_text("".join(f"{line}\n" for line in external), "utf-8")
    return len(written.files), len(found), len(external)


def main():
    chosen = arguments()
    root, out = chosen.root.resolve(), chosen.out.resolve()
    try:
        count, link_count, external = build(root, out, chosen.javadoc)
    except Problem as problem:
        print(problem, file=sys.stderr)
        return 1
    print(f"{out / 'site/index.html'}: {count} pages and the Javadoc, {link_count} links checked; "
          f"{external} external addresses are in {out / 'external-links.txt'}")
    return 0


if __name__ == "__main__":
    sys.exit(main())
