#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""size.py LIB [--strip COMMAND] [--budget BYTES]: what a library costs.

Lists the size of the stripped file, the relocations by kind and the start-up
work: each static initialiser in order with the objects that it makes. Ends
with 1 when the file is larger than the budget or the initialisers are others
than EXPECTED."""

import argparse
import os
import re
import subprocess
import sys
import tempfile

import elf

# Made in this order when the library is loaded, and nothing else.
EXPECTED = ["android::(anonymous namespace)::sServiceLock", "ORV::SyncToAsync::s_mutexGlobal"]
# The C runtime's own entry in every library.
RUNTIME = "frame_dummy"

TOOLS = {"armhf": "arm-linux-gnueabihf-", "x86_64": ""}


def stripped_size(library, strip):
    with tempfile.TemporaryDirectory() as folder:
        out = os.path.join(folder, "stripped")
        try:
            subprocess.run([strip, "-o", out, library.path], check=True)
        except (OSError, subprocess.CalledProcessError) as error:
            raise elf.Refusal(f"{library.path} could not be stripped: {error}") from None
        return os.path.getsize(out)


def objects_by_address(library):
    return {symbol["st_value"]: symbol.name for symbol in library.symbols(".symtab")
            if symbol["st_info"]["type"] == "STT_OBJECT" and symbol["st_size"]
            and symbol.name != "__dso_handle"}


def addresses_in(library, code):
    """Every address that a function's code forms, as far as its text shows."""
    # x86-64: the disassembler works the addresses out.
    for address in re.findall(r"# ([0-9a-f]+) <", code):
        yield int(address, 16)
    # ARM: a word behind the code and the instruction that adds where it is,
    # or an offset into the table of addresses.
    words = [int(word, 16) for word in re.findall(r"\.word\t0x([0-9a-f]+)", code)]
    adders = [int(place, 16) + 4
              for place in re.findall(r"^ *([0-9a-f]+):.*\tadd\tr\d+, pc", code, re.MULTILINE)]
    table = library.elf.get_section_by_name(".got")["sh_addr"]
    for word in words:
        for place in adders:
            yield (word + place) & 0xFFFFFFFF
        if library.architecture == "armhf" and word < 0x10000:
            try:
                yield library.read_word(table + word)
            except elf.Refusal:
                pass


def objects_made(library, function):
    tool = TOOLS[library.architecture] + "objdump"
    code = subprocess.run([tool, "-d", f"--disassemble={function}", library.path], text=True,
                          check=True, stdout=subprocess.PIPE).stdout
    objects = objects_by_address(library)
    return [objects[address] for address in dict.fromkeys(addresses_in(library, code))
            if address in objects]


def start_up(library):
    """(function, [objects]) of each initialiser, readable."""
    work = [(function, objects_made(library, function))
            for function in library.initialisers() if function != RUNTIME]
    names = elf.demangled(name for _, made in work for name in made)
    return [(function, [names[name] for name in made]) for function, made in work]


def report(library, size, budget, work):
    limit = f" of {budget}" if budget else ""
    print(f"{library.path} ({library.architecture})")
    print(f"  stripped file   {size} bytes{limit}")
    kinds = library.relocation_kinds()
    print(f"  relocations     {sum(kinds.values())}")
    for kind, count in kinds.most_common():
        print(f"    {count:5} {kind}")
    print(f"  start-up work   {len(work)} static initialisers")
    for function, made in work:
        print(f"    {', '.join(made) or 'unknown objects'}  ({function})")


def main():
    parser = argparse.ArgumentParser(description="What a library costs.")
    parser.add_argument("library")
    parser.add_argument("--strip", help="the command that strips it")
    parser.add_argument("--budget", type=int, help="largest stripped size in bytes")
    options = parser.parse_args()
    library = elf.Library(options.library)
    size = stripped_size(library, options.strip or TOOLS[library.architecture] + "strip")
    work = start_up(library)
    report(library, size, options.budget, work)
    failed = False
    if options.budget and size > options.budget:
        print(f"orv: {size - options.budget} bytes over the budget", file=sys.stderr)
        failed = True
    if [made for _, made in work] != [[name] for name in EXPECTED]:
        print(f"orv: the static initialisers must be those of {' and '.join(EXPECTED)}, in this"
              " order, and no other", file=sys.stderr)
        failed = True
    return 1 if failed else 0


if __name__ == "__main__":
    elf.exit_with(main)
