#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""engine_test.py machine ENGINE: x86_64 or armhf.
engine_test.py run ENGINE --kit FILE --media FOLDER [OPTIONS]: runs the rows of
tests/engine-kit against an engine library, prints the table of the operations and
ends with 0 when no row fails, 1 when one does, 2 when the input is unfit."""

import argparse
import os
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
sys.path.insert(0, str(ROOT / "tools/inspect"))

import preflight  # noqa: E402
import refusal  # noqa: E402
import report  # noqa: E402
import rows  # noqa: E402
from contract import Mismatch  # noqa: E402
from refusal import Refusal  # noqa: E402
from runner import FAIL, Kit  # noqa: E402


def arguments_of(words):
    parser = argparse.ArgumentParser(prog="orv engine-test", usage=argparse.SUPPRESS,
                                     add_help=False, allow_abbrev=False)
    parser.add_argument("engine")
    parser.add_argument("--kit", required=True)
    parser.add_argument("--media", required=True, type=pathlib.Path)
    parser.add_argument("--address", default="")
    parser.add_argument("--filter", default="")
    parser.add_argument("--limit", default=60, type=int)
    parser.add_argument("--jobs", default=min(os.cpu_count() or 1, 4), type=int)
    parser.add_argument("--json")
    parser.add_argument("--junit")
    return parser.parse_args(words)


def chosen(words):
    try:
        pattern = re.compile(words)
        found = rows.read(ROOT)
    except re.error as error:
        raise Refusal(f"'{words}' is no regular expression: {error}.") from None
    except Mismatch as mismatch:
        raise Refusal(str(mismatch)) from None
    found = [row for row in found if pattern.search(row.test) or pattern.search(row.operation)]
    if not found:
        raise Refusal(f"no row's operation or test matches '{words}'.")
    return found


def media_names():
    return (ROOT / rows.FOLDER / "media.txt").read_text(encoding="utf-8").split()


def run(options):
    asked = chosen(options.filter)
    preflight.machine(options.engine)
    preflight.check_symbols(options.engine, ROOT / "abi")
    preflight.check_media(options.media, media_names())
    media = options.media.resolve()
    with Kit(options.kit, options.engine, media, options.address) as kit:
        preflight.check_loading(options.engine, kit, options.limit)
        outcomes = report.print_table(kit.run_all(asked, options.limit, options.jobs))
    try:
        if options.json:
            report.write_json(options.json, options.engine, outcomes)
        if options.junit:
            report.write_junit(options.junit, options.engine, outcomes)
    except OSError as error:
        raise Refusal(f"{error.filename}: {error.strerror}; "
                      "the results were not written.") from None
    return 1 if any(outcome.result == FAIL for outcome in outcomes) else 0


def main(words):
    if len(words) == 2 and words[0] == "machine":
        print(preflight.machine(words[1]))
        return 0
    if words and words[0] == "run":
        return run(arguments_of(words[1:]))
    raise Refusal(__doc__)


if __name__ == "__main__":
    try:
        refusal.exit_with(main, sys.argv[1:])
    except KeyboardInterrupt:
        sys.exit(130)
    except BrokenPipeError:
        # Who read the table has ended; nothing is left to write for the interpreter's end.
        os.dup2(os.open(os.devnull, os.O_WRONLY), sys.stdout.fileno())
        sys.exit(1)
