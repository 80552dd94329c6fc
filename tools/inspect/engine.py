#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""engine.py list PRODUCT ENGINE: what the product needs of an engine library.
engine.py check ENGINE LISTS: which of it ENGINE lacks.

PRODUCT shows what it links to, ENGINE (one that was built from the same
headers) the order of the virtual slots. LISTS is the folder of the lists,
engine.ARCHITECTURE.txt. Ends with 0 when nothing is lacking, 1 when something
is, 2 when the input is unfit."""

import os
import sys

import elf

PLAYER = "N7android10TarnPlayerE"
HOOKS = range(2, 6)  # of reference counting: inherited, or the engine's own


def list_needs(product, engine):
    links = sorted(name for name in elf.Library(product).undefined()
                   if name.startswith("_ZN7android10TarnPlayer"))
    slots = elf.Library(engine).slots(PLAYER)
    if not links or slots is None:
        raise elf.Refusal("these are not the product and an engine that it links to")
    readable = elf.demangled(links + slots)
    print("# What the library needs of the engine: symbols that it links to, and virtual\n"
          "# operations by slot. Written by ./orv abi --accept, checked by a test.")
    for number, name in enumerate(slots):
        print(f"slot {number} {name}  # {readable[name]}")
    for name in links:
        print(f"link {name}  # {readable[name]}")


def read_needs(path):
    """({slot: name}, [linked name])"""
    slots, links = {}, []
    with open(path, encoding="utf-8") as file:
        for line in file:
            words = line.split("#")[0].split()
            if words and words[0] == "slot":
                slots[int(words[1])] = words[2]
            elif words:
                links.append(words[1])
    return slots, links


def operation(readable):
    """A function's name without its class: an engine may override what the
    reference player inherits."""
    return readable[readable[:readable.find("(")].rfind("::") + 2:]


def slot_findings(library, needed):
    exported = library.exported()
    found = library.slots(PLAYER)
    names = elf.demangled(set(needed.values()) | set(filter(None, found or [])))
    for number, name in needed.items():
        here = found[number] if found and number < len(found) else ""
        if here and operation(names[here]) != operation(names[name]):
            yield (f"virtual slot {number} is not {operation(names[name])} but "
                   f"{operation(names[here])}")
        elif not here and number not in HOOKS:
            if name not in exported:
                yield f"virtual slot {number}: {names[name]} is not exported"
            elif found is not None:
                yield f"virtual slot {number} is not {operation(names[name])}"


def check(path, lists):
    library = elf.Library(path)
    slots, links = read_needs(os.path.join(lists, f"engine.{library.architecture}.txt"))
    findings = list(slot_findings(library, slots))
    exported, names = library.exported(), elf.demangled(links)
    for name in links:
        if name not in exported:
            kind = "constructor" if "::TarnPlayer(" in names[name] else "method"
            findings.append(f"{kind}: {names[name]} is not exported")
    for finding in findings:
        print(finding)
    total = f"{len(slots)} virtual slots and {len(links)} functions"
    if findings:
        print(f"{path}: {len(findings)} of the engine's {total} are missing or misplaced"
              f" ({library.architecture})")
        return 1
    unseen = "" if library.slots(PLAYER) else "; its table of slots is not exported, so their " \
        "order could not be seen"
    print(f"{path}: has the engine's {total} ({library.architecture}){unseen}")
    return 0


def main(arguments):
    if len(arguments) == 3 and arguments[0] == "list":
        list_needs(*arguments[1:])
        return 0
    if len(arguments) == 3 and arguments[0] == "check":
        return check(*arguments[1:])
    raise elf.Refusal(__doc__)


if __name__ == "__main__":
    elf.exit_with(main, sys.argv[1:])
