#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv soak: what it takes for growth, and that it fails of each fault that is planted."""

import os
import pathlib
import random
import subprocess
import sys
import tempfile
import unittest
import xml.dom.minidom

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
SOAK = SOURCE / "tools/soak/soak.py"
sys.path[:0] = [str(SOURCE / "tools/soak"), str(SOURCE / "tools/bench")]
import fit  # noqa: E402
import growth  # noqa: E402
import picture  # noqa: E402
import ring  # noqa: E402

# Cycles that cost little, as their media do not open.
QUICK = "--only", "^(missing|empty|noise)$", "--cycles", "400", "--batch", "16"


def series(figure, count=80):
    """Checkpoints with a figure of their cycles, and others that do not change."""
    steady = {quantity.key: 100.0 for quantity in growth.QUANTITIES}
    return [{"cycles": 10 * n, **steady, **figure(10 * n)} for n in range(1, count + 1)]


def grown(checkpoints):
    return [finding.quantity.key for finding in growth.find(checkpoints) if finding.grows]


class GrowthTest(unittest.TestCase):
    def setUp(self):
        self.random = random.Random(4)

    def noise(self, size):
        return self.random.uniform(-size, size)

    def test_a_line_passes_by_outliers(self):
        line = fit.fit([(x, 3 * x + 7 if x % 5 else 1e9) for x in range(1, 40)])
        self.assertAlmostEqual(line.slope, 3)
        self.assertAlmostEqual(line.at(100), 307)
        self.assertLess(line.most - line.least, 1)

    def test_a_slope_of_few_points_is_not_certain(self):
        line = fit.fit([(1, 1), (2, 2), (3, 3)])
        self.assertEqual((line.least, line.most), (-float("inf"), float("inf")))

    def test_a_leak_is_found_in_noise(self):
        self.assertEqual(grown(series(lambda x: {
            "native": 1e7 + 4096 * x + self.noise(5e5)})), ["native"])

    def test_a_thread_each_ten_cycles_is_found(self):
        self.assertEqual(grown(series(lambda x: {
            "threads": 30 + x // 10 + self.random.randrange(4)})), ["threads"])

    def test_noise_is_no_growth(self):
        for _ in range(20):
            self.assertEqual(grown(series(lambda x: {
                "native": 1e7 + self.noise(5e5), "rss": 2.5e8 + self.noise(1e7),
                "threads": 30 + self.random.randrange(4), "open": 30 + self.noise(10)})), [])

    def test_what_fills_up_is_no_growth(self):
        self.assertEqual(grown(series(lambda x: {
            "native": 1e7 + 4096 * min(x, 300) + self.noise(1e4)})), [])

    def test_opens_that_take_twice_as_long_are_growth(self):
        self.assertEqual(grown(series(lambda x: {"open": 20 + x / 8 + self.noise(2)})), ["open"])

    def test_few_checkpoints_are_not_judged(self):
        findings = growth.find(series(lambda x: {"native": 4096 * x}, 9))
        self.assertEqual({finding.line for finding in findings}, {None})

    def test_checkpoints_without_a_figure_are_left_out(self):
        points = growth.find(series(lambda x: {"seek": None if x % 20 else 5}))[-1].points
        self.assertEqual(points, [(20 * n, 5) for n in range(1, 41)])

    def test_the_picture_has_a_panel_for_each_quantity(self):
        findings = growth.find(series(lambda x: {"native": 4096 * x}))
        drawn = xml.dom.minidom.parseString(picture.svg(findings, "a <run>", "here"))
        texts = [text.firstChild.data for text in drawn.getElementsByTagName("text")]
        self.assertIn("allocated memory, KiB: grows", texts)
        self.assertIn("JNI global references", texts)
        curves = drawn.getElementsByTagName("polyline")
        self.assertEqual(len(curves), len(growth.QUANTITIES))
        self.assertEqual(len(curves[0].getAttribute("points").split()), 80)

    def test_actions_are_read_in_their_order_from_a_ring(self):
        with tempfile.NamedTemporaryFile() as file:
            file.write(b"".join(f"{number:08d} action {number}".ljust(ring.SLOT - 1).encode()
                                + b"\n" for number in (202, 203, 201)) + bytes(2 * ring.SLOT))
            file.flush()
            self.assertEqual(ring.actions(file.name), ["action 201", "action 202", "action 203"])


class RunTest(unittest.TestCase):
    """Each run has a seed of its own, and so a folder of its own."""

    def soak(self, seed, *options):
        done = subprocess.run(
            [SOAK, "--seed", str(seed), *options, "--", os.environ["ORV_JAVA"]],
            capture_output=True, text=True, check=False)
        return done.returncode, done.stdout, done.stderr

    def test_a_run_of_every_kind_ends_well(self):
        status, out, err = self.soak(1, "--cycles", "30")
        self.assertEqual((status, err), (0, ""), out)
        self.assertTrue(out.startswith("seed 1\n"), out)
        path = out.rpartition("picture: ")[2].strip()
        self.assertIn("threads", pathlib.Path(path).read_text(encoding="utf-8"))

    def test_without_a_fault_nothing_grows(self):
        status, out, err = self.soak(2, *QUICK)
        self.assertEqual((status, err), (0, ""), out)
        self.assertNotIn("GROWS", out)

    def test_planted_growth_is_found(self):
        status, out, err = self.soak(
            3, *QUICK, "--plant", "leak,heap,threads,descriptors,references")
        self.assertEqual(status, 1)
        for name in ("allocated memory", "Java heap", "threads", "descriptors",
                     "JNI global references"):
            self.assertRegex(out, f"{name} .*GROWS")
            self.assertIn(name, err)
        self.assertRegex(out, "more threads: .*planted: ")
        self.assertRegex(out, "more descriptors: .*/dev/null: ")

    def test_a_planted_hang_is_reported_with_all_stacks(self):
        status, out, err = self.soak(4, *QUICK, "--plant", "hang", "--limit", "3")
        self.assertEqual(status, 1)
        self.assertRegex(out, r"cycle 3: hangs since \d s: ")
        self.assertIn("Plant.blockForever", out)
        self.assertIn('"soak-watchdog"', out)
        self.assertIn("./orv soak --seed 4 repeats it", err)

    def test_a_planted_exception_is_reported_with_the_last_actions(self):
        status, out, _ = self.soak(5, *QUICK, "--plant", "exception")
        self.assertEqual(status, 1)
        self.assertRegex(out, r"cycle 3: .*: java.lang.UnsupportedOperationException: planted")
        self.assertIn("at com.quintora.orv.soak.Plant.inAction", out)

    def test_a_fault_that_is_not_reported_fails_the_run(self):
        status, out, _ = self.soak(6, "--only", "missing", "--cycles", "8", "--plant", "unnoticed")
        self.assertEqual(status, 1)
        self.assertRegex(out, "AssertionError: taken for empty .*: the fault was not reported")

    def test_a_crash_is_reported_with_its_file_and_the_last_actions(self):
        status, out, _ = self.soak(7, *QUICK, "--plant", "crash")
        self.assertEqual(status, 1)
        self.assertRegex(out, r"the virtual machine crashed: .*/seed-7/hs_err.log")
        self.assertRegex(out, r"cycle 3: [^\n]*: \.\.\.")

    def test_arguments_that_make_no_sense_are_refused(self):
        for options in (["--minutes", "0"], ["--minutes", "many"], ["--cycles", "-1"],
                        ["--only", "("], ["--plant", "leek"], ["--seed", "x"]):
            status, out, err = self.soak(8, *options)
            self.assertEqual((status, out), (2, ""), options)
            self.assertIn(f"error: argument {options[0]}: ", err)


if __name__ == "__main__":
    unittest.main()
