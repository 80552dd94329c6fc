#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The engine suite: its rows are the header's, the desktop's engine passes all of it, and
engines with a fault fail where the fault is."""

import json
import os
import pathlib
import shutil
import signal
import subprocess
import sys
import tempfile
import unittest
import xml.etree.ElementTree as ElementTree

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
BINARY = pathlib.Path(os.environ["ORV_BINARY"])
FAULTY = pathlib.Path(os.environ["ORV_FAULTY"])
TOOL = SOURCE / "tools/engine-test/engine_test.py"
KIT = BINARY / "engine-kit.json"
MEDIA = BINARY / "media"
FILM = "pattern://10"
# Emulated rows take their time.
LIMIT = 240 if json.loads(KIT.read_text())["emulator"] else 90

sys.path.insert(0, str(SOURCE / "tools/engine-test"))
import contract  # noqa: E402
import rows  # noqa: E402


def run(engine, *options, media=MEDIA, limit=LIMIT):
    """(status, standard output, standard error)"""
    done = subprocess.run(
        [TOOL, "run", engine, "--kit", KIT, "--media", media, "--limit", str(limit), *options],
        capture_output=True, text=True)
    return done.returncode, done.stdout, done.stderr


def results(engine, *options, limit=LIMIT):
    """(status, {test: result}, what was said of each that did not pass)"""
    with tempfile.TemporaryDirectory() as folder:
        file = pathlib.Path(folder) / "results.json"
        status, output, error = run(engine, *options, "--json", file, limit=limit)
        if not file.exists():
            raise AssertionError(output + error)
        listed = json.loads(file.read_text(encoding="utf-8"))["rows"]
    said = {row["test"]: row["said"] for row in listed if row["said"]}
    return status, {row["test"]: row["result"] for row in listed}, said


def child_with(parent, argument):
    """The number of the process's child that has the argument; None without one."""
    for file in pathlib.Path(f"/proc/{parent}/task").glob("*/children"):
        try:
            for child in file.read_text().split():
                words = pathlib.Path(f"/proc/{child}/cmdline").read_bytes().split(b"\0")
                if argument.encode() in words:
                    return child
        except OSError:
            continue  # it has ended meanwhile
    return None


def tests_with(result, found):
    return {test for test, of in found.items() if of == result}


class ContractTest(unittest.TestCase):
    def changed_tree(self, before, after):
        """The headers and the rows with a change in the player's header."""
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        root = pathlib.Path(folder.name)
        for name in [contract.PLAYER, *contract.OTHERS]:
            (root / name).parent.mkdir(parents=True, exist_ok=True)
            shutil.copy(SOURCE / name, root / name)
        shutil.copytree(SOURCE / rows.FOLDER, root / rows.FOLDER)
        header = root / contract.PLAYER
        text = header.read_text(encoding="utf-8")
        self.assertIn(before, text)
        header.write_text(text.replace(before, after), encoding="utf-8")
        return root

    def test_every_operation_has_rows_of_its_own_sentences(self):
        self.assertEqual(rows.without_row(SOURCE), [])

    def test_an_operation_more_lacks_its_row(self):
        root = self.changed_tree("bool step(int amount);",
                                 "bool step(int amount);\n    bool leap(int amount);")
        self.assertEqual(rows.without_row(root), ["leap(amount)"])

    def test_an_operation_less_is_a_mismatch(self):
        with self.assertRaisesRegex(contract.Mismatch, "'step' names no operations"):
            rows.read(self.changed_tree("    bool step(int amount);\n", ""))

    def test_another_sentence_is_a_mismatch(self):
        with self.assertRaisesRegex(contract.Mismatch, "do not say 'Does not start playback'"):
            rows.read(self.changed_tree("Does not start playback", "Starts playback"))

    def test_a_changed_sentence_shows_in_the_table(self):
        root = self.changed_tree("For good.", "For good, whatever comes.")
        sentences = {row.test: row.sentence for row in rows.read(root)}
        self.assertEqual(sentences["LifeTest.ReleaseIsForGood"], "For good, whatever comes.")

    def test_the_rows_are_the_programs_tests(self):
        program = json.loads(KIT.read_text())["program"]
        listed = subprocess.run([program, "--gtest_list_tests"], capture_output=True, text=True,
                                check=True).stdout.splitlines()
        suite, tests = "", set()
        for line in listed:
            if line.startswith("  "):
                tests.add(suite + line.strip())
            elif line.endswith("."):
                suite = line
        self.assertEqual({row.test for row in rows.read(SOURCE)}, tests)

    def test_the_media_can_be_made(self):
        made = subprocess.run([SOURCE / "tests/media/make-media.sh", "--list"], check=True,
                              capture_output=True, text=True).stdout.split()
        wanted = (SOURCE / rows.FOLDER / "media.txt").read_text().split()
        self.assertEqual(set(wanted) - set(made), set())
        self.assertGreater(len(wanted), 8)


