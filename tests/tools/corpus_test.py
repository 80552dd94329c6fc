#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv corpus over test media, with faults planted in front of the player."""

import json
import os
import pathlib
import subprocess
import sys
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
MEDIA = pathlib.Path(os.environ["ORV_MEDIA"])
PLAYER = os.environ["ORV_PLAYER"].split("|")

sys.path.insert(0, str(SOURCE / "tools/corpus"))
import child  # noqa: E402
import pictures  # noqa: E402
import report  # noqa: E402

LIMIT = 60


class CorpusTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.media = self.folder / "media"
        self.media.mkdir()
        self.pids = self.folder / "pids"
        self.pids.touch()

    def add(self, name, original):
        place = self.media / name
        place.parent.mkdir(exist_ok=True)
        subprocess.run([SOURCE / "tests/media/make-media.sh", MEDIA, original], check=True)
        place.symlink_to(MEDIA / original)

    def corpus(self, *options, faults="", limit=LIMIT):
        """Runs the tool; the faults are cases of the shell for a player's
        command line, tried before the player is started."""
        script = self.folder / "player"
        script.write_text(f'#!/bin/bash\nPIDS={self.pids}\ncase "$*" in\n{faults}\nesac\n'
                          f'exec "{PLAYER[0]}" "${{@}}"\n', encoding="utf-8")
        script.chmod(0o755)
        out = self.folder / "report.json"
        done = subprocess.run(
            [SOURCE / "tools/corpus/corpus.py", self.media, "--report", out, "--limit", str(limit),
             *options, "--", script, *PLAYER[1:]], capture_output=True, text=True)
        self.assertEqual(done.stderr, "")
        return done.returncode, done.stdout.splitlines(), json.loads(out.read_text())

    def found(self, content):
        return [(d["kind"], d["file"], d["where"]) for d in content["differences"]]

    def test_media_that_play_well_and_files_that_are_none_agree(self):
        for name in ("short.mp4", "still.png", "tone.mp3", "garbage.bin", "empty.bin"):
            self.add(name, name)
        (self.media / "notes.txt").write_text("no media\n", encoding="utf-8")
        status, lines, content = self.corpus()
        self.assertEqual(content["differences"], [])
        self.assertEqual(len(content["files"]), 6)
        self.assertEqual((status, lines), (0, ["6 files, 0 differ"]))

    def test_a_crash_and_a_hang_are_reported_worst_first(self):
        self.add("a hang.mp4", "short.mp4")
        self.add("below/crash.mp4", "short.mp4")
        self.add("good.mp4", "short.mp4")
        status, lines, content = self.corpus("--jobs", "3", limit=20, faults="""
            *' play '*crash.mp4*) kill -SEGV $$ ;;
            *' info '*hang.mp4*)
                trap '' TERM INT
                sleep infinity &
                echo $$ $! >>"$PIDS"
                wait ;;""")
        self.assertEqual(status, 1)
        self.assertEqual(self.found(content), [("crash", "below/crash.mp4", "play"),
                                               ("hang", "a hang.mp4", "info")])
        self.assertRegex(lines[1], r"^crash +below/crash\.mp4 +play +SIGSEGV$")
        self.assertRegex(lines[2], r"^hang +a hang\.mp4 +info +killed after 20 s$")
        self.assertEqual(lines[3:], ["3 files, 2 differ: 1 x crash, 1 x hang"])
        pids = self.pids.read_text().split()
        self.assertEqual(len(pids), 2)
        for pid in pids:
            self.assertFalse(is_running(pid), "the whole group of processes is ended")

    def test_other_crashes_are_told_from_failures(self):
        self.add("aborted.mp4", "short.mp4")
        self.add("thrown.mp4", "short.mp4")
        self.add("refused.mp4", "short.mp4")
        _, _, content = self.corpus(faults="""
            *' info '*aborted.mp4*) exit 134 ;;
            *' info '*thrown.mp4*) printf 'java.lang.Error: odd\\n\\tat A.b(A.java:1)\\n' >&2; exit 1 ;;
            *' info '*refused.mp4*) echo 'orv: is no media' >&2; exit 1 ;;""")
        self.assertEqual(self.found(content), [
            ("crash", "aborted.mp4", "info"), ("crash", "thrown.mp4", "info"),
            ("refused", "refused.mp4", "info")])
        self.assertEqual([d["ours"] for d in content["differences"]],
                         ["status 134", "java.lang.Error: odd", "orv: is no media"])

    def test_every_statement_is_compared(self):
        wrong = json.dumps({
            "durationMs": 2000, "audio": [], "subtitles": [],
            "video": [{"codec": "mpeg4", "width": 180, "height": 320}]})
        self.add("wrong.mp4", "short.mp4")
        (self.folder / "wrong.json").write_text(wrong, encoding="utf-8")
        other = self.folder / "other.png"
        subprocess.run(["ffmpeg", "-v", "error", "-f", "lavfi", "-i", "color=red:size=320x180",
                        "-frames:v", "1", other], check=True)
        _, _, content = self.corpus(faults=f"""
            *' info '*) cat {self.folder}/wrong.json; exit ;;
            *' thumbnail '*' 0.0'*) cp {other} "${{@: -1}}"; exit ;;
            *' thumbnail '*) echo 'orv: no picture' >&2; exit 1 ;;
            *' play '*) printf '1.0 s of 3.0 s, 1x\\n7 frames shown, 1 dropped\\n'; exit ;;""")
        self.assertEqual([(d["kind"], d["where"].split(" --")[0], d["ours"], d["theirs"])
                          for d in content["differences"] if d["kind"] != "picture"], [
            ("playback", "play", "ended at 1.0 s", "3.0 s"),
            ("duration", "info", "2.000 s", "3.000 s"),
            ("tracks", "info audio", "0", "1"),
            ("size", "info video 0 height", "320", "180"),
            ("size", "info video 0 width", "180", "320"),
            ("frames", "play", "7 shown, 1 dropped", "90"),
            ("codec", "info video 0", "mpeg4", "h264")])
        drawn = [d["ours"] for d in content["differences"] if d["kind"] == "picture"]
        self.assertRegex(drawn[0], r"^\d\.\d dB$")
        self.assertEqual(drawn[1:], ["orv: no picture"] * 2)

    def test_what_only_one_side_reads_is_a_difference(self):
        self.add("garbage.bin", "garbage.bin")
        self.add("good.mp4", "short.mp4")
        _, _, content = self.corpus(faults="""
            *' info '*garbage.bin*) echo '{}'; exit ;;
            *' play '*good.mp4*) echo 'orv: the sound device is gone' >&2; exit 1 ;;""")
        self.assertEqual(self.found(content), [("playback", "good.mp4", "play"),
                                               ("extra", "garbage.bin", "info")])

    def test_wrong_arguments(self):
        for arguments, words in (((self.folder / "none",), "is no folder"),
                                 ((self.media, "--jobs", "0"), "invalid positive number"),
                                 ((self.media, "--limit", "x"), "invalid positive number"),
                                 ((self.media, "--report", "/none/r.json"), "does not exist"),
                                 ((), "required: DIR")):
            done = subprocess.run([SOURCE / "tools/corpus/corpus.py", *arguments, "--", "true"],
                                  capture_output=True, text=True)
            self.assertEqual(done.returncode, 2)
            self.assertIn(words, done.stderr)


class PartsTest(unittest.TestCase):
    def test_likeness(self):
        self.assertEqual(pictures.psnr(b"\0\0", b"\0\0"), float("inf"))
        self.assertAlmostEqual(pictures.psnr(b"\0" * 3, b"\1" * 3), 48.13, 2)
        self.assertEqual(pictures.psnr(b"\0" * 3, b"\0" * 6), 0)

    def test_names_have_no_power_over_the_terminal(self):
        self.assertEqual(report.printable("a\x1b[2J\nü\udcff"), r"a\x1b[2J\nü\udcff")

    def test_output_before_the_limit_is_kept(self):
        outcome = child.run(["sh", "-c", "echo begun; exec sleep infinity"], 5)
        self.assertTrue(outcome.hung())
        self.assertEqual(outcome.out, b"begun\n")


def is_running(pid):
    try:
        state = pathlib.Path(f"/proc/{pid}/stat").read_text().rpartition(")")[2].split()[0]
    except (FileNotFoundError, ProcessLookupError):
        return False
    return state not in "ZX"


if __name__ == "__main__":
    unittest.main()
