#!/usr/bin/env python3
# SPDX-License-Identifier: Apache-2.0
"""./orv trace on logs of known content: its table, its trace, its page, and its refusals."""

import html.parser
import json
import os
import pathlib
import re
import signal
import subprocess
import sys
import tempfile
import threading
import unittest

TRACE = os.environ["ORV_TRACE"]
BRIDGE = "OrvMediaClient-JNI"
# Of a median and a 99th percentile: half a bucket, and the rounding of three digits.
ERROR = 1 / 128 + .005


def line(time, text, tid=11, priority="I", tag=BRIDGE, pid=10):
    """A line of logcat -v threadtime; time is what follows 11-22 10:00:."""
    return f"11-22 10:00:{time} {pid:5} {tid:5} {priority} {tag:8}: {text}\n"


def call(name, begin, end, tid=11, pid=10):
    return (line(begin, f"OrvMediaClient_{name}(): Enter", tid, pid=pid) +
            line(end, f"OrvMediaClient_{name}(): Leave", tid, pid=pid))


class TraceTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)

    def run_trace(self, *arguments, data=None):
        return subprocess.run([TRACE, *map(str, arguments)], input=data, capture_output=True,
                              timeout=120, check=False)

    def log(self, text, name="log"):
        path = self.folder / name
        path.write_bytes(text if isinstance(text, bytes) else text.encode())
        return path

    def rows(self, text, *arguments):
        """The table's rows by their methods: what stands in the columns behind."""
        done = self.run_trace(*arguments, self.log(text))
        self.assertEqual(done.returncode, 0, done.stderr.decode())
        self.said = done.stdout.decode()
        rows = [re.split(r"  +", row) for row in self.said.split("\n\n")[0].splitlines()]
        return {row[0]: row[1:] for row in rows[1:]}

    def events(self, text):
        """A trace's events but those that name tracks."""
        out = self.folder / "out.json"
        done = self.run_trace("-o", out, self.log(text))
        self.assertEqual(done.returncode, 0, done.stderr.decode())
        trace = json.loads(out.read_text(encoding="utf-8"))
        self.tracks = {(event["pid"], event["tid"]): event["args"]["name"]
                       for event in trace["traceEvents"] if event["name"] == "thread_name"}
        self.check(trace)
        return [event for event in trace["traceEvents"] if event["ph"] != "M"]

    def check(self, trace):
        """What the trace-event format asks for, and that the spans of a thread nest."""
        open_spans = {}
        spans = [event for event in trace["traceEvents"] if event["ph"] == "X"]
        for event in trace["traceEvents"]:
            self.assertIn(event["ph"], "XiM")
            self.assertIsInstance(event["name"], str)
            for key in ("pid", "tid") + (("ts",) if event["ph"] != "M" else ()):
                self.assertIsInstance(event[key], (int, float))
            self.assertIn((event["pid"], event["tid"]), {**self.tracks, (event["pid"], event["pid"]): ""})
            if event["ph"] == "i":
                self.assertEqual(event["s"], "t")
        for event in sorted(spans, key=lambda span: (span["ts"], -span["dur"])):
            self.assertGreaterEqual(event["dur"], 0)
            stack = open_spans.setdefault((event["pid"], event["tid"]), [])
            while stack and stack[-1] <= event["ts"]:
                stack.pop()
            end = event["ts"] + event["dur"]
            self.assertTrue(not stack or end <= stack[-1] + 1e-6, event)
            stack.append(end)

    def refused(self, *arguments, status=1, data=None):
        """The one sentence of a run that fails and leaves nothing."""
        before = sorted(self.folder.iterdir())
        done = self.run_trace(*arguments, data=data)
        self.assertEqual(done.returncode, status, done.stderr.decode())
        said = done.stderr.decode()
        self.assertEqual(said.count("\n"), 1, said)
        self.assertTrue(said.startswith("orv: "), said)
        self.assertEqual(sorted(self.folder.iterdir()), before)
        return said