class DesktopEngineTest(unittest.TestCase):
    def test_it_passes_all_that_it_offers(self):
        status, found, said = results(os.environ["ORV_ENGINE"])
        self.assertEqual(tests_with("fail", found), set(), said)
        self.assertEqual(tests_with("not offered", found),
                         {"SpeedTest.TheTimeShiftSettingMayLack"}, said)
        self.assertEqual(status, 0)


class PatternEngineTest(unittest.TestCase):
    def test_it_passes_all_that_it_offers(self):
        status, found, said = results(os.environ["ORV_PATTERN_ENGINE"], "--address", FILM)
        self.assertEqual(tests_with("fail", found), set(), said)
        self.assertEqual(status, 0)
        for suite in ("LifeTest", "PlaybackTest", "SeekTest", "EventsTest", "SurfaceTest"):
            offered = {test for test in tests_with("pass", found) if test.startswith(suite)}
            self.assertGreater(len(offered), 3, suite)
        for test in ("SpeedTest.BackwardEndsAtTheStart", "StreamTest.AStreamIsPlayed",
                     "SourceTest.ADescriptorsPartIsPlayed", "ParametersTest.AParameterIsKept",
                     "DescriptionTest.AThumbnailFillsItsRows"):
            self.assertEqual(found[test], "not offered", said.get(test))

    def test_without_its_address_it_offers_no_playback(self):
        status, found, said = results(os.environ["ORV_PATTERN_ENGINE"], "--filter",
                                      r"^PlaybackTest\.StartPlays$")
        self.assertEqual((status, list(found.values())), (0, ["not offered"]), said)


class FaultyEngineTest(unittest.TestCase):
    def expect(self, fault, failing, *options, limit=LIMIT):
        engine = FAULTY / fault / "liborvtarn.so"
        status, found, said = results(engine, "--address", FILM, *options, limit=limit)
        self.assertEqual(tests_with("fail", found), failing, said)
        self.assertGreater(len(tests_with("pass", found)), 0)
        self.assertEqual(status, 1)
        return said

    def test_an_end_that_is_not_reported(self):
        self.expect("without_completion", {"EventsTest.TheEndIsReportedOnce",
                                           "PlaybackTest.StartAtTheEndCompletesAtOnce"})

    def test_a_place_that_is_not_that_of_the_seek(self):
        said = self.expect("wrong_place", {
            "SeekTest.ASeekEndsAtThePlace", "SeekTest.AnExactSeekIsExact",
            "SeekTest.ASeekAfterTheEndLeadsToPaused", "SurfaceTest.ASeekShowsItsFrame"})
        self.assertIn("4900", " ".join(said["SeekTest.ASeekEndsAtThePlace"]))

    def test_a_source_that_is_kept(self):
        said = self.expect("kept_source", {"StreamTest.ASourceThatIsRefusedIsDeletedAtOnce",
                                           "StreamTest.AReleasedPlayerDeletesItToo"})
        self.assertIn("deletions", said["StreamTest.AReleasedPlayerDeletesItToo"])

    def test_a_reset_that_crashes(self):
        said = self.expect("crashing_reset", {
            "LifeTest.ResetLeadsBackToOtherMedia", "LifeTest.NoResetLeadsOutOfARelease",
            "LifeTest.TheDurationOutlastsAStop", "PlaybackTest.LoopingOutlastsAReset",
            "SourceTest.HeadersComeWithTheAddress", "ThreadsTest.AResetMayComeInBetween",
            "ThreadsTest.AnyThreadMayCallAnyOperation"})
        crash = said["LifeTest.ResetLeadsBackToOtherMedia"][0]
        self.assertRegex(crash, "^it crashes: SIG(ILL|TRAP)$")

    def test_a_step_that_hangs(self):
        said = self.expect("hanging_step", {"SpeedTest.AStepIsAFrameAndPauses",
                                            "SpeedTest.NoStepLeadsOutOfTheMedia"},
                           "--filter", "^(step|pause)", limit=20)
        self.assertEqual(said["SpeedTest.AStepIsAFrameAndPauses"],
                         ["it hangs: not over after 20 seconds"])

    def test_an_interruption_ends_what_hangs(self):
        engine = FAULTY / "hanging_step/liborvtarn.so"
        tool = subprocess.Popen([TOOL, "run", engine, "--kit", KIT, "--media", MEDIA, "--address",
                                 FILM, "--filter", "NoStepLeadsOutOfTheMedia"])
        row = None
        while row is None:
            row = child_with(tool.pid, "--gtest_filter=SpeedTest.NoStepLeadsOutOfTheMedia")
        tool.send_signal(signal.SIGINT)
        self.assertEqual(tool.wait(LIMIT), 130)
        self.assertFalse(pathlib.Path(f"/proc/{row}").exists())

    def test_the_results_for_programs_are_those_of_the_table(self):
        engine = FAULTY / "crashing_reset/liborvtarn.so"
        with tempfile.TemporaryDirectory() as folder:
            file = pathlib.Path(folder) / "results.xml"
            status, output, _ = run(engine, "--address", FILM, "--filter", "^(reset|setTS)",
                                    "--junit", file)
            suite = ElementTree.parse(file).getroot()
        self.assertEqual(status, 1)
        cases = suite.findall("testcase")
        counts = [len(suite.findall(f"testcase/{kind}")) for kind in ("failure", "skipped")]
        self.assertEqual([suite.get("failures"), suite.get("skipped")], list(map(str, counts)))
        passed = len(cases) - sum(counts)
        self.assertEqual(output.splitlines()[-1], f"{len(cases)} rows: {passed} pass, "
                         f"{counts[0]} fail, {counts[1]} not offered")
        self.assertTrue(all(counts))


class UnfitInputTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def refusal(self, engine, pattern, *options, **keywords):
        status, output, error = run(engine, *options, **keywords)
        self.assertEqual((status, output), (2, ""), error)
        self.assertRegex(error, rf"\Aorv: [^\n]*{pattern}[^\n]*\.\n\Z")

    def test_no_such_file(self):
        self.refusal("/nowhere/liborvtarn.so", "there is no such file; give the path")

    def test_no_library(self):
        self.refusal(SOURCE / "README.md", "not an ELF library; give the engine as")

    def test_another_machine(self):
        other = self.folder / "liborvtarn.so"
        content = bytearray(pathlib.Path(os.environ["ORV_PATTERN_ENGINE"]).read_bytes())
        content[18:20] = (183).to_bytes(2, "little")  # the machine: 64-bit ARM
        other.write_bytes(content)
        self.refusal(other, "is for AArch64.*; give the engine as")

    def test_a_library_cut_off(self):
        cut = self.folder / "liborvtarn.so"
        cut.write_bytes(pathlib.Path(os.environ["ORV_PATTERN_ENGINE"]).read_bytes()[:2000])
        self.refusal(cut, "copy or build it again|give the engine as")

    def test_an_operation_that_is_not_exported(self):
        self.refusal(os.environ["ORV_ENGINE_LACKING"],
                     r"not exported, android::TarnPlayer::\w+\(.*; ./orv doctor --engine")

    def test_a_symbol_that_nothing_has(self):
        self.refusal(FAULTY / "undefined/liborvtarn.so",
                     r"has the symbol .*lacking\(\); link the engine to the library that has it")

    def test_no_folder_with_media(self):
        self.refusal(os.environ["ORV_PATTERN_ENGINE"], "there is no such folder",
                     media=self.folder / "nowhere")
        self.refusal(os.environ["ORV_PATTERN_ENGINE"], r"media tracks\.mp4 .*are missing",
                     media=self.folder)

    def test_no_row_of_that_name(self):
        self.refusal(os.environ["ORV_PATTERN_ENGINE"], "no row's operation or test matches",
                     "--filter", "^nothing$")
        self.refusal(os.environ["ORV_PATTERN_ENGINE"], r"'\(' is no regular expression",
                     "--filter", "(")

    def test_results_that_cannot_be_written(self):
        status, _, error = run(os.environ["ORV_PATTERN_ENGINE"], "--filter", "^setTS",
                               "--json", self.folder / "nowhere/results.json")
        self.assertEqual(status, 2)
        self.assertRegex(error, r"\Aorv: [^\n]*results were not written\.\n\Z")


if __name__ == "__main__":
    unittest.main()
