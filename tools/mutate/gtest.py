# SPDX-License-Identifier: Apache-2.0
"""Runs chosen tests of a GoogleTest program, and says which failed first."""

import re
import tempfile

import processes
from tests import UNNAMED, Run

STARTED = re.compile(r"^\[ RUN      \] (\S+)", re.MULTILINE)
ENDED = re.compile(r"^\[       OK \] (\S+?),? .*?\((\d+) ms\)", re.MULTILINE)
SKIPPED = re.compile(r"^\[  SKIPPED \] (\S+?) \(", re.MULTILINE)


def names(program):
    status, out = processes.run([program, "--gtest_list_tests"], program.parent)
    if status != 0:
        return []
    result, suite = [], ""
    for line in out.splitlines():
        line = line.split("#")[0].rstrip()
        if line.endswith(".") and not line.startswith(" "):
            suite = line
        elif line.startswith("  "):
            result.append(suite + line.strip())
    return result


def run(program, tests, environment, seconds):
    """Those tests, in the program's own order, up to the first that fails."""
    with tempfile.NamedTemporaryFile("w", prefix="orv-mutate-", suffix=".flags") as flags:
        flags.write("--gtest_filter=" + ":".join(tests) + "\n")
        flags.flush()
        command = [program, f"--gtest_flagfile={flags.name}", "--gtest_fail_fast=1",
                   "--gtest_color=no"]
        try:
            status, out = processes.run(command, program.parent, environment, seconds)
        except processes.TimedOut:
            return Run({}, None, True)
    passed = {name: int(ms) / 1000 for name, ms in ENDED.findall(out)}
    passed.update({name: 0.0 for name in SKIPPED.findall(out)})
    if status == 0 and STARTED.search(out):
        return Run(passed)
    started = [name for name in STARTED.findall(out) if name not in passed]
    return Run(passed, started[0] if started else UNNAMED)
