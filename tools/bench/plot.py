# SPDX-License-Identifier: Apache-2.0
"""The ratios as a picture: a bar for each row from 1, to the left for less
than the other side's figure and to the right for more, on a scale of powers,
with the goal as a mark."""

import math

from drawing import BAD, FAINT, GOOD, PLAIN, Drawing
from table import met_text, number, ratio_text

LINE, NAMES, BARS, NOTES = 22, 300, 420, 330  # pixels
TOP = 46
COLOURS = {True: GOOD, False: BAD, None: PLAIN}


def svg(rows, caption):
    shown = [row for row in rows if row.ratio or row.failure]
    scale = _Scale([row.ratio for row in shown if row.ratio] + [
        row.goal.most for row in shown if row.goal and row.goal.kind == "ratio"])
    height = TOP + LINE * len(shown) + 40
    drawing = Drawing(NAMES + BARS + NOTES, height)
    drawing.text(10, 18, "Times the floor or peer; less is better", font_weight="bold")
    for power in scale.powers():
        x = scale.x(power)
        drawing.line((x, TOP - 8), (x, height - 34), "black" if power == 1 else FAINT)
        drawing.text(x, TOP - 12, number(power), text_anchor="middle")
    for index, row in enumerate(shown):
        _draw_bar(drawing, row, scale, TOP + LINE * index)
    drawing.text(10, height - 12, caption, fill="#555")
    return drawing.svg()


def _draw_bar(drawing, row, scale, top):
    middle = top + LINE / 2 + 4
    drawing.text(NAMES - 8, middle, row.name, text_anchor="end")
    if row.failure:
        drawing.text(NAMES + 8, middle, f"failed: {row.failure}", fill=BAD)
        return
    left, right = sorted((scale.x(1), scale.x(row.ratio)))
    drawing.bar(left, top + 4, max(right - left, 1), LINE - 8, COLOURS[row.is_met])
    if row.goal and row.goal.kind == "ratio":
        x = scale.x(row.goal.most)
        drawing.line((x, top + 1), (x, top + LINE - 1), "black", stroke_width=3)
    note = f"{ratio_text(row.ratio)} of {row.peer_name}" + (
        f", {met_text(row)}" if row.goal else "")
    drawing.text(NAMES + BARS + 8, middle, note)


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
