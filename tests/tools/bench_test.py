#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv bench with small programs in the place of those that it compares."""

import contextlib
import io
import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest
import xml.dom.minidom

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
sys.path.insert(0, str(SOURCE / "tools/bench"))
import bench  # noqa: E402
import catalogue  # noqa: E402
import display  # noqa: E402
import tree  # noqa: E402
import watching  # noqa: E402
from figures import Comparison, Failed, Goal, Quantity, Side  # noqa: E402


def side(name, *numbers):
    """Has these figures, a round each."""
    rest = iter(numbers)
    return Side(name, lambda: {"time": next(rest)})


def pair(name, here, peer, goal=None):
    return Comparison(name, (Quantity("time", "s", goal),), here, peer)


class BenchTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def program(self, name, script):
        path = self.folder / name
        path.write_text(f"#!/bin/bash\n{script}\n", encoding="utf-8")
        path.chmod(0o755)
        return str(path)

    def bench(self, comparisons, *options):
        """(status, lines of the table, what it said besides)"""
        out, err = io.StringIO(), io.StringIO()
        with contextlib.redirect_stdout(out), contextlib.redirect_stderr(err):
            try:
                status = bench.main(list(options), comparisons)
            except SystemExit as end:
                status = end.code
        return status, out.getvalue().splitlines(), err.getvalue()

    def test_the_table_has_medians_spreads_ratios_and_what_met_its_goal(self):
        status, lines, said = self.bench([
            pair("quick", side("q", 3, 1, 2), side("slow one", 4, 8, 5), Goal(0.4)),
            pair("late", side("l", 3, 1, 2), side("other", 4, 8, 5), Goal(0.39)),
            pair("near", side("n", 0.06, 0.05, 0.04), side("bare", 0.02, 0.02, 0.03),
                 Goal(0.03, "over")),
            pair("much", side("m", 3, 1, 2), None, Goal(1.5, "value")),
            pair("plain", side("p", 30, 10, 20), None)], "--rounds", "3")
        self.assertEqual((status, said), (0, ""))
        self.assertEqual([re.split(" {2,}", line) for line in lines[:6]], [
            ["row", "here", "floor or peer", "ratio", "goal", "met"],
            ["quick/time", "2 s (1 to 3)", "slow one", "5 s (4 to 8)", "0.40", "≤ 0.4", "met"],
            ["late/time", "2 s (1 to 3)", "other", "5 s (4 to 8)", "0.40", "≤ 0.39", "missed"],
            ["near/time", "0.05 s (0.04 to 0.06)", "bare", "0.02 s (0.02 to 0.03)", "2.50",
             "≤ +0.03 s", "met"],
            ["much/time", "2 s (1 to 3)", "≤ 1.5 s", "missed"],
            ["plain/time", "20 s (10 to 30)"]])
        self.assertRegex(lines[-1], r"; 3 rounds, medians .*; load [\d.]+ before and [\d.]+ after")

    def test_the_sides_alternate_and_take_turns_to_begin(self):
        order = []

        def noting(name):
            return Side(name, lambda: order.append(name) or {"time": 1})
        self.bench([pair("a", noting("here"), noting("there"))], "--rounds", "3")
        self.assertEqual(order, ["here", "there", "there", "here", "here", "there"])

    def test_json_has_every_sample(self):
        path = self.folder / "out.json"
        self.bench([pair("a", side("h", 3, 2), side("p", 4, 6), Goal(0.5))],
                   "--rounds", "2", "--json", str(path))
        content = json.loads(path.read_text(encoding="utf-8"))
        self.assertEqual(content["rounds"], 2)
        self.assertEqual(content["rows"], [{
            "row": "a/time", "unit": "s",
            "here": {"median": 2.5, "least": 2, "most": 3, "samples": [3, 2]},
            # The second round begins with the peer, but its samples stay its own.
            "peer": {"name": "p", "median": 5, "least": 4, "most": 6, "samples": [4, 6]},
            "ratio": 0.5, "goal": {"most": 0.5, "kind": "ratio"}, "met": True, "failure": None}])
        self.assertEqual(content["machine"]["processors"], os.cpu_count())

    def test_the_plot_has_a_bar_for_each_ratio_on_one_scale(self):
        path = self.folder / "out.svg"
        self.bench([pair("met", side("h", 1), side("p", 10), Goal(1)),
                    pair("missed <&>", side("h", 100), side("p", 1), Goal(10)),
                    pair("alone", side("h", 1), None)],
                   "--rounds", "1", "--plot", str(path))
        picture = xml.dom.minidom.parse(str(path))
        bars = [(float(bar.getAttribute("x")), float(bar.getAttribute("width")))
                for bar in picture.getElementsByTagName("rect")[1:]]
        # Three powers of ten: left of 1 for a tenth, two to the right for a hundred.
        self.assertEqual(bars, [(300, 140), (440, 280)])
        texts = [text.firstChild.data for text in picture.getElementsByTagName("text")]
        self.assertIn("missed <&>/time", texts)
        self.assertIn("0.10 of p, met", texts)
        self.assertIn("100.00 of p, missed", texts)
        self.assertNotIn("alone/time", texts)

    def test_a_peer_that_fails_makes_a_row_that_says_why(self):
        peer = self.program("peer", "echo first >&2; echo 'no such film' >&2; exit 3")
        out = self.folder / "out.json"
        status, lines, _ = self.bench([
            pair("bad", side("h", 1), Side("peer", lambda: tree.run([peer]).figures())),
            pair("good", side("h", 1), side("p", 2))], "--rounds", "1", "--json", str(out))
        self.assertEqual(status, 1)
        self.assertRegex(lines[1], r"^bad/time +failed: peer: status 3, no such film$")
        self.assertRegex(lines[2], r"^good/time +1 s +p +2 s +0.50$")
        rows = json.loads(out.read_text(encoding="utf-8"))["rows"]
        self.assertEqual([row["failure"] for row in rows],
                         ["peer: status 3, no such film", None])

    def test_a_peer_that_is_missing_is_named(self):
        status, lines, _ = self.bench([pair("bad", side("h", 1), Side(
            "peer", lambda: tree.run(["/nowhere/thumbnailer"]).figures()))])
        self.assertEqual(status, 1)
        self.assertRegex(lines[1], "failed: peer: there is no /nowhere/thumbnailer here$")

    def test_a_comparison_that_cannot_be_prepared_fails_alone(self):
        def refuse():
            raise Failed("the media cannot be made")
        bad = Comparison("bad", (Quantity("time", "s"), Quantity("cpu", "s")), side("h"),
                         side("p"), refuse)
        status, lines, _ = self.bench([bad, pair("good", side("h", 1), None)], "--rounds", "1")
        self.assertEqual(status, 1)
        self.assertRegex(lines[1], "^bad/time +failed: the media cannot be made$")
        self.assertRegex(lines[2], "^bad/cpu +failed: the media cannot be made$")
        self.assertRegex(lines[3], "^good/time +1 s$")

    def test_rows_are_chosen_by_their_names(self):
        both = (Quantity("time", "s"), Quantity("cpu", "s"))
        here = Side("h", lambda: {"time": 1, "cpu": 2})
        comparisons = [Comparison("a", both, here), Comparison("b", both, here)]
        _, lines, _ = self.bench(comparisons, "--rounds", "1", "--rows", "^a/|cpu")
        self.assertEqual([line.split()[0] for line in lines[1:4]], ["a/time", "a/cpu", "b/cpu"])
        status, lines, said = self.bench(comparisons, "--rows", "^c")
        self.assertEqual((status, lines), (2, []))
        self.assertEqual(said, "orv: no row matches '^c'; --list names them\n")
        status, lines, said = self.bench(comparisons, "--rows", "(")
        self.assertEqual((status, lines), (2, []))
        self.assertIn("'(' is no regular expression", said)
        status, lines, _ = self.bench(comparisons, "--list", "--rows", "b")
        self.assertEqual((status, lines), (0, ["b/time", "b/cpu"]))

    def test_wrong_arguments_are_refused_before_anything_is_measured(self):
        def untouched():
            raise AssertionError("measured")
        comparisons = [pair("a", Side("h", untouched), None)]
        for options in (("--rounds", "0"), ("--rounds", "two"), ("--json", "/nowhere/out.json"),
                        ("--plot", "/nowhere/out.svg"), ("--unknown",)):
            status, lines, said = self.bench(comparisons, *options)
            self.assertEqual((status, lines), (2, []), options)
            self.assertIn("error:", said)

    def test_processor_time_is_that_of_all_generations(self):
        spin = "i=0; while ((i < 100000)); do ((++i)); done"
        one = tree.run([self.program("one", spin)]).cpu
        # Those who started these three have ended, and nobody waits for them.
        done = self.folder / "done"
        four = tree.run([self.program(
            "four", f"for n in 1 2 3; do (({spin}; echo >>{done}) &); done; {spin}\n"
            f"until [ -e {done} ] && (($(wc -l <{done}) == 3)); do sleep 0.05; done")]).cpu
        self.assertGreater(four, 2 * one)

    def test_nothing_stays_of_a_tree(self):
        pids = self.folder / "pids"
        script = self.program("leaving", f"(sleep infinity & echo $! >>{pids})")
        tree.run([script])
        for pid in pids.read_text().split():
            self.assertFalse(os.path.exists(f"/proc/{pid}"), "a process was left")

    def test_memory_is_the_sum_of_a_tree(self):
        hold = f"{sys.executable} -c 'import sys; x = b\"x\" * (64 << 20); sys.stdin.read()'"
        ready = self.folder / "go"
        os.mkfifo(ready)
        # Each holds its memory until the samples have seen both.
        script = self.program("two", f"{hold} <{ready} & {hold} <{ready} & wait")
        process = tree.Tree([script])
        with open(ready, "w", encoding="ascii"):
            watching.await_true(lambda: process.largest > 128 << 20, process, 60, "its size", 0.05)
        self.assertGreater(process.finish(60).demand_success().memory, 128)

    def test_what_takes_too_long_is_ended(self):
        script = self.program("hang", "trap '' TERM; sleep infinity & wait")
        with self.assertRaisesRegex(Failed, "^not done after 0.2 s$"):
            tree.run([script], 0.2)

    def test_what_a_display_shows_is_seen_from_outside(self):
        shown = display.Display()
        self.addCleanup(shown.close)

        def look(process):
            watching.await_true(lambda: shown.middle(display.is_green), process, 60, "green", 0.05)
            return shown.extent(display.is_green)
        self.assertFalse(shown.middle(display.is_green))
        # The middle of a box in a picture that is as large as the screen.
        film = f"color=black:size={display.WIDTH}x{display.HEIGHT}:rate=5,format=rgb24," \
            "drawbox=x=iw/4:w=iw/2:color=lime:t=fill"
        width, _ = watching.watch(
            ["ffplay", "-v", "error", "-noborder", "-left", "0", "-top", "0", "-f", "lavfi", film],
            {**shown.environment(), "SDL_AUDIODRIVER": "dummy"}, look)
        self.assertEqual(width, display.WIDTH // 2)

    def test_a_program_that_ends_too_early_is_no_figure(self):
        script = self.program("early", "echo 'no display' >&2; exit 4")
        with self.assertRaisesRegex(Failed, "^ended before the picture: status 4, no display$"):
            watching.watch([script], None, lambda tree: watching.await_true(
                lambda: False, tree, 60, "the picture", 0.01))

    def test_the_catalogue_names_each_row_once(self):
        place = catalogue.Place("/source", "/build", ["java"])
        names = [name for c in catalogue.comparisons(place) for name in c.row_names()]
        self.assertEqual(len(names), len(set(names)))
        for comparison in catalogue.comparisons(place):
            if comparison.peer:
                self.assertNotEqual(comparison.here.name, comparison.peer.name)

    def test_the_packages_of_its_peers_are_listed(self):
        listed = subprocess.run(["awk", "!/^#/ {print $1}", SOURCE / "tools/packages-bench.txt"],
                                capture_output=True, text=True, check=True).stdout.split()
        for peer in ("mpv", "ffmpegthumbnailer"):
            self.assertIn(peer, listed)


if __name__ == "__main__":
    unittest.main()
