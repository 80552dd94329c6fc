# SPDX-License-Identifier: Apache-2.0
"""A run as a picture: a panel for each quantity over the cycles, with the line through it."""

from drawing import BAD, FAINT, GOOD, PLAIN, Drawing
from growth import settled
from table import number

WIDTH, PANEL, LEFT, RIGHT, TOP = 900, 110, 90, 20, 30  # pixels
GAP = 34


def svg(findings, title, caption):
    shown = [finding for finding in findings if finding.points]
    height = TOP + (PANEL + GAP) * len(shown) + 30
    drawing = Drawing(WIDTH, height)
    drawing.text(10, 18, title, font_weight="bold")
    for index, finding in enumerate(shown):
        _panel(drawing, finding, TOP + GAP + (PANEL + GAP) * index)
    drawing.text(10, height - 10, caption, fill="#555")
    return drawing.svg()


def _panel(drawing, finding, top):
    scale = finding.quantity.scale
    points = [(x, y / scale) for x, y in finding.points]
    low, high = min(y for _, y in points), max(y for _, y in points)
    room = (high - low) / 20 or 1
    low, high = low - room, high + room
    first, last = points[0][0], max(points[-1][0], points[0][0] + 1)

    def place(x, y):
        return (LEFT + (WIDTH - LEFT - RIGHT) * (x - first) / (last - first),
                top + PANEL * (high - y) / (high - low))

    for y in (low + room, high - room):
        drawing.line(place(first, y), place(last, y), FAINT)
        drawing.text(LEFT - 6, place(first, y)[1] + 4, number(y), text_anchor="end")
    drawing.text(LEFT, top - 6, heading(finding), fill=BAD if finding.grows else "black")
    drawing.text(WIDTH - RIGHT, top + PANEL + 12, f"{last} cycles", text_anchor="end")
    drawing.curve([place(x, y) for x, y in points], PLAIN)
    if finding.line:
        begin = settled(finding.points)[0][0]
        drawing.line(place(begin, finding.line.at(begin) / scale),
                     place(last, finding.line.at(last) / scale),
                     BAD if finding.grows else GOOD, stroke_width=2)


def heading(finding):
    quantity = finding.quantity
    return ", ".join(filter(None, [quantity.name, quantity.unit])) + (
        ": grows" if finding.grows else "")