class Table(TraceTest):
    def test_calls_failures_and_times_of_each_method(self):
        text = call("start", "01.000", "01.004") + call("start", "02.000", "02.010")
        text += (line("03.000", "OrvMediaClient_prepare(): Enter") +
                 line("05.500", "process_media_player_call(): else 2, throw exception", priority="E") +
                 line("05.500", "OrvMediaClient_prepare(): Leave"))
        rows = self.rows(text)
        start = rows["start"]
        self.assertAlmostEqual(float(start.pop(3).split()[0]), 4, delta=4 * ERROR)
        self.assertEqual(start, ["2", "-", "14.0 ms", "10.0 ms", "10.0 ms", "11-22 10:00:02.000"])
        self.assertEqual(rows["prepare"], ["1", "1", "2.50 s", "2.50 s", "2.50 s", "2.50 s",
                                           "11-22 10:00:03.000"])
        self.assertEqual(list(rows), ["prepare", "start"])
        self.assertIn("7 lines: 7 of the player.", self.said)
        self.assertIn("3 calls, 1 exception.", self.said)

    def test_quantiles_of_many_calls(self):
        text = ""
        for i in range(1000):
            text += f"11-22 10:{i // 60:02}:{i % 60:02}.000000 1 1 I {BRIDGE}: OrvMediaClient_stop(): Enter\n"
            text += f"11-22 10:{i // 60:02}:{i % 60:02}.{i + 1:06} 1 1 I {BRIDGE}: OrvMediaClient_stop(): Leave\n"
        row = self.rows(text)["stop"]
        self.assertEqual(row[0], "1 000")
        self.assertAlmostEqual(float(row[3].split()[0]), 500, delta=500 * ERROR)
        self.assertAlmostEqual(float(row[4].split()[0]), 990, delta=990 * ERROR)
        self.assertEqual(row[5:], ["1.00 ms", "11-22 10:16:39.000000"])

    def test_less_than_a_millisecond_is_not_nothing(self):
        self.assertEqual(self.rows(call("start", "01.000", "01.000"))["start"][2], "< 1 ms")
        self.assertIn("threadtime,usec", self.said)

    def test_lines_of_others_are_counted(self):
        text = ("--------- beginning of main\n" + call("start", "01.000", "01.004") +
                line("01.100", "hello", tag="SurfaceFlinger") + "what is this\n" + "\n")
        self.rows(text)
        self.assertIn("6 lines: 2 of the player, 1 of another tag, 1 in no known format.", self.said)

    def test_interleaved_threads_and_processes_are_apart(self):
        first, second, other = (
            call("start", "01.000", "01.100", tid=tid, pid=pid).splitlines(True)
            for tid, pid in ((11, 10), (12, 10), (11, 20)))
        third = call("stop", "01.050", "01.060", tid=12).splitlines(True)
        text = first[0] + other[0] + third[0] + third[1] + first[1] + second[0] + second[1] + other[1]
        rows = self.rows(text)
        self.assertEqual(rows["start"][:3], ["3", "-", "300 ms"])
        self.assertEqual(rows["stop"][:3], ["1", "-", "10.0 ms"])
        self.assertNotIn("leave", self.said)

    def test_cut_logs_are_counted(self):
        text = (line("01.000", "OrvMediaClient_stop(): Leave") + call("start", "02.000", "02.004") +
                line("03.000", "OrvMediaClient_pause(): Enter"))
        rows = self.rows(text)
        self.assertEqual(rows["pause"], ["1", "-", "-", "-", "-", "-"])
        self.assertIn("1 call without a line that leaves it, "
                      "1 line that leaves what none has entered.", self.said)

    def test_a_reused_thread_id_begins_anew(self):
        text = line("01.000", "OrvMediaClient_prepare(): Enter") + call("start", "09.000", "09.001")
        rows = self.rows(text)
        self.assertEqual(rows["prepare"][:3], ["1", "-", "-"])
        self.assertEqual(rows["start"][2], "1.00 ms")

    def test_a_process_id_reused_begins_anew(self):
        text = (line("01.000", "OrvMediaClient_prepare(): Enter") +
                line("02.000", "JNI_OnLoad():  g__JavaVM[X] = 0x7f", tid=99) +
                line("03.000", "OrvMediaClient_prepare(): Leave"))
        self.assertEqual(self.rows(text)["prepare"][:3], ["1", "-", "-"])

    def test_midnight_and_new_year(self):
        text = (f"12-31 23:59:59.999 1 1 I {BRIDGE}: OrvMediaClient_start(): Enter\n"
                f"01-01 00:00:00.001 1 1 I {BRIDGE}: OrvMediaClient_start(): Leave\n"
                f"01-01 23:59:59.000 1 1 I {BRIDGE}: OrvMediaClient_stop(): Enter\n"
                f"01-02 00:00:01.000 1 1 I {BRIDGE}: OrvMediaClient_stop(): Leave\n")
        rows = self.rows(text)
        self.assertEqual(rows["start"][2], "2.00 ms")
        self.assertEqual(rows["stop"][2], "2.00 s")

    def test_a_clock_set_back_makes_no_time(self):
        rows = self.rows(call("start", "50.000", "01.000") + call("start", "02.000", "02.010"))
        self.assertEqual(rows["start"][:3], ["2", "-", "10.0 ms"])
        self.assertIn("1 time the clock was set back", self.said)

    def test_several_logs_go_on_where_the_last_ended(self):
        text = call("start", "01.000", "01.004").splitlines(True)
        first, second = self.log(text[0], "first"), self.log(text[1], "second")
        done = self.run_trace(first, second)
        self.assertRegex(done.stdout.decode(), r"start +1 +- +4.00 ms")


