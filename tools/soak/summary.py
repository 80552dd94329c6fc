# SPDX-License-Identifier: Apache-2.0
"""A run's figures for people."""

import math

from fit import median
from growth import settled
from table import number


def live(row):
    """A checkpoint in one line."""
    minutes, seconds = divmod(int(row["seconds"]), 60)
    return "  ".join([
        f"{minutes}:{seconds:02d}", f"{row['cycles']} cycles",
        f"{row['players']} players, {row['most']} at once", f"RSS {_mib(row['rss'])} MiB",
        f"allocated {_mib(row['native'])} MiB", f"heap {_mib(row['heap'])} MiB",
        f"threads {row['threads']}", f"descriptors {row['descriptors']}",
        f"references {row['references']}",
        f"open {_millis(row['open'])}", f"seek {_millis(row['seek'])}"])


def _mib(value):
    return f"{value / 2 ** 20:.1f}"


def _millis(value):
    return "-" if value is None else f"{number(value)} ms"


def lines(findings):
    """What each quantity was, and how it changed for each cycle."""
    rows = [("", "median", "from", "to", "each cycle", "certainly between", "")]
    rows += [_row(finding) for finding in findings if finding.points]
    widths = [max(len(row[column]) for row in rows) for column in range(len(rows[0]))]
    return ["  ".join(f"{text:{width}}" for text, width in zip(row, widths)).rstrip()
            for row in rows]


def _row(finding):
    quantity = finding.quantity
    values = sorted(y / quantity.scale for _, y in settled(finding.points))
    spread = (f"{number(median(values))} {quantity.unit}".strip(), number(values[0]),
              number(values[-1]))
    if finding.line is None:
        return (quantity.name, *spread, "", "", "too few checkpoints to judge")
    slope, least, most = (value / quantity.scale for value in (
        finding.line.slope, finding.line.least, finding.line.most))
    return (quantity.name, *spread, _rate(slope), f"{_rate(least)} and {_rate(most)}",
            "GROWS" if finding.grows else "")


def _rate(value):
    return str(value) if math.isinf(value) else number(value)


def changes(first, last, key):
    """Which names of threads or descriptors there are more of than at first."""
    return [f"{name}: {first[key].get(name, 0)} to {count}"
            for name, count in sorted(last[key].items()) if count > first[key].get(name, 0)]
