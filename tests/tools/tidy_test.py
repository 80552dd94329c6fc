#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""The static checks of sources in groups: they find what checks one by one would."""
import contextlib
import importlib.util
import io
import json
import os
import tempfile
import unittest
from importlib.machinery import SourceFileLoader
from pathlib import Path

CLEAN = 'namespace {{\nconst int kSize = {size};\n}}\nint sizeOf{name}() {{ return kSize; }}\n'
OTHER = 'int answer() { return 42; }\n'
FINDING = 'int* nothing() { return 0; }\n'


def load_tool():
    path = str(Path(os.environ['ORV_SOURCE'], 'tools', 'tidy'))
    loader = SourceFileLoader('tidy', path)
    module = importlib.util.module_from_spec(importlib.util.spec_from_loader('tidy', loader))
    loader.exec_module(module)
    return module


class TidyTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = Path(folder.name).resolve()
        (self.folder / '.clang-tidy').write_text(
            "Checks: '-*,modernize-use-nullptr,bugprone-suspicious-include'\n"
            "WarningsAsErrors: '*'\nHeaderFilterRegex: '.*'\n")
        self.tool = load_tool()

    def database(self, name, sources):
        folder = self.folder / name
        folder.mkdir()
        commands = [{'directory': str(self.folder), 'file': str(source),
                     'command': f'c++ -std=c++17 -c {source}'} for source in sources]
        (folder / 'compile_commands.json').write_text(json.dumps(commands))
        return str(folder)

    def run_on(self, **texts):
        """Of one group with these sources: the exit status, what is printed, and the log."""
        sources = []
        for name, text in texts.items():
            sources.append(self.folder / f'{name}.cpp')
            sources[-1].write_text(text)
        group = self.folder / 'unity_0_cxx.cxx'
        group.write_text(''.join(f'#include "{each}"\n\n' for each in sources))
        log = self.folder / 'log'
        printed = io.StringIO()
        with contextlib.redirect_stdout(printed):
            status = self.tool.main([self.database('groups', [group]),
                                     self.database('singles', sources), str(log)])
        return status, printed.getvalue(), log.read_text()

    def test_a_clean_group_is_checked_once(self):
        status, printed, log = self.run_on(one=CLEAN.format(name='One', size=1), other=OTHER)
        self.assertEqual((0, '', ''), (status, printed, log))

    def test_a_finding_is_printed_with_its_place(self):
        status, printed, log = self.run_on(one=CLEAN.format(name='One', size=1), other=FINDING)
        self.assertEqual(1, status)
        self.assertEqual(1, len(printed.splitlines()))
        self.assertIn(f'{self.folder}/other.cpp:1:25: error: use nullptr', printed)
        self.assertIn('use nullptr', log)

    def test_names_that_clash_are_no_finding(self):
        status, printed, log = self.run_on(one=CLEAN.format(name='One', size=1),
                                           two=CLEAN.format(name='Two', size=2))
        self.assertEqual((0, ''), (status, printed))
        self.assertIn("redefinition of 'kSize'", log)

    def test_a_finding_beside_names_that_clash_is_printed(self):
        status, printed, _ = self.run_on(one=CLEAN.format(name='One', size=1), other=FINDING,
                                         two=CLEAN.format(name='Two', size=2))
        self.assertEqual(1, status)
        self.assertEqual(1, len(printed.splitlines()))
        self.assertIn('other.cpp:1:25: error: use nullptr', printed)

    def test_what_does_not_compile_by_itself_is_a_finding(self):
        status, printed, _ = self.run_on(one='int broken() { return missing; }\n')
        self.assertEqual(1, status)
        self.assertIn("use of undeclared identifier 'missing'", printed)


if __name__ == '__main__':
    unittest.main()
