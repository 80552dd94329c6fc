# SPDX-License-Identifier: Apache-2.0
"""Tries the mutants of an area: makes each, and runs the tests that could notice."""

import collections
import concurrent.futures
import queue
import threading

import tests

# A test that waits takes longer beside others; a hang takes for ever.
LIMIT_FACTOR = 8
LIMIT_SECONDS = 20


class Trial:
    """Of an area, which makes mutants and runs tests."""

    def __init__(self, area, jobs, environments, confirms, say):
        """environments: one for each job; confirms: a failure counts when it comes twice,
        as tests that play media may miss their moment on a busy machine."""
        self._area = area
        self._jobs = jobs
        self._environments = queue.Queue()
        for environment in environments:
            self._environments.put(environment)
        self._confirms = confirms
        self._say = say
        self._workshops = queue.Queue()
        self._killers = collections.defaultdict(collections.Counter)
        self._lock = threading.Lock()

    def begin(self):
        self._area.prepare()
        for number in range(self._jobs):
            self._workshops.put(self._area.workshop(f"job-{number}"))
        workshop = self._workshops.get()
        with concurrent.futures.ThreadPoolExecutor(self._jobs) as pool:
            self._reach = self._area.measure(
                workshop, lambda work, items: list(pool.map(work, items)),
                self._borrowed_environment, self._say)
        self._workshops.put(workshop)

    def _borrowed_environment(self):
        environment = self._environments.get()
        self._environments.put(environment)
        return environment

    def judge(self, mutant):
        """(outcome, detail)"""
        workshop, environment = self._workshops.get(), self._environments.get()
        try:
            program = workshop.make(mutant)
            if program is None:
                return "did not compile", ""
            return self._test(program, mutant, environment)
        finally:
            self._workshops.put(workshop)
            self._environments.put(environment)

    def _test(self, program, mutant, environment):
        chosen = self._ordered(mutant)
        durations = self._reach.durations
        for group in tests.slices(chosen, durations):
            limit = LIMIT_SECONDS + LIMIT_FACTOR * sum(durations[t] for t in group)
            while group:
                run = self._area.run(program, group, environment, limit)
                if run.timed_out:
                    return "timed out", f"after {limit:.0f} s"
                if run.failed and self._is_certain(program, run.failed, environment, limit):
                    self._note(mutant, run.failed)
                    return "noticed", run.failed
                group = [t for t in group if t not in run.passed and t != run.failed] \
                    if run.failed else []
        return "unnoticed", f"{len(chosen)} tests ran"

    def _is_certain(self, program, test, environment, limit):
        if not self._confirms or test not in self._reach.durations:
            return True
        again = self._area.run(program, [test], environment, limit)
        return bool(again.failed or again.timed_out)

    # What noticed others in the same file will often notice this one, too.
    def _ordered(self, mutant):
        found = self._reach.tests_for(mutant)
        with self._lock:
            killers = dict(self._killers[mutant.file])
        return sorted(found, key=lambda test: -killers.get(test, 0))

    def _note(self, mutant, test):
        with self._lock:
            self._killers[mutant.file][test] += 1
