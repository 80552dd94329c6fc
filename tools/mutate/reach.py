# SPDX-License-Identifier: Apache-2.0
"""Which tests call which function, and how long each takes: from one run of a test
program without a mutant, which also shows that all of them pass without one."""

import hashlib
import json
import os
import pathlib
import re

import gtest
import processes
import tests
from mutant import Failed

SOURCE = pathlib.Path(__file__).with_name("Reach.cpp")
INSTRUMENTED = ["-O1", "-g1", "-w", "-finstrument-functions",
                "-finstrument-functions-exclude-file-list=/usr/"]
LIMIT_SECONDS = 600
GROUP = 40  # tests in a process


class Reach:
    """durations: seconds by test; calls: tests by file and first line of a function."""

    def __init__(self, durations, calls):
        self.durations = durations
        self._calls = calls

    def tests_for(self, mutant):
        """Those that call its function, the quickest first; all, when none is known to."""
        lines = self._calls.get(mutant.file, {})
        found = {test for line, reached in lines.items()
                 if mutant.first_line <= int(line) <= mutant.last_line for test in reached}
        found &= self.durations.keys()
        return sorted(found or self.durations, key=lambda test: (self.durations[test], test))


def measure(area, workshop, pool_map, environment, say):
    """Of an area's program; kept for as long as the program stays the same."""
    kept = area.build / "mutate" / f"reach-{area.name}.json"
    digest = hashlib.sha256(area.program.read_bytes() + SOURCE.read_bytes()).hexdigest()
    known = kept_at(kept, digest)
    if known:
        return known
    say("building and running every test without a mutant")
    program = instrumented(area, workshop, pool_map)
    names = gtest.names(program)
    if not names:
        raise Failed(f"{program.name} does not list its tests.")
    count = max(1, len(names) // GROUP)
    groups = [names[i::count] for i in range(count)]
    notes = workshop.folder / "reach"
    notes.unlink(missing_ok=True)

    def run(group):
        return gtest.run(program, group, {**environment(), "ORV_REACH": str(notes)}, LIMIT_SECONDS)
    durations = pass_all(run, groups, pool_map, program.name)
    return keep(kept, digest, durations, read_notes(notes, program, workshop, area))


def kept_at(path, digest):
    """What an earlier run has measured of the same; or None."""
    if path.is_file():
        content = json.loads(path.read_text())
        if content["digest"] == digest:
            return Reach(content["durations"], content["calls"])
    return None


def keep(path, digest, durations, calls):
    path.write_text(json.dumps({"digest": digest, "durations": durations, "calls": calls}))
    return Reach(durations, calls)


def pass_all(run, groups, pool_map, what):
    """Seconds of each test of those groups, all of which must pass."""
    def failure(test):
        return Failed(f"{test} of {what} fails without a mutant." if test else
                      f"{what} does not end without a mutant.")
    durations = {}
    for passed in pool_map(lambda group: tests.passing(run, group, failure), groups):
        durations.update(passed)
    return durations


def instrumented(area, workshop, pool_map):
    done = pool_map(lambda unit: workshop.compile(unit, INSTRUMENTED),
                    area.units)
    listener = workshop.folder / "Reach.o"
    compiler = [word for word in area.units[0].command if not word.startswith("-")]
    if not all(done) or not processes.succeeds(
            [*compiler, "-std=c++17", "-O1", "-c", "-o", str(listener), str(SOURCE)], area.base):
        raise Failed("the sources cannot be compiled with -finstrument-functions.")
    return workshop.link(area.units, [str(listener)])


def read_notes(notes, program, workshop, area):
    by_test, addresses = {}, set()
    for line in notes.read_text().splitlines():
        test, *reached = line.split(" ")
        by_test.setdefault(test, set()).update(reached)
        addresses.update(reached)
    places = places_of(sorted(addresses), program, workshop, area)
    calls = {}
    for test, reached in sorted(by_test.items()):
        for address in reached:
            if address in places:
                file, line = places[address]
                calls.setdefault(file, {}).setdefault(line, []).append(test)
    return calls


def places_of(addresses, program, workshop, area):
    """(file, line) of each function of the area."""
    listed = workshop.folder / "addresses"
    listed.write_text("\n".join(addresses))
    status, out = processes.run(
        ["sh", "-c", 'exec addr2line -e "$1" <"$2"', "sh", str(program), str(listed)],
        workshop.folder, is_limited=False)
    if status != 0:
        raise Failed("addr2line cannot read the test program.")
    places = {}
    for address, line in zip(addresses, out.splitlines()):
        found = re.match(r"(.+):(\d+)", line)
        if not found:
            continue
        path = os.path.realpath(found[1])
        if path.startswith(f"{workshop.folder}/{area.folder}/"):
            places[address] = (os.path.relpath(path, workshop.folder), found[2])
    return places
