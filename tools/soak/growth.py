# SPDX-License-Identifier: Apache-2.0
"""What must not grow from cycle to cycle, and whether it does."""

from dataclasses import dataclass

from fit import Fit, fit, median

KIB = 1024
# The part of a run in which caches fill and code is compiled.
WARM_UP = 0.25
FEWEST = 8  # checkpoints after that


@dataclass(frozen=True)
class Quantity:
    """scale: what a unit is of the checkpoints' figures. No leak are, in those figures: a rate
    of `noise` for each cycle, and `slack` over the whole run, which caches take that fill up
    slowly; None for half as much again as there is."""
    key: str
    name: str
    unit: str
    scale: float
    noise: float
    slack: float | None


QUANTITIES = (
    Quantity("native", "allocated memory", "KiB", KIB, KIB, 1024 * KIB),
    Quantity("rss", "resident memory", "KiB", KIB, 3 * KIB, 8 * 1024 * KIB),
    Quantity("heap", "Java heap", "KiB", KIB, 64, 192 * KIB),
    Quantity("threads", "threads", "", 1, 0.002, 3),
    Quantity("descriptors", "descriptors", "", 1, 0.002, 3),
    Quantity("references", "JNI global references", "", 1, 0.002, 3),
    Quantity("open", "open", "ms", 1, 0, None),
    Quantity("seek", "seek", "ms", 1, 0, None),
)


@dataclass(frozen=True)
class Finding:
    """line: of the figure over the cycles; None with too few checkpoints."""
    quantity: Quantity
    points: list
    line: Fit | None
    grows: bool


def settled(points):
    """Without the warm-up."""
    return points[int(len(points) * WARM_UP):]


def find(checkpoints):
    """A finding for each quantity."""
    return [_find(quantity, [(row["cycles"], row[quantity.key]) for row in checkpoints
                             if row.get(quantity.key) is not None])
            for quantity in QUANTITIES]


def _find(quantity, points):
    rest = settled(points)
    if len(rest) < FEWEST:
        return Finding(quantity, points, None, False)
    line = fit(rest)
    return Finding(quantity, points, line, _grows(quantity, rest, line))


def _grows(quantity, points, line):
    """A leak goes on for as long as the run; what fills up once has a second half that is flat."""
    slack = quantity.slack
    if slack is None:
        slack = median(sorted(y for _, y in points)) / 2
    noise = max(quantity.noise, slack / (points[-1][0] - points[0][0]))
    return line.least > noise and fit(points[len(points) // 2:]).slope > noise
