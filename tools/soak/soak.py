#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""Uses players for a long time while files, servers, disk and sound fail, and fails itself of
anything that grows, hangs, crashes, or goes unreported. Ends with 0 when nothing does, 1 when
something does, 2 when the arguments are wrong. After -- follows the java to run."""

import argparse
import json
import os
import pathlib
import random
import re
import shutil
import subprocess
import sys
import tempfile
import time

sys.path.insert(0, os.path.abspath(f"{__file__}/../../bench"))
import growth  # noqa: E402
import machine  # noqa: E402
import picture  # noqa: E402
import report  # noqa: E402
import ring  # noqa: E402
import summary  # noqa: E402

MEDIA = ("video.mp4 video.mkv video.ts video.avi slides.mkv rotated.mp4 tracks.mkv tracks.mp4"
         " tagged.mp3 tagged.ogg covered.mp3 covered.mkv tone.flac short.mp4 silent.mkv"
         " counted-sound.mkv fonts.mkv lines.srt lines.ass latin1.srt empty.bin"
         " garbage.bin").split()
PLANTS = ("leak", "heap", "threads", "descriptors", "references", "hang", "exception",
          "unnoticed", "crash")
LINE_SECONDS = 15


def parse(arguments):
    parser = argparse.ArgumentParser(
        prog="./orv soak",
        description="Uses players for a long time, several at once, with files, servers, a disk"
                    " and a sound server that fail, all chosen by a seed. Fails when memory,"
                    " threads, descriptors or JNI references grow, when something hangs or"
                    " crashes, and when a failure is not reported as it should be.")
    parser.add_argument("--minutes", metavar="M", type=positive_float,
                        help="how long (default: 2)")
    parser.add_argument("--cycles", metavar="N", type=positive,
                        help="how many cycles, in place of --minutes")
    parser.add_argument("--seed", metavar="S", type=int,
                        help="what chances follow from (default: another one each time)")
    parser.add_argument("--first", metavar="N", type=int, default=0,
                        help="the first cycle's number, to repeat it with --cycles 1")
    parser.add_argument("--only", metavar="REGEX", default="", type=expression,
                        help="only those kinds of media, as the summary names them")
    parser.add_argument("--workers", metavar="N", type=positive, default=4,
                        help="how many cycles run at once (default: 4)")
    parser.add_argument("--batch", metavar="N", type=positive, default=10,
                        help="cycles between two checkpoints (default: 10)")
    parser.add_argument("--limit", metavar="SECONDS", type=positive, default=150,
                        help="after which an action hangs (default: 150)")
    parser.add_argument("--plant", metavar="FAULT,...", type=plants,
                        help="faults of this command's own, to see it fail: " + ", ".join(PLANTS))
    return parser.parse_args(arguments)


def positive(text):
    if not text.isdecimal() or int(text) < 1:
        raise argparse.ArgumentTypeError(f"'{text}' is no positive number")
    return int(text)


def positive_float(text):
    try:
        if 0 < float(text) < float("inf"):
            return float(text)
    except ValueError:
        pass
    raise argparse.ArgumentTypeError(f"'{text}' is no positive number")


def expression(text):
    try:
        re.compile(text)
    except re.error as error:
        raise argparse.ArgumentTypeError(f"'{text}' is no regular expression: {error}") from error
    return text


def plants(text):
    for name in text.split(","):
        if name not in PLANTS:
            raise argparse.ArgumentTypeError(f"'{name}' is not one of {', '.join(PLANTS)}")
    return text


def settings(options, media):
    values = {"seed": options.seed, "first": options.first, "workers": options.workers,
              "batch": options.batch, "limit": options.limit, "plant": options.plant or "",
              "only": options.only, "media": media}
    if options.cycles:
        values["cycles"] = options.cycles
    else:
        values["minutes"] = options.minutes or 2
    return [f"{name}={value}" for name, value in values.items()]


def make_media(root, folder):
    done = subprocess.run([f"{root}/tests/media/make-media.sh", folder, *MEDIA],
                          capture_output=True, text=True, check=False)
    if done.returncode != 0:
        raise OSError(f"the media cannot be made: {done.stderr.strip()}")


def new_folder(build, seed):
    folder = pathlib.Path(build, "soak", f"seed-{seed}")
    shutil.rmtree(folder, ignore_errors=True)
    folder.mkdir(parents=True)
    return folder


class LiveLine:
    """The newest checkpoint: always on a terminal, now and then elsewhere."""

    def __init__(self):
        self._shown = 0

    def show(self, row):
        if sys.stdout.isatty():
            print(f"\r{summary.live(row)}\033[K", end="", flush=True)
        elif time.monotonic() - self._shown > LINE_SECONDS:
            self._shown = time.monotonic()
            print(summary.live(row), flush=True)

    @staticmethod
    def end():
        if sys.stdout.isatty():
            print("\r\033[K", end="")


def follow(process, folder):
    """(checkpoints, how often each kind of media was used), as the program reports them."""
    checkpoints, counts, line = [], {}, LiveLine()
    with open(folder / "checkpoints.jsonl", "w", encoding="utf-8") as kept:
        for text in process.stdout:
            if not text.startswith("{"):
                continue  # What a virtual machine says that crashes.
            kept.write(text)
            row = json.loads(text)
            counts = row.get("counts", counts)
            if "cycles" in row:
                checkpoints.append(row)
                line.show(row)
    line.end()
    return checkpoints, counts


def failure(process, folder, crash_report):
    """Why the program did not end well, with the last actions; None when it did."""
    if process.returncode == 0:
        return None
    if crash_report.exists():
        reason = f"the virtual machine crashed: {crash_report}"
    elif (folder / "failure").exists():
        reason = (folder / "failure").read_text(encoding="utf-8").rstrip()
    else:
        reason = f"the program ended with status {process.returncode}; {folder / 'log'} may say why"
    last = ring.actions(folder / "actions") if (folder / "actions").exists() else []
    return "\n".join([*last, "", "The actions above are the last ones, the newest at the bottom.",
                      reason])


def conclude(checkpoints, counts, folder, title):
    """Prints the figures, draws them; whether something grows."""
    findings = growth.find(checkpoints)
    print("\n".join(summary.lines(findings)))
    for finding in findings:
        if finding.grows and f"{finding.quantity.key[:-1]}_names" in checkpoints[0]:
            key = f"{finding.quantity.key[:-1]}_names"
            print(f"more {finding.quantity.name}: "
                  + "; ".join(summary.changes(checkpoints[0], checkpoints[-1], key)))
    if counts:
        print("\n" + ", ".join(f"{what} {count}" for what, count in counts.items()))
    path = folder / "soak.svg"
    report.write_whole(path, picture.svg(findings, title, str(folder)))
    print(f"\nfigures: {folder / 'checkpoints.jsonl'}\npicture: {path}")
    return [finding.quantity.name for finding in findings if finding.grows]


def announce(options, surroundings):
    print(f"seed {options.seed}", flush=True)
    if not surroundings.has_sound:
        print("no package pulseaudio here: no sound server fails", flush=True)
    if not surroundings.has_disk:
        print("no right to mount a small disk here: no disk is full", flush=True)


def main(arguments, root, build, java):
    options = parse(arguments)
    if options.seed is None:
        options.seed = random.randrange(1_000_000)
    media = os.path.join(build, "media")
    make_media(root, media)
    folder = new_folder(build, options.seed)
    with tempfile.TemporaryDirectory(prefix="orv-soak-") as place:
        surroundings = machine.Machine(build, java, folder, place)
        announce(options, surroundings)
        process = surroundings.start(settings(options, media))
        try:
            checkpoints, counts = follow(process, folder)
            process.wait()
        finally:
            machine.end(process)
        problem = failure(process, folder, surroundings.crash_report())
    if problem:
        print(problem)
    grown = conclude(checkpoints, counts, folder, f"./orv soak, seed {options.seed}") \
        if checkpoints else []
    if grown:
        print(f"orv: it grows from cycle to cycle: {', '.join(grown)}", file=sys.stderr)
    if problem:
        print(f"orv: the run failed; ./orv soak --seed {options.seed} repeats it", file=sys.stderr)
    return 1 if problem or grown else 0


def run(arguments):
    split = len(arguments) - 1 - arguments[::-1].index("--")
    return main(arguments[:split], os.path.abspath(f"{__file__}/../../.."),
                os.path.abspath(os.environ["ORV_BUILD"]), arguments[split + 1])


if __name__ == "__main__":
    try:
        sys.exit(run(sys.argv[1:]))
    except KeyboardInterrupt:
        sys.exit(130)
    except OSError as error:
        print(f"orv: {error}", file=sys.stderr)
        sys.exit(1)
