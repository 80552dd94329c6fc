# SPDX-License-Identifier: Apache-2.0
"""Runs programs in process groups of their own, each with a time limit."""

import dataclasses
import os
import signal
import subprocess
import tempfile
import threading

_running = set()
_lock = threading.Lock()
_stopping = False


@dataclasses.dataclass
class Outcome:
    """How a program ended. The status is None when it reached the limit, and
    negative for a signal, as it is in the subprocess module."""
    status: int | None
    out: bytes
    err: str

    def hung(self):
        return self.status is None

    def crashed(self):
        """Whether a signal ended it, also one that a shell around it reports
        in its status, or a Java exception that nobody caught."""
        if self.status is None:
            return False
        return self.status < 0 or self.status > 128 or \
            any(line.startswith("\tat ") for line in self.err.splitlines())

    def succeeded(self):
        return self.status == 0

    def reason(self):
        """What it said last, on one line, or how it ended."""
        if self.status is not None and self.status < 0:
            return signal.Signals(-self.status).name
        lines = [line.strip() for line in self.err.splitlines()
                 if line.strip() and not line.startswith("\tat ")]
        return lines[-1] if lines else f"status {self.status}"


def run(command, limit, environment=None):
    """Runs a program to its end, or to the end of its whole process group
    after `limit` seconds. What it leaves in its working folder is removed."""
    with tempfile.TemporaryDirectory() as folder, \
            tempfile.TemporaryFile() as out, tempfile.TemporaryFile() as err:
        # Files, not pipes: a grandchild that escapes would keep those open.
        process = subprocess.Popen(command, cwd=folder, env=environment, stdin=subprocess.DEVNULL,
                                   stdout=out, stderr=err, start_new_session=True)
        _register(process)
        try:
            status = process.wait(limit)
        except subprocess.TimeoutExpired:
            status = None
            _kill(process)
        finally:
            _forget(process)
        out.seek(0)
        err.seek(0)
        return Outcome(status, out.read(), err.read().decode(errors="replace"))


def stop_all():
    """Ends every program that runs, and those that would be started."""
    global _stopping
    with _lock:
        _stopping = True
        for process in _running:
            _kill_group(process)


def _register(process):
    with _lock:
        _running.add(process)
        if _stopping:
            _kill_group(process)


def _forget(process):
    with _lock:
        _running.discard(process)


def _kill(process):
    _kill_group(process)
    process.wait()


def _kill_group(process):
    try:
        os.killpg(process.pid, signal.SIGKILL)
    except ProcessLookupError:
        pass
