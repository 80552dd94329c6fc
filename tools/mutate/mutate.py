#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv mutate: changes the code in one small place at a time, and reports which
changes no test notices."""

import argparse
import concurrent.futures
import contextlib
import fcntl
import pathlib
import random
import re
import signal
import subprocess
import sys
import time

import areas
import processes
from equivalents import Equivalents
from journal import Journal
from mutant import Failed
from report import GOALS, Report

FOLDER = pathlib.Path(__file__).resolve().parent


def say(text):
    print(f"orv: {text}", file=sys.stderr, flush=True)


def positive(text):
    number = int(text)
    if number < 1:
        raise ValueError(text)
    return number


def options_of(arguments):
    parser = argparse.ArgumentParser(
        prog="./orv mutate", description=__doc__, allow_abbrev=False,
        epilog="Exit status: 0 when the goals hold (product 100 %, engine and Java half 95 % of "
               "the mutants that something could notice), 1 when not, 2 for wrong arguments.")
    parser.add_argument("--area", choices=[*GOALS, "all"], default="all",
                        help="what to change; default: all of them, one after the other")
    parser.add_argument("--sample", type=positive, metavar="N", help="that many of each area")
    parser.add_argument("--seed", type=int, metavar="S",
                        help="draws the same sample again; default: another each time")
    parser.add_argument("--since", metavar="REV", help="files alone that have changed since")
    parser.add_argument("--filter", metavar="REGEX", type=re.compile, default="",
                        help="those alone whose 'FILE:LINE FUNCTION OPERATOR' matches")
    parser.add_argument("--list", action="store_true", help="list them without trying any")
    parser.add_argument("--resume", metavar="FILE",
                        help="notes each outcome in FILE as it comes, and tries no more what FILE "
                             "says was noticed in the same source")
    parser.add_argument("--jobs", type=positive, metavar="J",
                        help="that many at a time; default: one for each processor")
    parser.add_argument("--root", required=True, help=argparse.SUPPRESS)
    parser.add_argument("--build", required=True, help=argparse.SUPPRESS)
    parser.add_argument("--java-home", default="/usr", help=argparse.SUPPRESS)
    options = parser.parse_args(arguments)
    if options.seed is not None and not options.sample:
        parser.error("--seed needs --sample.")
    return options


def changed_files(root, revision):
    git = subprocess.run(["git", "-C", root, "diff", "--name-only", "--end-of-options", revision],
                         capture_output=True, text=True)
    if git.returncode != 0:
        raise Failed(f"git knows no revision '{revision}'.")
    return set(git.stdout.splitlines())


def chosen(mutants, options, files, chance):
    if files is not None:
        mutants = [m for m in mutants if m.file in files]
    pattern = re.compile(options.filter)
    mutants = [m for m in mutants if pattern.search(f"{m.place()} {m.function} {m.operator}")]
    if options.sample and options.sample < len(mutants):
        mutants = sorted(chance.sample(mutants, options.sample), key=mutants.index)
    return mutants


def list_mutants(mutants, equivalents, source_of):
    for mutant in mutants:
        mark = ", equivalent" if equivalents.matches(mutant) else ""
        print(f"{mutant.place()} {mutant.function} ({mutant.operator}{mark})")
        print("".join(f"    {line}\n" for line in mutant.diff(source_of(mutant))), end="")


def try_all(trial, mutants, equivalents, journal, report, source_of, jobs):
    """Adds the outcome of each to the report."""
    rest = []
    for mutant in mutants:
        known = ("equivalent", "") if equivalents.matches(mutant) else \
            journal and journal.outcome(mutant)
        if known:
            report.add(mutant, *known, [])
        else:
            rest.append(mutant)
    if not rest:
        return
    trial.begin()

    def judge(mutant):
        outcome, detail = trial.judge(mutant)
        if journal:
            journal.note(mutant, outcome, detail)
        report.add(mutant, outcome, detail, mutant.diff(source_of(mutant)))
    # The first failure, or Ctrl-C, ends the rest.
    with concurrent.futures.ThreadPoolExecutor(jobs) as pool:
        tasks = [pool.submit(judge, mutant) for mutant in rest]
        try:
            for task in concurrent.futures.as_completed(tasks):
                task.result()
        except BaseException:
            processes.end_all()
            pool.shutdown(cancel_futures=True)
            raise


def run(options, make_area, listed):
    seed = options.seed if options.seed is not None else random.SystemRandom().randrange(1 << 32)
    files = changed_files(options.root, options.since) if options.since else None
    equivalents = Equivalents(listed)
    met = True
    for name in GOALS if options.area == "all" else [options.area]:
        area = make_area(name, options, say)
        mutants = area.find(files)
        for sentence in equivalents.stale(mutants, {m.file for m in mutants}):
            say(sentence)
            met = False
        mutants = chosen(mutants, options, files, random.Random(seed))

        def source_of(mutant):
            return (pathlib.Path(options.root) / mutant.file).read_bytes()
        if options.sample:
            say(f"{name}: --sample {options.sample} --seed {seed}")
        if options.list:
            list_mutants(mutants, equivalents, source_of)
            continue
        with contextlib.ExitStack() as stack:
            journal = options.resume and stack.enter_context(
                contextlib.closing(Journal(options.resume, source_of)))
            met = try_area(area, mutants, equivalents, journal, source_of) and met
    return 0 if met else 1


@contextlib.contextmanager
def alone_in(folder):
    """Keeps another run out of a folder."""
    folder.parent.mkdir(parents=True, exist_ok=True)
    with open(folder.with_suffix(".lock"), "w", encoding="ascii") as lock:
        try:
            fcntl.flock(lock, fcntl.LOCK_EX | fcntl.LOCK_NB)
        except BlockingIOError:
            raise Failed(f"another ./orv mutate is at work in {folder}.") from None
        yield


def try_area(area, mutants, equivalents, journal, source_of):
    report, started = Report(len(mutants)), time.monotonic()
    say(f"{area.name}: {len(mutants)} mutants, {area.jobs} at a time")
    try:
        with alone_in(area.work), area.trial() as trial:
            try_all(trial, mutants, equivalents, journal, report, source_of, area.jobs)
    finally:
        # Also of what an interrupted run has found.
        if report.results:
            report.print_table()
            print(f"{time.monotonic() - started:.0f} seconds for {len(report.results)} of "
                  f"{len(mutants)} mutants", flush=True)
    return report.meets_goals()


def main(arguments, make_area=areas.make, listed=FOLDER / "equivalents.toml"):
    options = options_of(arguments)
    try:
        return run(options, make_area, listed)
    except Failed as failure:
        say(failure)
    except (KeyboardInterrupt, processes.Interrupted):
        processes.end_all()
        return 130
    return 1


if __name__ == "__main__":
    signal.signal(signal.SIGTERM, signal.default_int_handler)
    sys.exit(main(sys.argv[1:]))
