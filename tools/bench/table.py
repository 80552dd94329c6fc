# SPDX-License-Identifier: Apache-2.0
"""The rows for people: each figure is a median, with the least and the most of
its samples."""

HEADING = ("row", "here", "floor or peer", "", "ratio", "goal", "met")


def lines(rows):
    cells = [HEADING] + [_cells(row) for row in rows]
    widths = [max(len(row[column]) for row in cells if len(row) == len(HEADING))
              for column in range(len(HEADING))]
    widths[0] = max(len(row[0]) for row in cells)
    return ["  ".join(f"{text:{width}}" for text, width in zip(row, widths)).rstrip()
            for row in cells]


def _cells(row):
    if row.failure:
        return (row.name, f"failed: {row.failure}")
    return (row.name, figure_text(row.here, row.unit),
            row.peer_name or "" if row.peer else "",
            figure_text(row.peer, row.unit) if row.peer else "",
            "" if row.ratio is None else ratio_text(row.ratio), goal_text(row), met_text(row))


def figure_text(figure, unit):
    spread = f" ({number(figure.least)} to {number(figure.most)})" if len(figure.samples) > 1 else ""
    return f"{number(figure.median)} {unit}{spread}"


def number(value):
    """Three digits that count, and no exponent."""
    if value == 0:
        return "0"
    size = abs(value)
    digits = 0
    while digits < 6 and size < 100:
        size *= 10
        digits += 1
    return f"{value:.{digits}f}".rstrip("0").rstrip(".") if digits else f"{value:.0f}"


def ratio_text(ratio):
    return f"{ratio:.3f}" if ratio < 0.1 else f"{ratio:.2f}"


def goal_text(row):
    if row.goal is None:
        return ""
    most = number(row.goal.most)
    return {"ratio": f"≤ {most}", "value": f"≤ {most} {row.unit}",
            "over": f"≤ +{most} {row.unit}"}[row.goal.kind]


def met_text(row):
    return {True: "met", False: "missed", None: ""}[row.is_met]
