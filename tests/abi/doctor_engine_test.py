#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The doctor's look at an engine library."""

import os
import pathlib
import subprocess
import tempfile
import unittest
from unittest import mock

import environment
import engine

WHOLE = os.environ["ORV_ENGINE_WHOLE"]
LACKING = os.environ["ORV_ENGINE_LACKING"]
SWAPPED = os.environ["ORV_ENGINE_SWAPPED"]


def check(library):
    return environment.run("engine.py", "check", library, environment.SOURCE / "abi")


class DoctorEngineTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def refused(self, library, why):
        self.assertEqual(check(library), (2, [], [f"orv: {library}: {why}"]))

    def test_a_whole_engine_is_clean(self):
        status, lines, _ = check(WHOLE)
        self.assertEqual(status, 0)
        self.assertRegex(lines[-1], r"has the engine's 25 virtual slots and 42 functions")

    def test_missing_symbols_are_named(self):
        status, lines, _ = check(LACKING)
        self.assertEqual(status, 1)
        self.assertEqual(lines[:-1], [
            "method: android::TarnPlayer::setSpeed(int) is not exported",
            "constructor: android::TarnPlayer::TarnPlayer(int) is not exported"])

    # The table still shows what stands in the slot while the file has its symbols.
    def test_a_hidden_virtual_operation_without_a_name_is_missing(self):
        stripped = self.folder / "stripped.so"
        subprocess.run([environment.STRIP, "-o", stripped, LACKING], check=True)
        _, lines, _ = check(stripped)
        self.assertIn("virtual slot 8: android::TarnPlayer::prepare() is not exported", lines)

    def test_swapped_slots_are_named(self):
        status, lines, _ = check(SWAPPED)
        self.assertEqual(status, 1)
        self.assertEqual(lines[:-1], ["virtual slot 10 is not start() but stop()",
                                      "virtual slot 11 is not stop() but start()"])

    # Its operations are exported, but the table does not lead to them.
    def test_a_table_with_gaps_is_told(self):
        needed = engine.read_needs(environment.SOURCE / "abi/engine.x86_64.txt")[0]
        whole = [needed[number] for number in range(len(needed))]

        def findings(slots):
            library = mock.Mock(exported=lambda: set(whole), slots=lambda _: slots)
            return list(engine.slot_findings(library, needed))

        self.assertEqual(findings(whole), [])
        self.assertEqual(len(findings(whole[:20])), len(whole) - 20)
        self.assertEqual(findings(whole[:10] + [""] + whole[11:]),
                         ["virtual slot 10 is not start()"])

    def test_another_library_lacks_everything(self):
        status, lines, _ = check(environment.PRODUCT)
        self.assertEqual(status, 1)
        self.assertEqual(len(lines), 21 + 42 + 1)

    def test_no_library_is_refused(self):
        self.refused(self.folder / "none.so", "No such file or directory")
        text = self.folder / "text.so"
        text.write_text("not a library")
        self.refused(text, "not an ELF library")
        self.refused(self.folder, "Is a directory")

    def test_a_library_of_another_architecture_is_refused(self):
        other = self.folder / "aarch64.so"
        whole = bytearray(pathlib.Path(WHOLE).read_bytes())
        whole[18:20] = (183).to_bytes(2, "little")  # e_machine
        other.write_bytes(whole)
        self.refused(other, "is for AArch64, while the product is for 32-bit ARM, "
                            "and for x86-64 on a desk")

    def test_a_cut_library_is_refused(self):
        whole = pathlib.Path(WHOLE).read_bytes()
        for length in (20, 100, len(whole) // 2, len(whole) - 100):
            cut = self.folder / f"cut{length}.so"
            cut.write_bytes(whole[:length])
            status, lines, errors = check(cut)
            self.assertEqual((status, lines, len(errors)), (2, [], 1), length)


if __name__ == "__main__":
    unittest.main()
