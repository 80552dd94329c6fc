# SPDX-License-Identifier: Apache-2.0
"""Players by the thousand that do nothing. What more of them cost than one is
the ratio: each stands beside a single one of the same round."""

from figures import Comparison, Goal, Quantity, Side
from tree import run

COUNTS = (1, 10, 100, 1000)
MOST = COUNTS[-1]
IDLE_SECONDS = 10
LIMIT = 300


def comparisons(place):
    return [*(_each(place, count) for count in COUNTS[1:]), _all(place)]


def _run(place, count, idle_seconds):
    """(what the program printed, its usage)"""
    program = place.java("com.quintora.mmp.Players", str(count), str(idle_seconds))
    usage = run(program, LIMIT, {**place.environment(), "ORV_LOG": "silent"})
    return [float(line) for line in usage.out.split()], usage


def _all(place):
    def take():
        (made, idle, released), usage = _run(place, MOST, IDLE_SECONDS)
        return {"make": made, "idle": 100 * idle / IDLE_SECONDS, "release": released,
                "memory": usage.memory}
    return Comparison(
        f"players-{MOST}-together",
        (Quantity("make", "s", Goal(3, "value")),
         Quantity("idle", "% of a core", Goal(0.5, "value")),
         Quantity("release", "s"), Quantity("memory", "MiB")),
        Side(f"{MOST} players", take))


def _each(place, count):
    def take(number):
        (made, _, released), _ = _run(place, number, 0)
        return {"make": 1000 * made / number, "release": 1000 * released / number}
    return Comparison(
        f"players-{count}-each", (Quantity("make", "ms"), Quantity("release", "ms")),
        Side(f"of {count}", lambda: take(count)), Side("a single one", lambda: take(1)))
