# SPDX-License-Identifier: Apache-2.0
"""A mutant: one small change of one source file."""

import dataclasses
import difflib
import re


class Failed(Exception):
    """What keeps the whole run from going on, in one sentence."""


@dataclasses.dataclass(frozen=True)
class Mutant:
    area: str  # product, engine or java
    file: str  # from the top of the sources
    function: str  # with its class; empty outside of one
    operator: str
    line: int  # of the change, from 1
    start: int  # the bytes of the file that are replaced
    end: int
    text: str  # what they are
    becomes: str
    first_line: int  # of the function
    last_line: int
    number: int = 1  # among those alike in all but their place

    def identity(self):
        """What stays the same when lines move."""
        return (self.file, self.function, self.operator, squeeze(self.text),
                squeeze(self.becomes), self.number)

    def apply(self, source):
        """The file's bytes with the change."""
        return source[:self.start] + self.becomes.encode() + source[self.end:]

    def place(self):
        return f"{self.file}:{self.line}"

    def diff(self, source):
        """The lines that differ, each with - or + in front, between their neighbours."""
        before = source.decode().splitlines()
        after = self.apply(source).decode().splitlines()
        lines = list(difflib.unified_diff(before, after, n=1, lineterm=""))[2:]
        return [line for line in lines if not line.startswith("@@")]


def squeeze(text):
    """With one blank for each run of white space."""
    return re.sub(r"\s+", " ", text).strip()


def numbered(mutants):
    """In the order of the files, those alike numbered from 1."""
    ordered = sorted(set(mutants), key=lambda m: (m.file, m.start, m.end, m.operator, m.becomes))
    seen, result = {}, []
    for mutant in ordered:
        identity = mutant.identity()
        seen[identity] = seen.get(identity, 0) + 1
        result.append(dataclasses.replace(mutant, number=seen[identity]))
    return result
