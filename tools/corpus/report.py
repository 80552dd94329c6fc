# SPDX-License-Identifier: Apache-2.0
"""Prints what was found, for people and for programs."""

import dataclasses
import json
import os

from compare import KINDS


class Report:
    def __init__(self, examinations, limit):
        self.names = sorted(e.name for e in examinations)
        self.limit = limit
        self.differences = sorted(
            (d for e in examinations for d in e.differences),
            key=lambda d: (KINDS.index(d.kind), d.file, d.where))
        self.notes = {e.name: e.notes for e in examinations if e.notes}

    def counts(self):
        """How many there are of each kind that was found, worst first."""
        kinds = [d.kind for d in self.differences]
        return {kind: kinds.count(kind) for kind in KINDS if kind in kinds}

    def table(self):
        """Lines: the differences, worst first, then the sum."""
        rows = [("", "file", "command", "here", "ffprobe, ffmpeg")]
        rows += [(d.kind, d.file, d.where, d.ours, d.theirs) for d in self.differences]
        rows = [tuple(map(printable, row)) for row in rows]
        widths = [max(len(row[column]) for row in rows) for column in range(4)]
        lines = ["  ".join([f"{text:{width}}" for text, width in zip(row, widths)] + [row[4]])
                 .rstrip() for row in rows]
        return (lines if self.differences else []) + [self.sum()]

    def sum(self):
        differing = len({d.file for d in self.differences})
        counts = ", ".join(f"{count} x {kind}" for kind, count in self.counts().items())
        return f"{len(self.names)} files, {differing} differ" + (f": {counts}" if counts else "")

    def write(self, path):
        """All of it as JSON; the file appears whole."""
        content = {
            "files": self.names,
            "limitSeconds": self.limit,
            "counts": self.counts(),
            "differences": [dataclasses.asdict(d) for d in self.differences],
            "notCompared": self.notes,
        }
        draft = f"{path}.part"
        try:
            with open(draft, "w", encoding="utf-8", errors="backslashreplace") as file:
                json.dump(content, file, indent=2, ensure_ascii=False)
                file.write("\n")
            os.replace(draft, path)
        finally:
            if os.path.exists(draft):
                os.remove(draft)


def printable(text):
    """On one line, without anything that a terminal would take for a command."""
    return "".join(c if c.isprintable() else c.encode("unicode_escape", "surrogatepass").decode()
                   for c in text)
