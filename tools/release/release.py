#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv release: what a release of this checkout needs, step by step."""

import argparse
import collections
import pathlib
import shutil
import sys
import tempfile

import artefacts
import checks
import signing
from outcome import Missing, Release, Skipped

EPILOG = """\
Steps run in this order; --only and --skip take their names, several with commas, or
"test" and "deb" for all of that kind. With -o nothing is made once a step is missing,
and FOLDER is there only when none is. Nothing is uploaded, and nothing is tagged.

Exit status: 0 when no step is missing, 1 when one is, 2 for wrong arguments."""

Step = collections.namedtuple("Step", "name kind run")
CHECK, MAKE = "check", "make"


def steps_of(root):
    releases = artefacts.supported_releases(root)
    return [
        Step("tree", CHECK, checks.check_tree),
        Step("version", CHECK, checks.check_version),
        Step("changelog", CHECK, checks.check_changelog),
        *(Step(f"test-{name}", MAKE, artefacts.test_debian(name)) for name in releases),
        Step("test-armhf", MAKE, artefacts.test_armhf),
        *(Step(f"deb-{name}", MAKE, artefacts.make_deb(name)) for name in releases),
        Step("maven", MAKE, artefacts.make_maven),
        Step("docs", MAKE, artefacts.make_docs),
        Step("source", MAKE, artefacts.make_source),
        Step("checksums", MAKE, signing.make_checksums),
        Step("signature", MAKE, signing.make_signature),
    ]


class Parser(argparse.ArgumentParser):
    """Refuses in one sentence."""

    def error(self, message):
        self.exit(2, f"orv: release: {message}. See ./orv release --help.\n")


def options_of(arguments, steps):
    parser = Parser(
        prog="./orv release", description=__doc__.split(": ", 1)[1], allow_abbrev=False,
        epilog=EPILOG + "\n\nSteps: " + ", ".join(step.name for step in steps),
        formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--dry-run", action="store_true",
                        help="do everything, say what is missing, keep nothing")
    parser.add_argument("-o", "--output", metavar="FOLDER", type=pathlib.Path,
                        help="put the files there; it must not be there yet, or be empty")
    parser.add_argument("--only", metavar="STEPS", help="these alone")
    parser.add_argument("--skip", metavar="STEPS", help="all but these")
    parser.add_argument("--key", metavar="KEY",
                        help="the key of gpg that signs; its first otherwise")
    parser.add_argument("--root", type=pathlib.Path, required=True, help=argparse.SUPPRESS)
    parser.add_argument("--build", type=pathlib.Path, required=True, help=argparse.SUPPRESS)
    options = parser.parse_args(arguments)
    for name in ("only", "skip"):
        setattr(options, name, chosen(parser, f"--{name}", getattr(options, name), steps))
    if options.dry_run == (options.output is not None):
        parser.error("it takes either --dry-run, or -o FOLDER for the files")
    if options.output:
        why = why_unfit(options)
        if why:
            parser.error(f"{options.output} {why}")
    return options


def why_unfit(options):
    folder = options.output.resolve()
    if folder.exists() and (not folder.is_dir() or any(folder.iterdir())):
        return "is there already, and not an empty folder"
    if folder.is_relative_to(options.root.resolve()) and not folder.is_relative_to(
            options.build.resolve()):
        return "is a part of what is released: name a folder outside of the checkout"
    return None


def chosen(parser, option, text, steps):
    """The names of the steps that an option's value stands for; None without it."""
    if text is None:
        return None
    names = set()
    for word in text.split(","):
        found = {step.name for step in steps if word in (step.name, step.name.split("-")[0])}
        if not found:
            parser.error(f"{option}: there is no step '{word}'; they are "
                         + ", ".join(step.name for step in steps))
        names |= found
    return names


class Table:
    """One line for each step, written when its state is known."""

    def __init__(self, steps):
        self.width = max(len(step.name) for step in steps)
        self.states = collections.Counter()

    def row(self, step, state, sentence):
        self.states[state] += 1
        print(f"{step.name:{self.width}}  {state:7}  {sentence}", flush=True)


def run(release, steps, options):
    """Whether no step is missing."""
    table, first_missing = Table(steps), None
    for step in steps:
        why = reason_to_skip(step, options, first_missing)
        try:
            if why:
                raise Skipped(why)
            table.row(step, "ok", step.run(release))
        except Skipped as skipped:
            table.row(step, "skipped", skipped)
        except Missing as missing:
            first_missing = first_missing or step.name
            table.row(step, "missing", missing)
        except OSError as error:
            first_missing = first_missing or step.name
            table.row(step, "missing", f"{error.filename}: {error.strerror}")
    print(f"release of {release.version}: " + ", ".join(
        f"{table.states[state]} {state}" for state in ("ok", "missing", "skipped")))
    return table.states["missing"] == 0


def reason_to_skip(step, options, first_missing):
    if options.only is not None and step.name not in options.only:
        return "skipped by --only"
    if options.skip is not None and step.name in options.skip:
        return "skipped by --skip"
    if options.output and first_missing and step.kind == MAKE:
        return f"nothing is made, as {first_missing} is missing"
    return None


def release_into(options, steps, version):
    """Makes the files in a folder beside their place, so that they come there whole
    or not at all; those of a dry run go again."""
    parent = options.output.absolute().parent if options.output else None
    if parent:
        parent.mkdir(parents=True, exist_ok=True)
    with tempfile.TemporaryDirectory(prefix=".release-", dir=parent) as work:
        files = pathlib.Path(work) / "files"
        files.mkdir()
        release = Release(options.root.resolve(), options.build.resolve(), files, version,
                          options.key)
        whole = run(release, steps, options)
        if whole and options.output:
            if options.output.exists():
                options.output.rmdir()
            shutil.move(files, options.output)
            print(f"the files are in {options.output}")
    return whole


def main(arguments):
    root = pathlib.Path(arguments[arguments.index("--root") + 1])
    steps = steps_of(root)
    options = options_of(arguments, steps)
    version = checks.product_version(root)
    if version is None:
        print("orv: CMakeLists.txt has no project(… VERSION …).", file=sys.stderr)
        return 1
    return 0 if release_into(options, steps, version) else 1


if __name__ == "__main__":
    try:
        sys.exit(main(sys.argv[1:]))
    except KeyboardInterrupt:
        sys.exit(130)
