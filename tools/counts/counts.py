#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""counts.py check|accept HELD paths PROGRAM PRODUCT
counts.py check|accept HELD library LIB [--strip COMMAND]

Counts the instructions of the product's hottest paths (PROGRAM takes them,
PRODUCT is the library that it links to), or the bytes, relocations and
initialisers of LIB; prints them beside those that the file HELD holds for the
same compiler, or records them there. A check ends with 0 when nothing has grown
by more than 3 %, 1 when something has or a row is missing or unknown, 77 when
nothing is held of that compiler, 2 when the input is unfit."""

import argparse
import os
import re
import sys

sys.path.insert(1, os.path.join(os.path.dirname(os.path.realpath(__file__)), "../inspect"))

import elf
import size

import callgrind
import table

NOT_HELD = 77


def compiler(library):
    """As in "GCC 12"."""
    section = library.elf.get_section_by_name(".comment")
    text = section.data().decode("ascii", "replace") if section is not None else ""
    found = re.search(r"(GCC): .* (\d+)\.[\d.]+\0", text)
    return " ".join(found.groups()) if found else "another compiler"


def count_paths(options):
    """The column's name and its rows."""
    product = elf.Library(options.product)
    name = f"{product.architecture} {compiler(product)} {os.confstr('CS_GNU_LIBC_VERSION')}"
    return name, callgrind.measure(options.program, options.product)


def count_library(options):
    library = elf.Library(options.library)
    strip = options.strip or size.TOOLS[library.architecture] + "strip"
    return f"{library.architecture} {compiler(library)}", {
        "stripped_bytes": size.stripped_size(library, strip),
        "relocations": sum(library.relocation_kinds().values()),
        "initialisers": sum(name != size.RUNTIME for name in library.initialisers()),
    }


def check(path, column, counts):
    held = table.read(path).get(column)
    print(column, *table.lines(counts, held), sep="\n")
    if held is None:
        print(f"orv: not held here: there are no counts of {column} to compare with",
              file=sys.stderr)
        return NOT_HELD
    findings = list(table.findings(counts, held))
    for finding in findings:
        print(f"orv: {finding}", file=sys.stderr)
    if findings:
        print("orv: if the change is meant, ./orv counts --accept records it", file=sys.stderr)
    return 1 if findings else 0


def accept(path, column, counts):
    columns = table.read(path) if os.path.exists(path) else {}
    print(column, *table.lines(counts, columns.get(column)), sep="\n")
    columns[column] = counts
    table.write(path, columns)
    return 0


def main():
    parser = argparse.ArgumentParser(description="What the library's hottest paths cost.")
    parser.add_argument("mode", choices=["check", "accept"])
    parser.add_argument("held")
    kinds = parser.add_subparsers(required=True)
    paths = kinds.add_parser("paths")
    paths.add_argument("program")
    paths.add_argument("product")
    paths.set_defaults(count=count_paths)
    library = kinds.add_parser("library")
    library.add_argument("library")
    library.add_argument("--strip", help="the command that strips it")
    library.set_defaults(count=count_library)
    options = parser.parse_args()
    return {"check": check, "accept": accept}[options.mode](options.held, *options.count(options))


if __name__ == "__main__":
    elf.exit_with(main)
