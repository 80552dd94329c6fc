# SPDX-License-Identifier: Apache-2.0
"""Runs a program and measures it with all that it starts.

Processor time is what the kernel accounts to the program and its descendants
when they have ended (wait4): this process adopts those that outlive their
parents, so none is missed. Memory is the largest sum of the resident memory of
all of them, taken from /proc every 50 ms, or of the largest one as the kernel
has it when that is more; pages that two of them share count twice."""

import ctypes
import dataclasses
import os
import shutil
import signal
import subprocess
import tempfile
import threading
import time

from figures import Failed

SAMPLE_SECONDS = 0.05
END_SECONDS = 30
PR_SET_CHILD_SUBREAPER = 36
PAGE_BYTES = os.sysconf("SC_PAGE_SIZE")


@dataclasses.dataclass
class Usage:
    wall: float  # seconds
    cpu: float  # seconds
    memory: float  # MiB
    status: int
    out: str
    err: str

    def figures(self):
        return {"time": self.wall, "cpu": self.cpu, "memory": self.memory}

    def demand_success(self):
        if self.status != 0:
            raise Failed(self.reason())
        return self

    def reason(self):
        lines = [line.strip() for line in self.err.splitlines() if line.strip()]
        if self.status < 0:
            return f"ended by {signal.Signals(-self.status).name}"
        return f"status {self.status}" + (f", {lines[-1]}" if lines else "")


class Tree:
    """A program that runs. It has a session of its own; whatever is left of
    that when the program ends is ended, too."""

    def __init__(self, command, environment=None):
        require_program(command[0])
        adopt_orphans()
        self.folder = tempfile.mkdtemp(prefix="orv-bench-")
        self._children_before = children(os.getpid())
        self.out = tempfile.TemporaryFile()
        self.err = tempfile.TemporaryFile()
        self.started = time.monotonic()
        self.process = subprocess.Popen(
            command, cwd=self.folder, env=environment, stdin=subprocess.DEVNULL,
            stdout=self.out, stderr=self.err, start_new_session=True)
        self.pid = self.process.pid
        self._stop_sampling = threading.Event()
        self.largest = 0
        self._sampler = threading.Thread(target=self._sample, daemon=True)
        self._sampler.start()

    def has_ended(self):
        """Whether the program itself has; it is not waited for yet then."""
        return os.waitid(os.P_PID, self.pid, os.WEXITED | os.WNOHANG | os.WNOWAIT) is not None

    def end(self):
        """Asks it to end, and waits for that."""
        os.kill(self.pid, signal.SIGTERM)
        return self.finish(END_SECONDS)

    def finish(self, limit):
        """Waits for the end, at most that many seconds, and frees everything."""
        hung = threading.Event()
        timer = threading.Timer(limit, lambda: (hung.set(), self._kill()))
        timer.start()
        try:
            # Without reaping it, so that the group cannot be another's yet.
            os.waitid(os.P_PID, self.pid, os.WEXITED | os.WNOWAIT)
            wall = time.monotonic() - self.started
        except BaseException:
            self._kill()
            raise
        finally:
            timer.cancel()
            timer.join()
            self._stop_sampling.set()
            self._sampler.join()
            self._kill()
            usage = self._reap()
        if hung.is_set():
            raise Failed(f"not done after {limit:g} s")
        return dataclasses.replace(usage, wall=wall)

    def _sample(self):
        while not self._stop_sampling.wait(SAMPLE_SECONDS):
            self.largest = max(self.largest, sum(map(resident_bytes, descendants(self.pid))))

    def _kill(self):
        try:
            os.killpg(self.pid, signal.SIGKILL)
        except ProcessLookupError:
            pass

    def _reap(self):
        _, status, used = os.wait4(self.pid, 0)
        self.process.returncode = os.waitstatus_to_exitcode(status)
        cpu = used.ru_utime + used.ru_stime
        largest = max(self.largest, used.ru_maxrss * 1024)
        for orphan in children(os.getpid()) - self._children_before:
            _, _, used = os.wait4(orphan, 0)
            cpu += used.ru_utime + used.ru_stime
        shutil.rmtree(self.folder, ignore_errors=True)
        texts = []
        for file in (self.out, self.err):
            file.seek(0)
            texts.append(file.read().decode(errors="replace"))
            file.close()
        return Usage(0, cpu, largest / 2**20, self.process.returncode, *texts)


def run(command, limit=120, environment=None):
    return Tree(command, environment).finish(limit).demand_success()


def require_program(name):
    if shutil.which(name) is None:
        raise Failed(f"there is no {name} here")


def adopt_orphans():
    if ctypes.CDLL(None, use_errno=True).prctl(PR_SET_CHILD_SUBREAPER, 1, 0, 0, 0) != 0:
        raise OSError(ctypes.get_errno(), "the orphans of what is measured cannot be adopted")


def children(pid):
    found = set()
    try:
        for thread in os.listdir(f"/proc/{pid}/task"):
            with open(f"/proc/{pid}/task/{thread}/children", encoding="ascii") as file:
                found.update(map(int, file.read().split()))
    except (FileNotFoundError, ProcessLookupError):
        pass  # It has ended meanwhile.
    return found


def descendants(pid):
    """Those that run, the process itself among them."""
    found, waiting = set(), [pid]
    while waiting:
        found.add(each := waiting.pop())
        waiting += children(each) - found
    return found


def resident_bytes(pid):
    try:
        with open(f"/proc/{pid}/statm", encoding="ascii") as file:
            return int(file.read().split()[1]) * PAGE_BYTES
    except (FileNotFoundError, ProcessLookupError):
        return 0


def processor_seconds(pid):
    """What a process that runs has used so far, without those it started."""
    with open(f"/proc/{pid}/stat", encoding="ascii", errors="replace") as file:
        fields = file.read().rpartition(")")[2].split()
    return (int(fields[11]) + int(fields[12])) / os.sysconf("SC_CLK_TCK")