class Formats(TraceTest):
    def total(self, text):
        return self.rows(text)["start"][2]

    def both(self, form):
        return "".join(form.format(time=time, text=f"OrvMediaClient_start(): {word}")
                       for time, word in (("10:00:01.000", "Enter"), ("10:00:01.004", "Leave")))

    def test_threadtime_with_modifiers(self):
        for form in ("11-22 {time} 10 11 I OrvMediaClient-JNI: {text}\n",
                     "11-22 {time}    10    11 I OrvMediaClient-JNI: {text} \n",
                     "2026-11-22 {time} +0200 10 11 I OrvMediaClient-JNI: {text}\n",
                     "11-22 {time}  1000    10    11 I OrvMediaClient-JNI: {text}\n",
                     "11-22 {time} u0_a7    10    11 I OrvMediaClient-JNI: {text}\n",
                     "11-22 {time}123 10 11 I OrvMediaClient-JNI: {text}\n",
                     "\033[38;5;40m11-22 {time} 10 11 I OrvMediaClient-JNI: {text}\033[0m\n"):
            with self.subTest(form):
                self.assertEqual(self.total(self.both(form)), "4.00 ms")

    def test_seconds_since_a_start(self):
        text = "".join(f"     {time} 10 11 I {BRIDGE}: OrvMediaClient_start(): {word}\n"
                       for time, word in (("17.000", "Enter"), ("17.004", "Leave")))
        self.assertEqual(self.total(text), "4.00 ms")

    def test_long(self):
        for form in ("[ 11-22 {time} 10:11 I/OrvMediaClient-JNI ]\n{text}\n\n",
                     "[ 11-22 {time}    10:   11 I/OrvMediaClient-JNI ]\n{text}\n\n",
                     "[ 11-22 {time}  1000:   10:   11 I/OrvMediaClient-JNI ]\n{text}\n\n"):
            with self.subTest(form):
                self.assertEqual(self.total(self.both(form)), "4.00 ms")

    def test_time_has_no_threads(self):
        form = "11-22 {time} I/OrvMediaClient-JNI(   10): {text}\n"
        self.assertEqual(self.total(self.both(form)), "4.00 ms")
        self.assertIn("Lines without threads", self.said)

    def test_brief_has_no_times(self):
        rows = self.rows(self.both("I/OrvMediaClient-JNI(   10): {text}\n"))
        self.assertEqual(rows["start"], ["1", "-", "-", "-", "-", "-"])
        self.assertIn("Lines without times", self.said)

    def test_standard_error_of_the_platforms_library(self):
        form = "OrvMediaClient-JNI I 11-22 {time} 10 11 {text}\n\n"
        self.assertEqual(self.total(self.both(form)), "4.00 ms")

    def test_carriage_returns(self):
        form = "11-22 {time} 10 11 I OrvMediaClient-JNI: {text}\r\n"
        self.assertEqual(self.total(self.both(form)), "4.00 ms")

    def test_no_line_end_at_the_end(self):
        self.assertEqual(self.total(call("start", "01.000", "01.004").rstrip("\n")), "4.00 ms")

    def test_huge_lines_are_cut_and_counted(self):
        huge = line("01.001", "x" * 3_000_000, tag="Other")
        text = call("start", "01.000", "01.004").splitlines(True)
        self.assertEqual(self.total(text[0] + huge + "y" * 300_000 + "\n" + text[1]), "4.00 ms")
        self.assertIn("2 lines cut", self.said)
        self.assertIn("4 lines: 2 of the player, 1 of another tag, 1 in no known format", self.said)

    def test_bytes_that_are_no_text(self):
        text = (call("start", "01.000", "01.004").encode() + b"\xff\xfe\x00\n" +
                line("02.000", "q\x00", priority="W").encode().replace(b"q", b"\xc3\x28") +
                bytes(range(256)) * 4)
        marks = [event for event in self.events(text) if event["cat"] == "warning"]
        self.assertEqual(marks[0]["name"], "\ufffd(\x00")


