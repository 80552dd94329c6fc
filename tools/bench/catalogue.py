# SPDX-License-Identifier: Apache-2.0
"""All that is measured, in the order of the table."""

import bridge
import many
import playing
import processes
import seeks
import walls
from place import Place

__all__ = ["Place", "comparisons"]


def comparisons(place):
    kinds = (bridge, processes, playing, walls, seeks, many)
    return [comparison for kind in kinds for comparison in kind.comparisons(place)]
