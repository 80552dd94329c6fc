#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""Plays, describes and pictures every file below a folder, and compares with
ffprobe and ffmpeg. Ends with 0 when nothing differs, 1 when something does, 2
when the arguments are wrong. After -- follows the command that starts the
player."""

import argparse
import concurrent.futures
import os
import sys

import child
from compare import Examination
from player import Player
from report import Report


def files_below(folder):
    """Their paths, sorted; links to files count, links to folders do not."""
    paths = []
    for place, _, names in os.walk(folder):
        paths += [path for path in (os.path.join(place, name) for name in names)
                  if os.path.isfile(path)]
    return sorted(paths)


def positive(kind):
    def read(text):
        value = kind(text)
        if value <= 0:
            raise ValueError
        return value
    read.__name__ = "positive number"
    return read


def parse(arguments):
    parser = argparse.ArgumentParser(
        prog="./orv corpus",
        description="Plays, describes and pictures every file below a folder, each in a process"
                    " of its own, and lists what differs from ffprobe and ffmpeg, worst first."
                    " Long files are played for their last seconds.")
    parser.add_argument("folder", metavar="DIR")
    parser.add_argument("--report", metavar="OUT", help="also write all of it there, as JSON")
    parser.add_argument("--jobs", metavar="N", type=positive(int), default=os.cpu_count(),
                        help="how many files at a time (default: as many as processors)")
    parser.add_argument("--limit", metavar="SECONDS", type=positive(float), default=60,
                        help="end a process that takes longer; what it plays is added"
                             " (default: 60)")
    options = parser.parse_args(arguments)
    if not os.path.isdir(options.folder):
        parser.error(f"'{options.folder}' is no folder")
    if options.report and not os.path.isdir(os.path.dirname(os.path.abspath(options.report))):
        parser.error(f"the folder of '{options.report}' does not exist")
    return options


def examine_all(player, folder, jobs):
    paths = files_below(folder)
    with concurrent.futures.ThreadPoolExecutor(jobs) as pool:
        try:
            waiting = [pool.submit(Examination(player, os.path.abspath(path),
                                               os.path.relpath(path, folder)).run)
                       for path in paths]
            return [wait(done, number, len(paths)) for number, done in enumerate(waiting)]
        except BaseException:
            pool.shutdown(wait=False, cancel_futures=True)
            child.stop_all()
            raise


def wait(done, number, count):
    if sys.stderr.isatty():
        print(f"\r     {number} of {count}\033[K\r", end="", file=sys.stderr)
    return done.result()


def main(arguments):
    split = len(arguments) - 1 - arguments[::-1].index("--")
    options = parse(arguments[:split])
    player = Player(arguments[split + 1:], options.limit)
    report = Report(examine_all(player, options.folder, options.jobs), options.limit)
    if options.report:
        report.write(options.report)
    print("\n".join(report.table()))
    return 1 if report.differences else 0


if __name__ == "__main__":
    try:
        sys.exit(main(sys.argv[1:]))
    except KeyboardInterrupt:
        sys.exit(130)
    except OSError as error:
        print(f"orv: {error}", file=sys.stderr)
        sys.exit(2)
