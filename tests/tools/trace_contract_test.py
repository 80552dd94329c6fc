#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""What ./orv trace makes of the lines that each native method writes in the contract tests:
the recorded calls of tests/contract/traces, written as a log in which each is a process."""

import collections
import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
TRACE = os.environ["ORV_TRACE"]
TABLE = SOURCE / "frameworks/playback/MediaPlayer/jni/NativeMethodTable.cpp"
ROW = re.compile(r'ROW\("(\w+)", "([^"]+)", OrvMediaClient_(\w+)\)')
CALL = re.compile(r"^(native_\w+)(?: (\([^ ]*\)\S+))?$")
LINE = re.compile(r"^    log (\w) (\S+) (.*)$")
# Asked many times a second: these write nothing.
SILENT = {"getCurrentPosition", "getBufferingTime", "getCurrentBytePosition",
          "get_audio_session_id"}

# Lines of error priority that report none.
REPORTS = re.compile(r"^OrvMediaService::(getDuration\(\): |step\(\): amount)|mLanguage|^width_new ")

LEAVES = re.compile(r"(: Leave|, leave|\(\)end|no need to fetch subtitle info)$")
# What leaves inside of native methods.
INSIDE = re.compile("decVideoSurfaceRef|setVideoSurface|setMediaService|createPlayer|Msg|Media|Sync|Java")

Recorded = collections.namedtuple("Recorded", "method lines throws place")


def functions():
    """The function of each Java name with its signature, and without where there is one alone."""
    rows = ROW.findall(TABLE.read_text())
    named = {(name, signature): function for name, signature, function in rows}
    count = collections.Counter(name for name, _, _ in rows)
    named.update({(name, None): function for name, _, function in rows if count[name] == 1})
    return named


def recorded():
    """The recorded calls of native methods: their log lines, and whether they throw."""
    named = functions()
    calls = []
    for path in sorted((SOURCE / "tests/contract/traces").glob("*.txt")):
        call = None
        for number, text in enumerate(path.read_text(errors="surrogateescape").splitlines(), 1):
            if not text.startswith("    "):
                match = CALL.match(text)
                call = None
                if match and match.groups() in named:
                    call = Recorded(named[match.groups()], [], [], f"{path.name}:{number}")
                    calls.append(call)
            elif call is not None:
                match = LINE.match(text)
                if match:
                    call.lines.append(match.groups())
                elif text.startswith("    throw "):
                    call.throws.append(text.strip())
    return calls


def log_of(calls):
    """A log with each call in a process of its own, a millisecond a line."""
    lines, clock = [], 0
    for pid, call in enumerate(calls, 1):
        for priority, tag, text in call.lines:
            clock += 1
            seconds, ms = divmod(clock, 1000)
            time = f"03-04 {seconds // 3600:02}:{seconds // 60 % 60:02}:{seconds % 60:02}.{ms:03}"
            text = text.replace("\\n", "").split("\\0")[0]
            lines.append(f"{time} {pid:5} {pid:5} {priority} {tag}: {text}\n")
    return "".join(lines).encode(errors="surrogateescape")


class RecordedCalls(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.calls = recorded()
        with tempfile.TemporaryDirectory() as folder:
            log, out = pathlib.Path(folder, "log"), pathlib.Path(folder, "out.json")
            log.write_bytes(log_of(cls.calls))
            subprocess.run([TRACE, "-o", out, log], check=True, stdout=subprocess.DEVNULL)
            events = json.loads(out.read_text())["traceEvents"]
        cls.found = collections.defaultdict(list)
        for event in events:
            if event.get("cat") == "native":
                cls.found[event["pid"]].append(event)
        for spans in cls.found.values():
            spans.sort(key=lambda event: (event["ts"], -event.get("dur", 0)))

    def each(self):
        for pid, call in enumerate(self.calls, 1):
            yield call, self.found[pid]

    def test_every_method_is_recorded(self):
        methods = {call.method for call in self.calls}
        self.assertEqual(methods, set(functions().values()))
        self.assertGreater(len(self.calls), 300)

    def test_each_call_is_found_under_its_name(self):
        for call, spans in self.each():
            names = [span["name"] for span in spans]
            with self.subTest(call.place):
                if call.method in SILENT or not call.lines:
                    self.assertEqual(names, [])
                elif call.method == "setDataSource":
                    self.assertEqual(names, ["setDataSource", "setDataSourceAndHeaders"])
                elif call.method == "finalize":
                    self.assertEqual(names, ["finalize", "release"])
                # Its first line is the chapter getter's; nothing else tells it apart when it
                # finds no service.
                elif call.method == "getDivxPlayListInfo" and "PlayList" not in str(call.lines):
                    self.assertEqual(names, ["getDivxChapInfo"])
                else:
                    self.assertEqual(names, [call.method])

    def test_each_exception_after_a_complaint_is_a_failure(self):
        tried = 0
        for call, spans in self.each():
            complains = any(priority == "E" or "jniThrowException" in text
                            for priority, _, text in call.lines)
            if not call.throws or not complains or not spans:
                continue
            tried += 1
            with self.subTest(call.place):
                self.assertIn("failure", spans[0]["args"])
        self.assertGreater(tried, 100)

    def test_what_has_no_complaint_is_no_failure(self):
        complaint = re.compile("fail|error|not exist|Exception")
        tried = 0
        for call, spans in self.each():
            if call.throws or any(
                    complaint.search(text) or (priority == "E" and not REPORTS.search(text))
                    for priority, _, text in call.lines):
                continue
            tried += 1
            with self.subTest(call.place):
                for span in spans:
                    self.assertNotIn("failure", span["args"])
        self.assertGreater(tried, 100)

    def test_a_call_with_a_line_that_leaves_has_its_end_and_no_other(self):
        for call, spans in self.each():
            if not spans or spans[0]["ph"] != "X":
                continue
            texts = [text.replace("\\n", "") for _, _, text in call.lines]
            with self.subTest(call.place):
                if any(LEAVES.search(text) and not INSIDE.match(text) for text in texts):
                    self.assertNotIn("end", spans[0]["args"])
                else:
                    self.assertIn("end", spans[0]["args"])


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
