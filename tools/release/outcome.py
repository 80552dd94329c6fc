# SPDX-License-Identifier: Apache-2.0
"""What a step of a release ends in, and the commands that steps run."""

import collections
import os
import subprocess


class Missing(Exception):
    """The step's condition does not hold; the text says what is missing."""


class Skipped(Exception):
    """The step was not tried; the text says why."""


# folder: where the files go; key: which of gpg's keys signs, None for its own choice.
Release = collections.namedtuple("Release", "root build folder version key")


def output_of(arguments, **options):
    """Its standard output; Missing when it fails or is not there."""
    try:
        done = subprocess.run([str(word) for word in arguments], capture_output=True, text=True,
                              errors="replace", check=False, stdin=subprocess.DEVNULL, **options)
    except FileNotFoundError:
        raise Missing(f"{arguments[0]} is not installed") from None
    if done.returncode != 0:
        raise Missing(last_line(done.stderr) or f"{arguments[0]} ends with {done.returncode}")
    return done.stdout


def last_line(text):
    lines = [line.strip() for line in text.splitlines() if line.strip()]
    return lines[-1] if lines else ""


def run_logged(release, name, arguments):
    """Runs a long command with its output in a log of the build folder."""
    log = release.build / "log" / f"release-{name}.log"
    log.parent.mkdir(parents=True, exist_ok=True)
    with log.open("w", encoding="utf-8") as file:
        status = subprocess.run(
            [str(word) for word in arguments], cwd=release.root, stdin=subprocess.DEVNULL,
            stdout=file, stderr=subprocess.STDOUT, check=False,
            env={**os.environ, "ORV_BUILD": str(release.build)}).returncode
    if status == 0:
        return
    said = [line for line in log.read_text("utf-8", errors="replace").splitlines()
            if line.startswith("orv: ")]
    why = said[-1].removeprefix("orv: ").rstrip(".") if said else f"it ends with {status}"
    raise Missing(f"{why}; see {log}")
