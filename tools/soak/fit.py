# SPDX-License-Identifier: Apache-2.0
"""A straight line through points of which some are far off: the median of the slopes of all
pairs (Theil and Sen), with the bounds that Kendall's statistic gives."""

import math
from dataclasses import dataclass

# Of the normal distribution, for bounds between which a slope of pure noise is 99 times of 100.
CONFIDENCE = 2.576


@dataclass(frozen=True)
class Fit:
    """slope: per unit of x, certainly between least and most."""
    slope: float
    least: float
    most: float
    offset: float

    def at(self, x):
        return self.offset + self.slope * x


def fit(points):
    """Of (x, y), at least two; x must rise."""
    slopes = sorted((y2 - y1) / (x2 - x1) for index, (x1, y1) in enumerate(points)
                    for x2, y2 in points[index + 1:])
    slope = median(slopes)
    count = len(points)
    spread = CONFIDENCE * math.sqrt(count * (count - 1) * (2 * count + 5) / 18)
    first = math.floor((len(slopes) - spread) / 2)
    last = math.ceil((len(slopes) + spread) / 2)
    return Fit(slope,
               slopes[first] if first >= 0 else -math.inf,
               slopes[last] if last < len(slopes) else math.inf,
               median(sorted(y - slope * x for x, y in points)))


def median(values):
    """Of sorted numbers."""
    middle = len(values) // 2
    return values[middle] if len(values) % 2 else (values[middle - 1] + values[middle]) / 2
