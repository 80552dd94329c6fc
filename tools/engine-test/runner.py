# SPDX-License-Identifier: Apache-2.0
"""Runs each row in a process of its own, which a watchdog ends."""

import collections
import concurrent.futures
import json
import os
import pathlib
import signal
import subprocess
import tempfile

PASS, FAIL, NOT_OFFERED = "pass", "FAIL", "not offered"
# said: why, in lines; empty for a pass.
Outcome = collections.namedtuple("Outcome", "row result said")


class Kit:
    """The program with the tests, and how it is started on an engine."""

    def __init__(self, description, engine, media, address):
        about = json.loads(pathlib.Path(description).read_text(encoding="utf-8"))
        # The program asks for liborvtarn.so, whatever the engine's file is called.
        self._folder = tempfile.TemporaryDirectory(prefix="orv-engine-")
        engine = pathlib.Path(engine).resolve()
        (pathlib.Path(self._folder.name) / "liborvtarn.so").symlink_to(engine)
        paths = f"{self._folder.name}:{engine.parent}"
        self._environment = {**os.environ, "ORV_KIT_MEDIA": str(media),
                             "ORV_KIT_ADDRESS": address, "ORV_KIT_FILES": self._folder.name}
        emulator = [word.replace("LD_LIBRARY_PATH=", f"LD_LIBRARY_PATH={paths}:")
                    for word in about["emulator"]]
        if not emulator:
            self._environment["LD_LIBRARY_PATH"] = paths
        self._command = [*emulator, about["program"]]
        self._running = set()

    def __enter__(self):
        return self

    def __exit__(self, *_):
        self._folder.cleanup()

    def start(self, limit, *arguments, **environment):
        """(status, or None when it had to be ended, what it wrote)"""
        with tempfile.TemporaryFile() as output:
            process = subprocess.Popen(
                [*self._command, *arguments], stdin=subprocess.DEVNULL, stdout=output,
                stderr=subprocess.STDOUT, env={**self._environment, **environment},
                start_new_session=True)
            self._running.add(process)
            try:
                status = process.wait(limit)
            except subprocess.TimeoutExpired:
                status = None
            finally:
                end(process)
                self._running.discard(process)
            output.seek(0)
            return status, output.read().decode("utf-8", "replace")

    def load_error(self, limit):
        """What the dynamic linker says of the engine with all symbols looked up; None
        when it is content."""
        status, text = self.start(limit, "--gtest_list_tests", LD_BIND_NOW="1")
        if status == 0:
            return None
        return text if status is not None else "loading it did not end"

    def run(self, row, limit):
        with tempfile.NamedTemporaryFile(suffix=".json", dir=self._folder.name) as report:
            status, text = self.start(limit, f"--gtest_filter={row.test}",
                                      f"--gtest_output=json:{report.name}")
            return judge(row, status, text, report.read(), limit)

    def run_all(self, rows, limit, jobs):
        """Outcomes in the order of the rows. An interruption ends those under way."""
        pool = concurrent.futures.ThreadPoolExecutor(jobs)
        try:
            yield from pool.map(lambda row: self.run(row, limit), rows)
        finally:
            pool.shutdown(wait=False, cancel_futures=True)
            for process in list(self._running):
                end(process)
            pool.shutdown()


def end(process):
    """Also those that the engine has started."""
    try:
        os.killpg(process.pid, signal.SIGKILL)
    except ProcessLookupError:
        pass
    process.wait()


def judge(row, status, text, report, limit):
    try:
        suites = json.loads(report)["testsuites"]
    except (ValueError, KeyError):
        suites = []
    tests = [test for suite in suites for test in suite["testsuite"]]
    failures = [failure["failure"] for test in tests for failure in test.get("failures", [])]
    if failures:
        return Outcome(row, FAIL, failures[0].splitlines())
    if status is None:
        return Outcome(row, FAIL, [f"it hangs: not over after {limit} seconds"])
    if status != 0 or not tests:
        return Outcome(row, FAIL, [f"it {ending(status)}", *last_lines(text)])
    why = tests[0].get("notOffered")
    return Outcome(row, NOT_OFFERED, [why]) if why else Outcome(row, PASS, [])


def ending(status):
    if status < 0:
        return f"crashes: {signal.Signals(-status).name}"
    return f"ends the process with status {status}"


def last_lines(text):
    lines = [line for line in text.splitlines() if line.strip() and not line.startswith("[")]
    return lines[-3:]
