# SPDX-License-Identifier: Apache-2.0
"""A picture as SVG, put together of few kinds of shapes."""

from xml.sax.saxutils import escape

BAD = "#b3261e"
GOOD = "#2a7f3f"
PLAIN = "#5b6f8c"
FAINT = "#ddd"


class Drawing:
    """Sizes and places are in pixels from the left and the top."""

    def __init__(self, width, height):
        self._parts = [
            f'<svg xmlns="http://www.w3.org/2000/svg" width="{width}" height="{height}"'
            ' font-family="sans-serif" font-size="12">',
            f'<rect width="{width}" height="{height}" fill="white"/>']

    def text(self, x, y, text, **style):
        self._parts.append(f'<text x="{_place(x)}" y="{_place(y)}"{_style(style)}>{escape(text)}</text>')

    def line(self, start, end, stroke, **style):
        (x1, y1), (x2, y2) = start, end
        self._parts.append(f'<line x1="{_place(x1)}" y1="{_place(y1)}" x2="{_place(x2)}"'
                           f' y2="{_place(y2)}" stroke="{stroke}"{_style(style)}/>')

    def bar(self, x, y, width, height, fill):
        self._parts.append(f'<rect x="{_place(x)}" y="{_place(y)}" width="{width:.1f}"'
                           f' height="{_place(height)}" fill="{fill}"/>')

    def curve(self, points, stroke):
        places = " ".join(f"{_place(x)},{_place(y)}" for x, y in points)
        self._parts.append(f'<polyline points="{places}" fill="none" stroke="{stroke}"/>')

    def svg(self):
        return "\n".join([*self._parts, "</svg>", ""])


def _place(value):
    return f"{value:.1f}".removesuffix(".0")


def _style(style):
    return "".join(f' {name.replace("_", "-")}="{value}"' for name, value in style.items())
