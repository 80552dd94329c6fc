# SPDX-License-Identifier: Apache-2.0
"""The ratios as a picture: a bar for each row from 1, to the left for less
than the other side's figure and to the right for more, on a scale of powers,
with the goal as a mark."""

import math
from xml.sax.saxutils import escape

from table import met_text, number, ratio_text

LINE, NAMES, BARS, NOTES = 22, 300, 420, 330  # pixels
TOP = 46
COLOURS = {True: "#2a7f3f", False: "#b3261e", None: "#5b6f8c"}


def svg(rows, caption):
    shown = [row for row in rows if row.ratio or row.failure]
    scale = _Scale([row.ratio for row in shown if row.ratio] + [
        row.goal.most for row in shown if row.goal and row.goal.kind == "ratio"])
    height = TOP + LINE * len(shown) + 40
    parts = [
        f'<svg xmlns="http://www.w3.org/2000/svg" width="{NAMES + BARS + NOTES}" height="{height}"'
        ' font-family="sans-serif" font-size="12">',
        f'<rect width="{NAMES + BARS + NOTES}" height="{height}" fill="white"/>',
        '<text x="10" y="18" font-weight="bold">Times the floor or peer; less is better</text>']
    for power in scale.powers():
        x = scale.x(power)
        parts.append(f'<line x1="{x:.1f}" y1="{TOP - 8}" x2="{x:.1f}" y2="{height - 34}"'
                     f' stroke="{"black" if power == 1 else "#ddd"}"/>')
        parts.append(f'<text x="{x:.1f}" y="{TOP - 12}" text-anchor="middle">{number(power)}</text>')
    for index, row in enumerate(shown):
        parts += _bar(row, scale, TOP + LINE * index)
    parts.append(f'<text x="10" y="{height - 12}" fill="#555">{escape(caption)}</text>')
    return "\n".join([*parts, "</svg>", ""])


def _bar(row, scale, top):
    middle = top + LINE / 2 + 4
    yield f'<text x="{NAMES - 8}" y="{middle}" text-anchor="end">{escape(row.name)}</text>'
    if row.failure:
        yield f'<text x="{NAMES + 8}" y="{middle}" fill="#b3261e">failed: {escape(row.failure)}</text>'
        return
    left, right = sorted((scale.x(1), scale.x(row.ratio)))
    yield (f'<rect x="{left:.1f}" y="{top + 4}" width="{max(right - left, 1):.1f}"'
           f' height="{LINE - 8}" fill="{COLOURS[row.is_met]}"/>')
    if row.goal and row.goal.kind == "ratio":
        x = scale.x(row.goal.most)
        yield (f'<line x1="{x:.1f}" y1="{top + 1}" x2="{x:.1f}" y2="{top + LINE - 1}"'
               ' stroke="black" stroke-width="3"/>')
    note = f"{ratio_text(row.ratio)} of {row.peer_name}" + (
        f", {met_text(row)}" if row.goal else "")
    yield f'<text x="{NAMES + BARS + 8}" y="{middle}">{escape(note)}</text>'


class _Scale:
    """From a power of ten to another, with all of the values and 1 between."""

    def __init__(self, values):
        values = [value for value in values if value > 0] + [0.5, 2]
        self._low = math.floor(math.log10(min(values)))
        self._high = math.ceil(math.log10(max(values)))

    def x(self, value):
        part = (math.log10(value) - self._low) / (self._high - self._low)
        return NAMES + BARS * part

    def powers(self):
        return [10.0 ** power for power in range(self._low, self._high + 1)]
