#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""Measures every figure beside its floor or its peer, in one run. Ends with 0
when every row has its figures, whether or not they meet their goals, 1 when a
row has failed, 2 when the arguments are wrong. After -- follows the command
that starts the player."""

import argparse
import os
import re
import sys

import catalogue
import plot
import report
import table
from rounds import measure


def parse(arguments):
    parser = argparse.ArgumentParser(
        prog="./orv bench",
        description="Measures what calls, players, pictures and streams cost, each beside the"
                    " same done by hand or by another program. docs/performance.md says how.")
    parser.add_argument("--rows", metavar="REGEX", default="", type=expression,
                        help="only the rows whose names match")
    parser.add_argument("--rounds", metavar="N", default=5, type=positive,
                        help="how often each side is measured (default: 5)")
    parser.add_argument("--json", metavar="FILE", type=file_to_write,
                        help="also write all samples there")
    parser.add_argument("--plot", metavar="FILE.svg", type=file_to_write,
                        help="also draw the ratios there")
    parser.add_argument("--list", action="store_true", help="only name the rows")
    return parser.parse_args(arguments)


def expression(text):
    try:
        return re.compile(text)
    except re.error as error:
        raise argparse.ArgumentTypeError(f"'{text}' is no regular expression: {error}") from error


def positive(text):
    if not text.isdecimal() or int(text) < 1:
        raise argparse.ArgumentTypeError(f"'{text}' is no positive number")
    return int(text)


def file_to_write(path):
    if not os.path.isdir(os.path.dirname(os.path.abspath(path))):
        raise argparse.ArgumentTypeError(f"the folder of '{path}' does not exist")
    return path


def choose(comparisons, pattern):
    """The names of the rows that match."""
    return {name for comparison in comparisons for name in comparison.row_names()
            if pattern.search(name)}


def measure_all(comparisons, wanted, rounds):
    rows = []
    chosen = [c for c in comparisons if wanted.intersection(c.row_names())]
    for number, comparison in enumerate(chosen, 1):
        if sys.stderr.isatty():
            print(f"\r     {number} of {len(chosen)}: {comparison.name}\033[K\r", end="",
                  file=sys.stderr, flush=True)
        rows += measure(comparison, wanted, rounds)
    if sys.stderr.isatty():
        print("\r\033[K", end="", file=sys.stderr)
    return rows


def main(arguments, comparisons, java="java"):
    options = parse(arguments)
    pattern = options.rows or re.compile("")
    wanted = choose(comparisons, pattern)
    if not wanted:
        print(f"orv: no row matches '{pattern.pattern}'; --list names them", file=sys.stderr)
        return 2
    if options.list:
        print("\n".join(name for c in comparisons for name in c.row_names() if name in wanted))
        return 0
    before = os.getloadavg()[0]
    rows = measure_all(comparisons, wanted, options.rounds)
    load = before, os.getloadavg()[0]
    facts = report.machine(java)
    caption = report.machine_text(facts, options.rounds, load)
    print("\n".join([*table.lines(rows), "", caption]))
    if options.json:
        report.write_json(options.json, report.content(rows, facts, options.rounds, load))
    if options.plot:
        report.write_whole(options.plot, plot.svg(rows, caption))
    return 1 if any(row.failure for row in rows) else 0


def run(arguments):
    split = len(arguments) - 1 - arguments[::-1].index("--")
    player = arguments[split + 1:]
    place = catalogue.Place(os.path.abspath(f"{__file__}/../../.."), os.environ["ORV_BUILD"], player)
    try:
        return main(arguments[:split], catalogue.comparisons(place), player[0])
    finally:
        place.close()


if __name__ == "__main__":
    try:
        sys.exit(run(sys.argv[1:]))
    except KeyboardInterrupt:
        sys.exit(130)
    except OSError as error:
        print(f"orv: {error}", file=sys.stderr)
        sys.exit(1)
