#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""./orv trace on the log of a real run: each call's time against the one that the program
which made the call has measured itself."""

import json
import os
import pathlib
import statistics
import subprocess
import sys
import tempfile
import unittest

BUILD = pathlib.Path(os.environ["ORV_BUILD"])
MEDIA = pathlib.Path(os.environ["ORV_MEDIA"], "short.mp4")
JARS = ("orv_timed_calls", "mediaplayer_orv_java", "orv_platform_java")
# Calls that Java does not make itself.
INSIDE = {"init", "setup", "setDataSourceAndHeaders"}
# From here on writing the last line of a call is little beside the call.
LONG = 1_000_000


class RealRun(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        with tempfile.TemporaryDirectory() as folder:
            log, out = pathlib.Path(folder, "log"), pathlib.Path(folder, "out.json")
            classes = ":".join(str(BUILD / "java" / f"{jar}.jar") for jar in JARS)
            with log.open("wb") as errors:
                run = subprocess.run(
                    [os.environ["ORV_JAVA"], f"-Djava.library.path={BUILD / 'lib'}", "-cp", classes,
                     "com.quintora.mmp.TimedCalls", MEDIA],
                    stdout=subprocess.PIPE, stderr=errors, check=True, text=True,
                    env={**os.environ, "ORV_LOG": "verbose"})
            cls.table = subprocess.run([os.environ["ORV_TRACE"], "-o", out, log], check=True,
                                       stdout=subprocess.PIPE, text=True).stdout
            trace = json.loads(out.read_text(encoding="utf-8"))["traceEvents"]
        cls.measured = [(name, int(time)) for name, time in map(str.split, run.stdout.splitlines())]
        cls.tracks = [event for event in trace if event["name"] == "thread_name"]
        spans = [event for event in trace if event.get("cat") == "native"]
        spans.sort(key=lambda event: event["ts"])
        cls.traced = [(span["name"], span["dur"] * 1000) for span in spans
                      if span["name"] not in INSIDE]

    def test_every_call_is_found(self):
        self.assertEqual([name for name, _ in self.traced], [name for name, _ in self.measured])

    def test_no_call_takes_longer_than_its_caller_has_waited(self):
        for (name, traced), (_, measured) in zip(self.traced, self.measured):
            with self.subTest(name):
                # Two clocks, one of which the system may be setting right.
                self.assertLessEqual(traced, measured * 1.01)

    def test_long_calls_take_what_was_measured(self):
        missing = [1 - traced / measured
                   for (_, traced), (_, measured) in zip(self.traced, self.measured)
                   if measured > LONG]
        self.assertGreater(len(missing), 20)
        # Any one may be interrupted between its last line and its return.
        self.assertLess(statistics.median(missing), 0.05)

    def test_the_player_has_a_track(self):
        self.assertEqual([track["args"]["name"] for track in self.tracks if track["tid"] >= 1e9],
                         ["player 1"])
        self.assertIn(" 1 player", self.table)
        self.assertNotIn("without a line that leaves", self.table)


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
