#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The check of counts, with counts made up: what it lets pass and what it finds."""

import contextlib
import io
import os
import pathlib
import subprocess
import sys
import tempfile
import unittest
from unittest import mock

TOOLS = pathlib.Path(os.environ["ORV_SOURCE"]) / "tools"
sys.path[:0] = [str(TOOLS / "counts"), str(TOOLS / "inspect")]

import callgrind
import counts
import table
from refusal import Refusal

COLUMN = "x86_64 GCC 12 glibc 2.36"
HELD = {"position": 1000, "load": 35, "initialisers": 0}


class CheckTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.path = os.path.join(folder.name, "counts.txt")
        table.write(self.path, {COLUMN: HELD, "armhf GCC 12": {"relocations": 400}})

    def run_mode(self, mode, found, column=COLUMN):
        """(status, lines of standard output, lines of standard error)"""
        out, err = io.StringIO(), io.StringIO()
        with contextlib.redirect_stdout(out), contextlib.redirect_stderr(err):
            status = mode(self.path, column, found)
        return status, out.getvalue().splitlines(), err.getvalue().splitlines()

    def check(self, found, column=COLUMN):
        return self.run_mode(counts.check, found, column)

    def found(self, expected, found):
        status, _, said = self.check(found)
        self.assertEqual((status, said[:-1]), (1, [f"orv: {expected}"]))
        self.assertIn("./orv counts --accept", said[-1])

    def test_the_same_counts_pass(self):
        status, shown, said = self.check(HELD)
        self.assertEqual((status, said), (0, []))
        self.assertEqual(shown[0], COLUMN)
        self.assertRegex(shown[2], r"^position +1000 +1000  =$")

    def test_three_percent_more_pass(self):
        status, shown, _ = self.check({**HELD, "position": 1030})
        self.assertEqual(status, 0)
        self.assertRegex(shown[2], r"^position +1030 +1000  \+3\.0 %$")

    def test_one_instruction_beyond_three_percent_fails(self):
        self.found("position has grown from 1000 to 1031, by more than 3 %",
                   {**HELD, "position": 1031})

    def test_small_counts_are_held_as_well(self):
        self.assertEqual(self.check({**HELD, "load": 36})[0], 0)
        self.found("load has grown from 35 to 37, by more than 3 %", {**HELD, "load": 37})

    def test_something_in_place_of_nothing_fails(self):
        self.found("initialisers has grown from 0 to 1, by more than 3 %",
                   {**HELD, "initialisers": 1})

    def test_fewer_pass(self):
        self.assertEqual(self.check({**HELD, "position": 500})[0], 0)

    def test_a_missing_row_fails(self):
        self.found("load is held and was not counted", {"position": 1000, "initialisers": 0})

    def test_an_unknown_row_fails(self):
        self.found("another is not held", {**HELD, "another": 1})

    def test_another_compiler_is_skipped_and_said(self):
        status, shown, said = self.check(HELD, "x86_64 GCC 13 glibc 2.38")
        self.assertEqual(status, 77)
        self.assertRegex(shown[2], r"^position +1000 +-  not held$")
        self.assertEqual(said, ["orv: not held here: there are no counts of"
                                " x86_64 GCC 13 glibc 2.38 to compare with"])

    def test_what_is_accepted_is_held_from_then_on(self):
        grown = {"position": 2000, "other": 1}
        self.assertEqual(self.run_mode(counts.accept, grown)[0], 0)
        self.assertEqual(table.read(self.path),
                         {COLUMN: grown, "armhf GCC 12": {"relocations": 400}})
        self.assertEqual(self.check(grown)[0], 0)

    def test_a_first_column_makes_the_file(self):
        os.remove(self.path)
        self.run_mode(counts.accept, HELD)
        self.assertEqual(table.read(self.path), {COLUMN: HELD})

    def test_damaged_files_are_refused(self):
        for text, why in (
                ("position 1", ":1: neither a column nor a row and its count"),
                ("column a\nposition\n", ":2: neither a column nor a row and its count"),
                ("column a\nposition x\n", ":2: neither a column nor a row and its count"),
                ("column a\nposition 1\nposition 2\n", ":3: position 2 stands there twice"),
                ("column a\ncolumn a\n", ":2: column a stands there twice")):
            pathlib.Path(self.path).write_text(text, encoding="utf-8")
            with self.assertRaises(Refusal) as refused:
                table.read(self.path)
            self.assertEqual(str(refused.exception), self.path + why)
        os.remove(self.path)
        with self.assertRaises(Refusal):
            table.read(self.path)


