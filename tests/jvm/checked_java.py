#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""Runs Java with -Xcheck:jni and fails for complaints that are not expected.

    checked_java.py EXPECTED JAVA [ARGUMENT]...

EXPECTED has a line for each kind of complaint: the complaint, the place and the reason,
separated by " | ". Complaint and place are patterns of a shell's kind. The place is the
native method in which Java was, or "a native thread". Standard output is passed on; the
exit status is Java's, or 1 when a complaint was not expected.
"""
import fnmatch
import re
import subprocess
import sys
from pathlib import Path

COMPLAINT = re.compile(r"WARNING in native method: (.*)|WARNING: (JNI local refs: .*)")
# Another frame is of a stack that another thread is writing.
FRAME = re.compile(r"\s+at ([\w.$/]+)\([^)]*Native Method\)")
NATIVE_THREAD = "a native thread"
# How far from its first line a complaint's place can be when threads write at a time.
REACH = 6


class Complaints:
    """Finds the complaints in lines of output; the place is None where it was lost."""

    def __init__(self):
        self.found = {}
        self._text = None
        self._left = 0

    def read(self, line):
        complaint = COMPLAINT.search(line)
        if complaint:
            self.end()
            self._text = complaint[1] or complaint[2]
            self._left = REACH
        elif self._text is not None:
            self._look_for_place(line)

    def _look_for_place(self, line):
        frame = FRAME.match(line)
        if frame:
            self._add(frame[1])
        elif line.startswith("Native frames:"):
            self._add(NATIVE_THREAD)
        else:
            self._left -= 1
            if self._left == 0:
                self.end()

    def end(self):
        if self._text is not None:
            self._add(None)

    def _add(self, place):
        key = (self._text, place)
        self.found[key] = self.found.get(key, 0) + 1
        self._text = None


def read_expected(path):
    lines = Path(path).read_text(encoding="utf-8").splitlines()
    rules = [line.split(" | ") for line in lines if line.strip() and not line.startswith("#")]
    for rule in rules:
        if len(rule) != 3:
            sys.exit(f"{path}: a line has a complaint, a place and a reason: {' | '.join(rule)}")
    return [[part.strip() for part in rule] for rule in rules]


def is_expected(complaint, place, rules):
    return any(
        fnmatch.fnmatchcase(complaint, text) and (place is None or fnmatch.fnmatchcase(place, where))
        for text, where, _ in rules
    )


def main():
    if len(sys.argv) < 3:
        sys.exit(__doc__)
    rules = read_expected(sys.argv[1])
    complaints = Complaints()
    with subprocess.Popen(sys.argv[2:], stdout=subprocess.PIPE) as java:
        for line in java.stdout:
            sys.stdout.buffer.write(line)
            sys.stdout.buffer.flush()
            complaints.read(line.decode("utf-8", "replace"))
    complaints.end()
    unexpected = [
        f"{count} times in {place or 'an unknown place'}: {text}"
        for (text, place), count in complaints.found.items()
        if not is_expected(text, place, rules)
    ]
    for line in unexpected:
        print("not expected of -Xcheck:jni:", line)
    if java.returncode < 0:
        print("Java was ended by signal", -java.returncode)
    return java.returncode if java.returncode > 0 else int(bool(unexpected or java.returncode))


if __name__ == "__main__":
    sys.exit(main())
