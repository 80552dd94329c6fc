#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""How the product is built: without exceptions and type information, its
names hidden but for a list."""

import json
import re
import unittest

import environment
import elf

# Plain char is unsigned on the target; desktop builds agree.
FLAGS = {"-fno-exceptions", "-fno-rtti", "-funsigned-char", "-fvisibility=hidden",
         "-fvisibility-inlines-hidden"}


class ProductTest(unittest.TestCase):
    def setUp(self):
        self.library = elf.Library(environment.PRODUCT)

    def test_every_source_has_the_flags(self):
        commands = json.loads((environment.BINARY / "compile_commands.json").read_text())
        flags = {command["file"]: set(command["command"].split()) for command in commands}
        for source in environment.cmake_sources():
            missing = FLAGS - flags[str(environment.PRODUCT_SOURCE / source)]
            self.assertEqual(missing, set(), source)

    def test_nothing_handles_exceptions_or_knows_types(self):
        sections = {section.name for section in self.library.elf.iter_sections()}
        self.assertNotIn(".gcc_except_table", sections)
        self.assertNotIn(".ARM.extab", sections)
        names = {symbol.name for table in (".symtab", ".dynsym")
                 for symbol in self.library.symbols(table)}
        foreign = [name for name in names if re.match(
            r"_ZT[IS]|__gxx_personality|__cxa_(throw|begin_catch|rethrow)", name)]
        self.assertEqual(foreign, [])

    def test_every_name_on_the_list_is_exported_and_no_other(self):
        text = (environment.PRODUCT_SOURCE / "mediaplayer_orv.map").read_text()
        # Names stand in quotes as they are, and without them as patterns.
        listed = re.findall(r'^ +(?:"(.*)"|([\w:]+)(\*?));', text.split("local:")[0],
                            re.MULTILINE)
        exported = set(elf.demangled(self.library.exported()).values())
        for quoted, plain, wildcard in listed:
            name = quoted or plain
            matching = {e for e in exported if e == name or wildcard and e.startswith(name)}
            self.assertTrue(matching, f"{name} is listed and not exported")
            exported -= matching
        self.assertEqual(exported, set())


if __name__ == "__main__":
    unittest.main()
