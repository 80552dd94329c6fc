#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The player on top of the sample engine."""

import json
import os
import re
import subprocess
import unittest

PLAYER = os.environ["ORV_PLAYER"].split("|")


def player(*arguments):
    return subprocess.run([*PLAYER, *arguments], capture_output=True, text=True,
                          env={**os.environ, "ORV_LOG": "silent"})


class PlayerTest(unittest.TestCase):
    def test_it_plays_to_the_end_from_where_it_shall_begin(self):
        done = player("play", "--no-window", "--stats", "--start", "58", "pattern://60")
        self.assertEqual(done.returncode, 0, done.stderr)
        shown = re.search(r"(\d+) frames shown", done.stdout)
        self.assertIsNotNone(shown, done.stdout)
        # Two of the sixty seconds; a busy machine may leave frames out.
        self.assertTrue(5 <= int(shown[1]) < 100, done.stdout)

    def test_its_track_is_described(self):
        done = player("info", "--json", "pattern://7")
        self.assertEqual(done.returncode, 0, done.stderr)
        text = json.dumps(json.loads(done.stdout))
        self.assertRegex(text, '"raw ?"')
        self.assertIn("640", text)

    def test_what_it_does_not_open_is_one_sentence(self):
        for source, reason in (("http://localhost/film", "http:// are not opened"),
                               ("pattern://soon", "pattern:// are not opened"),
                               ("/film.mkv", "not opened")):
            done = player("play", "--no-window", source)
            self.assertEqual((done.returncode, done.stdout), (1, ""))
            self.assertRegex(done.stderr, rf"\Aorv: {source}: .*{reason}\n\Z")

    def test_a_speed_is_refused(self):
        done = player("play", "--no-window", "--speed", "2", "pattern://60")
        self.assertEqual(done.returncode, 1)
        self.assertIn("cannot be played at speed 2", done.stderr)


if __name__ == "__main__":
    unittest.main()
