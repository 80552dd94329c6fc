# SPDX-License-Identifier: Apache-2.0
"""Libraries of either architecture, read without running them."""

import collections
import subprocess
import sys

from elftools.common.exceptions import ELFError
from elftools.elf.descriptions import describe_e_machine
from elftools.elf.elffile import ELFFile
from elftools.elf.enums import ENUM_RELOC_TYPE_ARM, ENUM_RELOC_TYPE_x64
from elftools.elf.relocation import RelocationSection
from elftools.elf.sections import SymbolTableSection

import refusal
from refusal import Refusal

ARCHITECTURES = {
    "EM_X86_64": ("x86_64", ENUM_RELOC_TYPE_x64),
    "EM_ARM": ("armhf", ENUM_RELOC_TYPE_ARM),
}


def exit_with(main, *arguments):
    """Ends the program with what main returns, or with 2 for unfit input."""
    try:
        refusal.exit_with(main, *arguments)
    except (ELFError, StopIteration, ValueError, AttributeError) as error:
        print(f"orv: the library is damaged or cut off: {error}", file=sys.stderr)
        sys.exit(2)


def demangled(names):
    """A dictionary from mangled names to readable ones."""
    names = list(names)
    if not names:
        return {}
    done = subprocess.run(["c++filt"], input="\n".join(names), text=True, check=True,
                          stdout=subprocess.PIPE)
    return dict(zip(names, done.stdout.splitlines()))


class Library:
    def __init__(self, path):
        try:
            self.elf = ELFFile(open(path, "rb"))
            machine = self.elf["e_machine"]
        except OSError as error:
            raise Refusal(f"{path}: {error.strerror}") from None
        except ELFError:
            raise Refusal(f"{path}: not an ELF library") from None
        if machine not in ARCHITECTURES:
            raise Refusal(f"{path}: is for {describe_e_machine(machine)}, while the product "
                          "is for 32-bit ARM, and for x86-64 on a desk")
        self.path = path
        self.architecture, reloc_types = ARCHITECTURES[machine]
        self.word = self.elf.elfclass // 8
        self._reloc_names = {number: name for name, number in reloc_types.items()
                             if isinstance(number, int)}
        if self.elf.get_section_by_name(".dynsym") is None:
            raise Refusal(f"{path}: not a shared library")

    def symbols(self, section):
        table = self.elf.get_section_by_name(section)
        return list(table.iter_symbols()) if isinstance(table, SymbolTableSection) else []

    def exported(self):
        """Name to symbol of what other libraries can link to."""
        return {symbol.name: symbol for symbol in self.symbols(".dynsym")
                if symbol["st_shndx"] != "SHN_UNDEF"
                and symbol["st_info"]["bind"] in ("STB_GLOBAL", "STB_WEAK")
                and symbol["st_other"]["visibility"] in ("STV_DEFAULT", "STV_PROTECTED")}

    def undefined(self):
        return [symbol.name for symbol in self.symbols(".dynsym")
                if symbol["st_shndx"] == "SHN_UNDEF" and symbol.name]

    def relocations(self):
        """(place, kind, symbol's name or "", addend or None) of each."""
        dynsym = self.elf.get_section_by_name(".dynsym")
        for section in self.elf.iter_sections():
            if not isinstance(section, RelocationSection):
                continue
            for entry in section.iter_relocations():
                kind = self._reloc_names.get(entry["r_info_type"], str(entry["r_info_type"]))
                name = dynsym.get_symbol(entry["r_info_sym"]).name if entry["r_info_sym"] else ""
                yield entry["r_offset"], kind, name, entry.entry.get("r_addend")

    def relocation_kinds(self):
        return collections.Counter(kind for _, kind, _, _ in self.relocations())

    def read_word(self, address):
        offset = next(self.elf.address_offsets(address, self.word), None)
        if offset is None:
            raise Refusal(f"{self.path}: the library is damaged or cut off")
        self.elf.stream.seek(offset)
        return int.from_bytes(self.elf.stream.read(self.word), "little")

    def functions_by_address(self):
        """Address to name; the bit that marks Thumb code is not part of it."""
        return {symbol["st_value"] & ~1: symbol.name
                for table in (".symtab", ".dynsym") for symbol in self.symbols(table)
                if symbol["st_info"]["type"] == "STT_FUNC"
                and symbol["st_shndx"] not in ("SHN_UNDEF",)}

    def pointers(self, address, count):
        """The functions that so many words point to: names, "" where unknown."""
        relocations = {place: (kind, name, addend)
                       for place, kind, name, addend in self.relocations()}
        functions = self.functions_by_address()
        for place in range(address, address + count * self.word, self.word):
            kind, name, addend = relocations.get(place, ("", "", None))
            if name:
                yield name
            elif kind.endswith("_RELATIVE"):
                target = self.read_word(place) if addend is None else addend
                yield functions.get(target & ~1, "")
            else:
                yield ""

    def slots(self, class_symbol):
        """The functions in a class's table of virtual operations, or None
        when the library does not export the table. Two words of every table
        come before its slots."""
        table = self.exported().get(f"_ZTV{class_symbol}")
        if table is None:
            return None
        return list(self.pointers(table["st_value"] + 2 * self.word,
                                  table["st_size"] // self.word - 2))

    def initialisers(self):
        """The functions that run when the library is loaded, in order."""
        section = self.elf.get_section_by_name(".init_array")
        if section is None:
            return []
        return list(self.pointers(section["sh_addr"], section["sh_size"] // self.word))
