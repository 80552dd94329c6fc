# SPDX-License-Identifier: Apache-2.0
"""The virtual slots of a tree's MediaPlayerBase, compared with those of
platform/include/media/MediaPlayerInterface.h."""

import collections
import re

from tree_words import BASE, BASE_HEADER

Operation = collections.namedtuple("Operation", "slot name declaration")
Entry = collections.namedtuple("Entry", "owner name signature")
FIRST = 6  # behind two destructors and four hooks of reference counting


def read_operations(path):
    """The base class's operations in the order of their slots."""
    with open(path, encoding="utf-8") as file:
        body = file.read().split(f"class {BASE} ")[1].split("class Listener", 1)[1]
    declared = re.findall(r"^    (virtual .*?(\w+)\(.*\)) = 0;", body, re.MULTILINE)
    return [Operation(FIRST + number, name, declaration)
            for number, (declaration, name) in enumerate(declared)]


def probe(operations):
    """A class that overrides them all. What the base class lacks stands in new
    slots of it, behind those of the base class."""
    body = "".join(f"    {operation.declaration};\n" for operation in operations)
    return (f"#include <{BASE_HEADER}>\n#include <utils/SortedVector.h>\n"
            "namespace android {\nclass IGraphicBufferProducer;\nclass Parcel;\n"
            f"struct SlotProbe : {BASE} {{\n    SlotProbe();\n{body}}};\n"
            "SlotProbe::SlotProbe() {}\n}\n")


def entries(dump, name):
    """The entries of a class in what -fdump-vtable-layouts prints."""
    table = re.search(rf"^Vtable for 'android::{name}' .*\n((?:.+\n)*)", dump,
                      re.MULTILINE | re.IGNORECASE)
    found = []
    for text in re.findall(r"^ +\d+ \| (.*)$", table.group(1), re.MULTILINE)[2:] if table else ():
        match = re.match(r".*?([\w:]*)::(~?\w+)(\(.*)$", text.replace("android::", ""))
        if match is None:
            break  # a second table, of a further base class
        found.append(Entry(match.group(1), match.group(2), match.group(2)
                           + match.group(3).replace(" [pure]", "")))
    return found


def said_of_slots(operations, dump):
    """(name, sentence) of each operation that is not in its slot."""
    size = len(entries(dump, BASE))
    found = entries(dump, "SlotProbe")
    slots = {entry.name: slot for slot, entry in enumerate(found[:size])
             if entry.owner == "SlotProbe"}
    others = {slot: entry for slot, entry in enumerate(found[:size])
              if entry.owner != "SlotProbe" and slot >= FIRST}
    lacking = [operation for operation in operations if operation.name not in slots]
    yield from said_of_lacking(lacking, others)
    changed = {operation.name for operation in lacking}
    last = max(slots.values(), default=0)
    further = [(slot, entry) for slot, entry in others.items()
               if entry.name not in changed and slot < last]
    seen = set()
    for slot, entry in further:
        # Of several with one name, the first stands for what follows from it.
        yield entry.signature if entry.name in seen else entry.name, (
            f"class {BASE} has an operation more, {entry.signature}, in virtual slot {slot}: "
            "those behind it are a slot too far back")
        seen.add(entry.name)
    yield from said_of_order([operation for operation in operations if operation.name in slots],
                             slots, lacking or further)


def said_of_lacking(lacking, others):
    for operation in lacking:
        instead = [entry.signature for entry in others.values() if entry.name == operation.name]
        what = f"operation {operation.name} of class {BASE} is {' and '.join(instead)}" \
            if instead else f"class {BASE} has no operation {operation.name}"
        yield operation.name, f"{what}; {expected(operation)}"


def expected(operation):
    return f"expected in virtual slot {operation.slot}: {operation.declaration} = 0"


def said_of_order(present, slots, shifted):
    """Where operations are lacking or added, only their order is looked at."""
    in_order = sorted(slots[operation.name] for operation in present)
    if not shifted:
        in_order = [operation.slot for operation in present]
    names = {slot: name for name, slot in slots.items()}
    for slot, operation in zip(in_order, present):
        if slots[operation.name] != slot:
            yield f"slot {slot}", (f"virtual slot {slot} of class {BASE} is "
                                   f"{names.get(slot, 'another operation')}, not {operation.name}")


def said_of_results(operations, diagnostics):
    """The compiler shows no slots when an operation's result has another type."""
    for diagnostic in diagnostics:
        match = re.match(r"virtual function '(\w+)' has a different return type \(.*\) than the "
                         r"function it overrides \(which has return type '(.+?)'", diagnostic.text)
        for operation in operations if match else ():
            if operation.name == match.group(1):
                yield operation.name, (f"operation {operation.name} of class {BASE} returns "
                                       f"{match.group(2)}; {expected(operation)}")
