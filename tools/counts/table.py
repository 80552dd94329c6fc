# SPDX-License-Identifier: Apache-2.0
"""The counts that are held in a file, a column for each compiler and C library.

    column x86_64 GCC 12 glibc 2.36
        current_position 197

A # begins a comment."""

import os

from refusal import Refusal

HEAD = """\
# What is held of the library's costs: instructions of its hottest paths, and of
# the ARM library bytes, relocations and initialisers. Written by ./orv counts
# --accept, checked by the tests counts.paths and counts.library, which allow 3 %
# more.
"""
ALLOWED_PERCENT = 3


def read(path):
    """{column: {row: count}}"""
    columns = {}
    rows = None
    try:
        with open(path, encoding="utf-8") as file:
            lines = [line.split("#")[0].split() for line in file]
    except OSError as error:
        raise Refusal(f"{path}: {error.strerror}") from None
    for number, words in enumerate(lines, 1):
        if not words:
            continue
        if words[0] == "column" and len(words) > 1:
            name = " ".join(words[1:])
            known, rows = name in columns, columns.setdefault(name, {})
        elif rows is not None and len(words) == 2 and words[1].isdecimal():
            known = words[0] in rows
            rows[words[0]] = int(words[1])
        else:
            raise Refusal(f"{path}:{number}: neither a column nor a row and its count")
        if known:
            raise Refusal(f"{path}:{number}: {words[-2]} {words[-1]} stands there twice")
    return columns


def write(path, columns):
    """Whole or not at all."""
    unfinished = f"{path}.new"
    with open(unfinished, "w", encoding="utf-8") as file:
        file.write(HEAD)
        for name in sorted(columns):
            file.write(f"\ncolumn {name}\n")
            file.writelines(f"    {row} {count}\n" for row, count in columns[name].items())
    os.replace(unfinished, path)


def has_grown(count, held):
    return count * 100 > held * (100 + ALLOWED_PERCENT)


def change(count, held):
    """As the table shows it."""
    if held is None:
        return "not held"
    if count == held:
        return "="
    return f"{(count - held) * 100 / held:+.1f} %" if held else f"+{count}"


def lines(counts, held):
    """The table: what was counted beside what is held (None: nothing)."""
    yield f"{'':20} {'count':>9} {'held':>9}  change"
    for row, count in counts.items():
        was = (held or {}).get(row)
        yield f"{row:20} {count:9} {'-' if was is None else was:>9}  {change(count, was)}"


def findings(counts, held):
    """What makes the check fail, in sentences."""
    for row, count in counts.items():
        if row not in held:
            yield f"{row} is not held"
        elif has_grown(count, held[row]):
            yield (f"{row} has grown from {held[row]} to {count},"
                   f" by more than {ALLOWED_PERCENT} %")
    for row in held:
        if row not in counts:
            yield f"{row} is held and was not counted"