class Traces(TraceTest):
    def test_spans_have_their_times_and_the_logs(self):
        events = self.events(call("start", "01.000", "01.004"))
        self.assertEqual(len(events), 1)
        self.assertEqual(events[0]["name"], "start")
        self.assertEqual((events[0]["pid"], events[0]["tid"]), (10, 11))
        self.assertEqual(events[0]["dur"], 4000)
        self.assertEqual(events[0]["args"], {"at": "11-22 10:00:01.000"})

    def test_nested_calls(self):
        text = (line("01.000", "OrvMediaClient_finalize(): Enter") +
                line("01.001", "OrvMediaClient_release(): Enter") +
                line("01.001", "decVideoSurfaceRef(): Enter") +
                line("01.002", "setMediaService(): Enter") +
                line("01.003", "setMediaService(): Leave") +
                line("01.004", "OrvMediaClient_release(): Leave") +
                line("01.009", "OrvMediaClient_finalize(): Leave"))
        times = {event["name"]: event["dur"] for event in self.events(text)}
        self.assertEqual(times["finalize"], 9000)
        self.assertEqual(times["release"], 3000)
        self.assertEqual(times["setMediaService"], 1000)

    def test_errors_warnings_and_exceptions_are_marks(self):
        text = call("start", "01.000", "01.004") + (
            line("02.000", "service not exist, throw exception. Line:1", priority="E") +
            line("02.001", "OrvMediaService::start(): NO_INIT", priority="E", tag="OrvMediaService") +
            line("02.002", "header x left out", priority="W", tag="TarnPlayer") +
            line("02.003", "OrvMediaService::getDuration(): 3000", priority="E", tag="OrvMediaService") +
            line("02.004", "an error of others", priority="E", tag="Other"))
        marks = [(event["cat"], event["args"]["priority"]) for event in self.events(text)
                 if event["ph"] == "i"]
        self.assertEqual(marks, [("exception", "E"), ("error", "E"), ("warning", "W")])

    def test_a_player_has_a_track_with_its_life_its_waits_and_its_events(self):
        text = (line("01.000", "OrvMediaClient_setup(): Enter") +
                line("01.001", "OrvMediaService::attachPlayer(player)", tag="OrvMediaService") +
                line("01.002", "OrvMediaClient_setup(): Leave") +
                call("prepareAsync", "02.000", "02.001") +
                line("03.000", "MEDIA_PREPARED, this=0xab, prepared", tid=12, tag="OrvMediaService") +
                call("seekTo", "04.000", "04.001") +
                line("04.500", " MEDIA_SEEK_COMPLETE, this=0xab, Received seek complete", tid=12,
                     tag="OrvMediaService") +
                line("05.000", "OrvMediaClient_release(): Enter") +
                line("05.001", "OrvMediaService::disconnect()", tag="OrvMediaService") +
                line("05.002", "OrvMediaClient_release(): Leave"))
        events = self.events(text)
        track = next(key for key, name in self.tracks.items() if name == "player 1")
        mine = {event["name"]: event for event in events if (event["pid"], event["tid"]) == track}
        self.assertEqual(mine["preparing"]["dur"], 1_000_000)
        self.assertEqual(mine["seeking"]["dur"], 500_000)
        self.assertEqual(mine["player"]["dur"], 4_000_000)
        self.assertIn("MEDIA_PREPARED, this=0xab, prepared", mine)
        self.assertEqual(len(mine), 5)

    def test_a_reset_gives_up_what_is_waited_for(self):
        events = self.events(line("01.000", "OrvMediaService::attachPlayer(player)", tag="OrvMediaService") +
                             call("seekTo", "02.000", "02.001") + call("reset", "03.000", "03.001") +
                             call("start", "09.000", "09.001"))
        seek = next(event for event in events if event["name"] == "seeking")
        self.assertEqual((seek["dur"], seek["args"]["end"]), (1_000_000, "not in the log"))

    def test_players_at_a_time_have_the_events_of_their_addresses(self):
        born = "OrvMediaService::attachPlayer(player)"
        text = call("start", "00.000", "00.001") + "".join(
            line(f"01.00{i}", born, tag="OrvMediaService") for i in range(2)) + "".join(
                line(f"02.00{i}", f"MEDIA_PREPARED, this=0x{address}, prepared", tag="OrvMediaService")
                for i, address in enumerate(("a", "b", "a")))
        events = self.events(text)
        counts = {name: sum(event["tid"] == tid and event["ph"] == "i" for event in events)
                  for (_, tid), name in self.tracks.items()}
        self.assertEqual(counts["player 3 (0xa)"], 2)
        self.assertEqual(counts["player 4 (0xb)"], 1)

    def test_standard_output(self):
        done = self.run_trace("-o", "-", "-", data=call("start", "01.000", "01.004").encode())
        self.assertEqual(len(json.loads(done.stdout)["traceEvents"]), 3)
        self.assertIn(b"METHOD", done.stderr)

    def test_an_old_trace_is_replaced_with_its_mode(self):
        out = self.log("old", "out.json")
        out.chmod(0o640)
        self.assertEqual(self.run_trace("-o", out, self.log(call("start", "01.0", "01.1"))).returncode, 0)
        json.loads(out.read_text())
        self.assertEqual(out.stat().st_mode & 0o777, 0o640)
        self.assertEqual(sorted(path.name for path in self.folder.iterdir()), ["log", "out.json"])


