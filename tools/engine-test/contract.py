# SPDX-License-Identifier: Apache-2.0
"""What the headers of an engine say: operations, and the sentences about them."""

import collections
import re

PLAYER = "engine/include/orvtarn/TarnPlayer.h"
OTHERS = ["engine/include/orvtarn/PlayerTypes.h", "engine/include/orvtarn/Parameters.h",
          "engine/include/orvtarn/TrackRecords.h", "engine/include/orvtarn/MediaDescription.h",
          "engine/include/orvtarn/PictureRecords.h", "engine/include/orvtarn/PcmRecords.h",
          "frameworks/playback/MediaPlayer/stream/IOrvStreamSource.h"]
# What rows that are about more than one operation name in its place.
GENERAL = "the player"

# own: sentences right above or behind the declaration; nearby: all from the last empty
# line on.
Operation = collections.namedtuple("Operation", "key own nearby")


class Mismatch(Exception):
    """A row cites what the headers do not say; the text is one line."""


def sentences(comment):
    """The sentences of a comment's lines."""
    text = " ".join(re.sub(r"^\s*// ?", "", line) for line in comment.splitlines())
    text = re.sub(r"\s+", " ", text).strip()
    return [part for part in re.split(r"(?<=\.) ", text) if part]


def operation_key(name, parameters):
    """As docs/engine.md writes it: seekTo(msec, mode)."""
    while "<" in parameters:
        parameters = re.sub(r"<[^<>]*>", "", parameters)
    names = [re.findall(r"\w+", part)[-1] for part in parameters.split(",") if part.strip()]
    return f"{name}({', '.join(names)})"


def operations_of(header):
    """The public operations, in the header's order."""
    body = header.split("class TarnPlayer :")[1].split("protected:")[0].split("public:")[1]
    found, comment, block = [], [], []
    pattern = (r"(?P<comment>(?:[ \t]*//[^\n]*\n)+)|(?P<blank>\n[ \t]*\n)"
               r"|(?P<name>\w+)\((?P<parameters>[^()]*)\)\s*(?:override)?\s*;"
               r"(?:[ \t]*(?P<trailing>//[^\n]*))?")
    for part in re.finditer(pattern, body):
        if part["comment"]:
            comment = sentences(part["comment"])
            block += comment
        elif part["name"]:
            own = comment + sentences(part["trailing"] or "")
            key = operation_key(part["name"], part["parameters"])
            found.append(Operation(key, own, list(block)))
            comment = []
        else:
            comment, block = [], []
    return found


def class_sentences(header):
    """What the comment above the class says, which holds for all operations."""
    above = re.search(r"((?:^//[^\n]*\n)+)class TarnPlayer :", header, re.MULTILINE)
    return sentences(above[1])


def other_sentences(text):
    """Those of a header of records or types; one beside a value begins with its name."""
    found = [f"{name}: {' '.join(sentences(comment))}" for name, comment in
             re.findall(r"^ +(\w+) = [^,\n]*,[ \t]*(//[^\n]*)", text, re.MULTILINE)]
    for block in re.findall(r"((?:^[ \t]*//[^\n]*\n)+)", text, re.MULTILINE):
        found += sentences(block)
    return found


class Contract:
    def __init__(self, root):
        header = (root / PLAYER).read_text(encoding="utf-8")
        self.operations = {operation.key: operation for operation in operations_of(header)}
        self.general = class_sentences(header)
        self.others = [sentence for operation in self.operations.values()
                       for sentence in operation.own]
        self.others += [sentence for name in OTHERS
                        for sentence in other_sentences((root / name).read_text(encoding="utf-8"))]

    def keys(self):
        return [GENERAL, *self.operations]

    def key_of(self, name):
        """The operation that a row names, by its name alone where that is of one."""
        found = [key for key in self.keys() if name in (key, key.split("(")[0])]
        if len(found) != 1:
            raise Mismatch(f"'{name}' names {len(found) or 'no'} operations of {PLAYER}")
        return found[0]

    def sentence(self, name, words):
        """The one sentence with those words, from the nearest place that has them."""
        key = self.key_of(name)
        operation = self.operations.get(key, Operation(key, [], []))
        for place in (operation.own, operation.nearby, self.general, self.others):
            found = [sentence for sentence in dict.fromkeys(place) if words in sentence]
            if len(found) > 1:
                raise Mismatch(f"{key}: {len(found)} sentences of the headers say '{words}'")
            if found:
                return found[0]
        raise Mismatch(f"{key}: the headers do not say '{words}'")