PROFILE = """\
events: Ir

ob=/lib/libproduct.so
fn=product
10 100
cob=/usr/lib/libc.so.6
cfn=memcpy
calls=2 0
11 3000
cob=/bin/program
cfn=fake
calls=1 0
12 50000
cfn=inside
calls=1 0
13 20

fn=inside
13 20

ob=/bin/program
fn=fake
1 600000
cob=/usr/lib/libc.so.6
cfn=memcpy
calls=1 0
1 7000000

ob=/usr/lib/libc.so.6
fn=memcpy
0 80000000
"""


class ProfileTest(unittest.TestCase):
    def test_the_product_and_what_it_has_the_c_library_do_count(self):
        self.assertEqual(callgrind.count(PROFILE, "/lib/libproduct.so"),
                         100 + 3000 + 20)

    def test_a_profile_without_the_product_is_refused(self):
        with self.assertRaises(Refusal):
            callgrind.count(PROFILE, "/lib/libother.so")

    def test_a_profile_without_counts_is_refused(self):
        with self.assertRaises(Refusal):
            callgrind.count("", "/lib/libproduct.so")

    def test_ten_entries_less_none_are_one_row(self):
        times = callgrind.TIMES
        self.assertEqual(callgrind.rows_of({"track/10": 1200 * times, "track/0": 200 * times,
                                            "load": 35 * times}), {"track": 100, "load": 35})

    def test_a_program_that_fails_is_refused(self):
        with self.assertRaisesRegex(Refusal, "there is no such path"):
            callgrind.profile_of(["/bin/sh", "-c", "echo there is no such path >&2; exit 1"])

    def test_a_machine_without_valgrind_is_refused(self):
        with mock.patch.object(callgrind, "VALGRIND", ["no-such-valgrind"]), \
                self.assertRaisesRegex(Refusal, "no-such-valgrind is not installed"):
            callgrind.profile_of(["true"])


class MeasureTest(unittest.TestCase):
    def test_a_path_without_its_counterpart_is_refused(self):
        with self.assertRaisesRegex(Refusal, "track/10 has no track/0"):
            callgrind.rows_of({"track/10": 1})

    def test_a_program_that_cannot_be_run_is_refused(self):
        with self.assertRaisesRegex(Refusal, "Permission denied"):
            callgrind.measure("/dev/null", "/dev/null")


class CommandTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.path = os.path.join(folder.name, "counts.txt")

    def run_tool(self, mode, library=os.environ["ORV_PRODUCT"]):
        """(status, lines of standard error)"""
        done = subprocess.run([TOOLS / "counts/counts.py", mode, self.path, "library", library],
                              capture_output=True, text=True)
        return done.returncode, done.stderr.splitlines()

    def test_a_library_that_has_grown_since_it_was_accepted_fails(self):
        self.assertEqual(self.run_tool("accept"), (0, []))
        self.assertEqual(self.run_tool("check"), (0, []))
        held = table.read(self.path)
        (column, rows), = held.items()
        now = rows["relocations"]
        rows["relocations"] = then = now * 100 // 104
        table.write(self.path, held)
        status, said = self.run_tool("check")
        self.assertEqual((status, said[0]), (
            1, f"orv: relocations has grown from {then} to {now}, by more than 3 %"))
        table.write(self.path, {"another compiler": rows})
        self.assertEqual(self.run_tool("check"), (77, [
            f"orv: not held here: there are no counts of {column} to compare with"]))

    def test_unfit_input_is_refused(self):
        self.assertEqual(self.run_tool("check"), (2, [
            f"orv: {self.path}: No such file or directory"]))
        self.assertEqual(self.run_tool("accept", __file__), (2, [
            f"orv: {__file__}: not an ELF library"]))
        self.assertFalse(os.path.exists(self.path))


if __name__ == "__main__":
    unittest.main()