class Page(html.parser.HTMLParser):
    def __init__(self, text):
        super().__init__()
        self.links, self.data, self.inside = [], "", False
        self.feed(text)

    def handle_starttag(self, tag, attrs):
        attributes = dict(attrs)
        self.links += [value for key, value in attrs if key in ("src", "href")]
        self.inside = tag == "script" and attributes.get("id") == "data"

    def handle_endtag(self, tag):
        self.inside = False

    def handle_data(self, data):
        if self.inside:
            self.data += data


class Pages(TraceTest):
    def page(self, text):
        out = self.folder / "page.html"
        done = self.run_trace("--html", out, self.log(text))
        self.assertEqual(done.returncode, 0, done.stderr.decode())
        page = Page(out.read_text(encoding="utf-8"))
        self.assertEqual(page.links, [])
        return json.loads(page.data)

    def test_it_has_the_table_and_the_timeline(self):
        evil = "</script><script>alert(1)</script>"
        data = self.page(call("start", "01.000", "01.004") + line("02.000", evil, priority="W"))
        self.assertEqual(data["table"][1][0], "start")
        self.assertEqual(data["spans"], [{"track": 0, "name": "start", "begin": 0, "time": 4000,
                                          "at": "11-22 10:00:01.000", "kind": "native"}])
        self.assertEqual(data["marks"][0]["name"], evil)
        self.assertIn("3 of the player", data["summary"])

    def test_of_many_spans_it_has_the_longest(self):
        text = "".join(f"11-22 {i // 3600:02}:{i // 60 % 60:02}:{i % 60:02}.{fraction} 1 1 I {BRIDGE}: "
                       f"OrvMediaClient_start(): {word}\n"
                       for i in range(21000)
                       for fraction, word in (("000", "Enter"), ("002" if i < 1000 else "009", "Leave")))
        data = self.page(text)
        self.assertEqual(data["allSpans"], 21000)
        self.assertEqual(len(data["spans"]), 20000)
        self.assertEqual({span["time"] for span in data["spans"]}, {9000})


