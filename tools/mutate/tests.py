# SPDX-License-Identifier: Apache-2.0
"""What running some tests gave, and how many run in one process."""

import dataclasses

SLICE_SECONDS = 15
SLICE_TESTS = 400
UNNAMED = "(before any test)"
TRIES = 3  # by itself, on a machine that may be busy


@dataclasses.dataclass
class Run:
    passed: dict  # seconds of each test that passed
    failed: str = None  # the first test that did not
    timed_out: bool = False


def slices(tests, durations):
    """Groups of tests that one process runs, the first ones first."""
    group, total = [], 0
    for test in tests:
        seconds = durations.get(test, 0.1)
        if group and (total + seconds > SLICE_SECONDS or len(group) >= SLICE_TESTS):
            yield group
            group, total = [], 0
        group.append(test)
        total += seconds
    if group:
        yield group


def passing(run, tests, failure):
    """Seconds of each test. One that fails beside others has more chances by itself.

    run(tests) gives a Run; failure(test) makes the exception for one that fails, or for
    None when they do not end."""
    durations, left = {}, list(tests)
    while left:
        result = run(left)
        if result.timed_out:
            raise failure(None)
        durations.update(result.passed)
        if not result.failed:
            break
        passed = by_itself(run, result.failed) if result.failed in left else {}
        if not passed:
            raise failure(result.failed)
        durations.update(passed)
        left = [test for test in left if test not in durations]
    return durations


def by_itself(run, test):
    for _ in range(TRIES):
        alone = run([test])
        if alone.passed and not alone.failed and not alone.timed_out:
            return alone.passed
    return {}
