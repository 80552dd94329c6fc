#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""java_api.py check|accept MODULES DESCRIPTION [--java PROGRAM]: the public Java API.

Compares what the Java modules show to everybody with DESCRIPTION, which is
abi/java-api.txt, or writes that anew. MODULES names their JARs and those that
they need, one a line: "described JAR" or "needed JAR". Ends with 0 when nothing
differs, 1 when something does, 2 when the input is unfit."""

import argparse
import pathlib
import subprocess
import sys

import refusal
from refusal import Refusal

HERE = pathlib.Path(__file__).parent
HEAD = """# What the Java modules show to programs. Written by ./orv abi --accept, checked by
# the test abi.java_api.
"""


def arguments():
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("mode", choices=["check", "accept"])
    parser.add_argument("modules", type=pathlib.Path)
    parser.add_argument("description", type=pathlib.Path)
    parser.add_argument("--java", default="java", metavar="PROGRAM")
    return parser.parse_args()


def read(path):
    try:
        return path.read_text("utf-8")
    except OSError as error:
        raise Refusal(f"{path}: {error.strerror}") from None


def read_jars(path):
    """(the described JARs, those that they need)"""
    jars = {"described": [], "needed": []}
    for number, line in enumerate(read(path).splitlines(), 1):
        role, _, jar = line.partition(" ")
        if role not in jars or not jar:
            raise Refusal(f"{path}:{number}: not 'described JAR' or 'needed JAR'")
        if not pathlib.Path(jar).is_file():
            raise Refusal(f"{jar}: not built yet")
        jars[role].append(jar)
    if not jars["described"]:
        raise Refusal(f"{path}: names no JAR to describe")
    return jars["described"], jars["needed"]


def describe(java, described, needed):
    """The API's lines, sorted."""
    try:
        done = subprocess.run([java, HERE / "JavaApi.java", *described, "--", *needed],
                              capture_output=True, encoding="utf-8", check=False)
    except OSError as error:
        raise Refusal(f"{java}: {error.strerror}") from None
    if done.returncode != 0:
        raise Refusal(f"the Java API cannot be read: {done.stderr.strip()}")
    return done.stdout.splitlines()


def compare(recorded, found):
    """Prints what is gone and what is new; whether nothing is."""
    changes = [f"gone: {line}" for line in recorded if line not in found]
    changes += [f"new:  {line}" for line in found if line not in recorded]
    print("\n".join(changes), end="\n" if changes else "")
    return not changes


def main():
    chosen = arguments()
    found = describe(chosen.java, *read_jars(chosen.modules))
    if chosen.mode == "accept":
        chosen.description.write_text(HEAD + "".join(f"{line}\n" for line in found), "utf-8")
        return 0
    recorded = [line for line in read(chosen.description).splitlines()
                if not line.startswith("#")]
    if compare(recorded, found):
        return 0
    print("orv: the public Java API is not that of abi/java-api.txt; if the change is meant, "
          "./orv abi --accept records it.", file=sys.stderr)
    return 1


if __name__ == "__main__":
    refusal.exit_with(main)