class Refusals(TraceTest):
    def test_an_empty_log(self):
        self.assertIn("is empty", self.refused("-o", self.folder / "out", self.log("")))

    def test_what_is_no_log(self):
        self.assertIn("is no log: none of 2 lines",
                      self.refused("-o", self.folder / "out", self.log("one\ntwo\n")))

    def test_a_log_without_the_player(self):
        self.assertIn("nothing of the player", self.refused(self.log(line("01.000", "x", tag="Other"))))

    def test_a_log_without_calls(self):
        self.assertIn("no call of a native method",
                      self.refused(self.log(line("01.000", "OrvMediaClient_start(): Leave"))))

    def test_a_log_that_is_not_there_or_a_folder(self):
        self.assertIn("cannot be read: No such file", self.refused(self.folder / "none"))
        self.assertIn("cannot be read: Is a directory", self.refused(self.folder))

    def test_a_trace_that_cannot_be_written(self):
        log = self.log(call("start", "01.000", "01.004"))
        self.assertIn("cannot be written", self.refused("-o", self.folder / "no/out", log))
        self.assertIn("cannot be written", self.refused("-o", self.folder, log))
        self.assertIn("cannot be written", self.refused("--html", "/dev/full", log))
        self.assertIn("cannot be written", self.refused("-o", "/dev/full", log))

    def test_a_trace_of_no_times(self):
        out = self.folder / "out"
        log = self.log(f"I/{BRIDGE}( 10): OrvMediaClient_start(): Enter\n")
        self.assertIn("has no times", self.refused("-o", out, log))

    def test_wrong_arguments(self):
        self.assertIn("needs a log", self.refused(status=2))
        self.assertIn("does not know '--nonsense'", self.refused("--nonsense", "x", status=2))
        self.assertIn("does not know '-x'", self.refused("-x", "y", status=2))
        self.assertIn("'-o' lacks", self.refused("-o", status=2))

    def test_help(self):
        done = self.run_trace("--help")
        self.assertEqual((done.returncode, done.stderr), (0, b""))
        self.assertIn(b"--live", done.stdout)

    def test_an_interrupted_run_leaves_nothing(self):
        out = self.folder / "out.json"
        with subprocess.Popen([TRACE, "-o", out, "-"], stdin=subprocess.PIPE,
                              stdout=subprocess.PIPE, stderr=subprocess.PIPE) as process:
            process.stdin.write(call("start", "01.000", "01.004").encode())
            process.stdin.flush()
            while not list(self.folder.iterdir()):
                self.assertIsNone(process.poll())
            process.send_signal(signal.SIGINT)
            self.assertEqual(process.wait(60), 130)
        self.assertEqual(list(self.folder.iterdir()), [])


class Live(TraceTest):
    """Waits for what is printed, with a watchdog in place of a time."""

    def start(self, *arguments, **options):
        # pylint: disable=consider-using-with
        process = subprocess.Popen([TRACE, "--live", *map(str, arguments)], stdout=subprocess.PIPE,
                                   stderr=subprocess.PIPE, **options)
        watchdog = threading.Timer(120, process.kill)
        watchdog.start()
        self.addCleanup(watchdog.cancel)
        self.addCleanup(process.stderr.close)
        self.addCleanup(process.stdout.close)
        self.addCleanup(process.wait)
        self.addCleanup(process.kill)
        return process

    def wait_for(self, process, pattern):
        for row in process.stdout:
            if re.search(pattern, row.decode()):
                return
        self.fail(f"it ends without '{pattern}': {process.stderr.read().decode()}")

    def test_a_file_that_grows_and_is_replaced(self):
        log, out = self.log(call("start", "01.000", "01.004")), self.folder / "out.json"
        process = self.start("-o", out, log)
        self.wait_for(process, r"^start +1 ")
        with log.open("a") as file:
            file.write(call("start", "02.000", "02.004"))
        self.wait_for(process, r"^start +2 ")
        self.log(call("stop", "03.000", "03.004"), "new").rename(log)
        self.wait_for(process, r"^stop +1 ")
        self.assertFalse(out.exists())
        process.send_signal(signal.SIGINT)
        process.stdout.read()
        self.assertEqual(process.wait(), 0)
        names = [event["name"] for event in json.loads(out.read_text())["traceEvents"]
                 if event["ph"] == "X"]
        self.assertEqual(names, ["start", "start", "stop"])

    def test_half_a_line_waits_for_the_rest(self):
        text = call("start", "01.000", "01.004")
        log = self.log(call("stop", "00.000", "00.001") + text[:-10])
        process = self.start(log)
        self.wait_for(process, r"^stop +1 ")
        with log.open("a") as file:
            file.write(text[-10:])
        self.wait_for(process, r"^start +1 +- +4.00 ms")
        process.send_signal(signal.SIGTERM)
        process.stdout.read()
        self.assertEqual(process.wait(), 0)

    def test_a_pipe_until_its_end(self):
        process = self.start("-", stdin=subprocess.PIPE)
        process.stdin.write(call("start", "01.000", "01.004").encode())
        process.stdin.flush()
        self.wait_for(process, r"^start +1 ")
        process.stdin.write(call("start", "02.000", "02.004").encode())
        process.stdin.close()
        self.wait_for(process, r"^start +2 ")
        process.stdout.read()
        self.assertEqual(process.wait(), 0)


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
