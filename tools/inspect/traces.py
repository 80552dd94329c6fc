#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""traces.py FOLDER [METHOD…]

Prints what native methods do to the world around the library, step by step, as
the tests hold it: for each method the order of log lines, calls of the virtual
machine, Java methods, operations of the engine and exceptions, once for each way
that a test saw it go, with a test that shows it. A METHOD is a name, or a part of
one; without any, all methods are printed.
"""
import collections
import pathlib
import sys


def paragraphs(file):
    """Each call of a file: its test, its title and its steps."""
    test, title, steps = "", "", []
    for line in file.read_text(encoding="utf-8").splitlines():
        if line.startswith("    "):
            steps.append(line)
            continue
        if title:
            yield test, title, tuple(steps)
        title, steps = "", []
        if line.startswith("== "):
            test = line[3:]
        else:
            title = line
    if title:
        yield test, title, tuple(steps)


def traces(folder):
    """Of each title, by its name, each sequence with the tests that show it."""
    found = collections.defaultdict(lambda: collections.defaultdict(list))
    for file in sorted(folder.glob("*.txt")):
        for test, title, steps in paragraphs(file):
            if not title.startswith(("native_", "JNI_OnLoad")):
                continue  # of a part of the library, or of a failure
            tests = found[title][steps]
            if test not in tests:
                tests.append(test)
    return found


def main(arguments):
    if not arguments:
        sys.exit(__doc__)
    found = traces(pathlib.Path(arguments[0]))
    if not found:
        sys.exit(f"traces: no traces in {arguments[0]}")
    for part in arguments[1:]:
        if not any(part in title for title in found):
            sys.exit(f"traces: no native method with '{part}' in its name")
    wanted = [
        title
        for title in sorted(found)
        if not arguments[1:] or any(part in title for part in arguments[1:])
    ]
    for title in wanted:
        print(f"{title}    {len(found[title])} ways")
        for steps, tests in found[title].items():
            more = f" and {len(tests) - 1} more" if len(tests) > 1 else ""
            print(f"  {tests[0]}{more}")
            print("\n".join(steps) if steps else "    nothing")
        print()


if __name__ == "__main__":
    try:
        main(sys.argv[1:])
    except BrokenPipeError:
        sys.stderr.close()
