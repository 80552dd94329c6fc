# SPDX-License-Identifier: Apache-2.0
"""Runs programs that a mutant may have spoilt: with a limit of time, memory and
output, and nothing that they started left behind."""

import os
import resource
import signal
import subprocess
import tempfile
import threading
import time

MEMORY = 3 << 30
OUTPUT = 256 << 20

now = time.monotonic

_running = set()
_lock = threading.Lock()
_ended = False


class TimedOut(Exception):
    pass


class Interrupted(Exception):
    pass


def limit():
    resource.setrlimit(resource.RLIMIT_DATA, (MEMORY, MEMORY))
    resource.setrlimit(resource.RLIMIT_FSIZE, (OUTPUT, OUTPUT))
    resource.setrlimit(resource.RLIMIT_CORE, (0, 0))


def run(command, folder, environment=None, seconds=None, is_limited=True):
    """(status, what it wrote on its standard output)"""
    with tempfile.TemporaryFile() as out:
        with _lock:
            if _ended:
                raise Interrupted
            process = subprocess.Popen(
                command, cwd=folder, env=environment, stdin=subprocess.DEVNULL, stdout=out,
                stderr=subprocess.DEVNULL, start_new_session=True,
                preexec_fn=limit if is_limited else None)
            _running.add(process)
        try:
            status = process.wait(seconds)
        except subprocess.TimeoutExpired:
            raise TimedOut from None
        finally:
            end(process)
        if _ended:
            raise Interrupted
        out.seek(0)
        return status, out.read().decode(errors="replace")


def succeeds(command, folder):
    return run(command, folder, is_limited=False)[0] == 0


def end(process):
    """With all of its session's first group."""
    try:
        os.killpg(process.pid, signal.SIGKILL)
    except ProcessLookupError:
        pass
    process.wait()
    with _lock:
        _running.discard(process)


def end_all():
    """Those that run in other threads, which then meet Interrupted; none starts again."""
    global _ended
    with _lock:
        _ended = True
        for process in _running:
            try:
                os.killpg(process.pid, signal.SIGKILL)
            except ProcessLookupError:
                pass
