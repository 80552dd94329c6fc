# SPDX-License-Identifier: Apache-2.0
"""A wall of small films that play at once: in one Java program, beside a process
of mpv for each."""

import os
import re
import tempfile

from figures import Comparison, Failed, Goal, Quantity, Side
from playing import PLAY_LIMIT, SECONDS, mpv
from tree import run

PLAYERS = 16
RATE = 30  # frames a second
FILM = "wall.mkv"
START_ALL = 'folder=$1; shift; for i in $(seq {}); do "$@" >"$folder/$i" 2>&1 & done; wait'


def comparisons(place):
    film = place.media(FILM)
    environment = {**place.environment(), "ORV_LOG": "silent"}
    program = place.java("com.quintora.orv.player.Wall", str(PLAYERS), film)
    return [Comparison(
        f"wall-{PLAYERS}",
        (Quantity("dropped", "frames", Goal(0, "value")), Quantity("cpu", "s"),
         Quantity("memory", "MiB"), Quantity("time", "s")),
        Side(f"{PLAYERS} players", lambda: _players(program, environment)),
        Side(f"{PLAYERS} of mpv --vo=null", lambda: _processes(film, environment)),
        lambda: place.make_media(FILM))]


def _players(program, environment):
    usage = run(program, PLAY_LIMIT, environment)
    counts = re.search(r"(?P<shown>\d+) frames shown, (?P<dropped>\d+) dropped", usage.out)
    return _figures(usage, [counts], PLAYERS)


def _processes(film, environment):
    command = mpv("--vo=null", "--no-input-terminal", "--msg-level=all=error,statusline=status",
                  "--term-status-msg=dropped ${frame-drop-count} of ${estimated-frame-number}",
                  film)
    with tempfile.TemporaryDirectory() as folder:
        usage = run(["sh", "-c", START_ALL.format(PLAYERS), "sh", folder, *command], PLAY_LIMIT,
                    environment)
        counts = [_last_count(os.path.join(folder, name)) for name in os.listdir(folder)]
    return _figures(usage, counts, PLAYERS)


def _last_count(path):
    with open(path, encoding="utf-8", errors="replace") as file:
        counts = [*re.finditer(r"dropped (?P<dropped>\d+) of (?P<shown>\d+)", file.read())]
    return counts[-1] if counts else None


def _figures(usage, counts, players):
    """Refuses a run that did not get to the end of all films."""
    if None in counts:
        raise Failed("did not say how many frames it showed")
    shown = sum(int(count["shown"]) for count in counts)
    dropped = sum(int(count["dropped"]) for count in counts)
    if shown + dropped < players * RATE * (SECONDS - 1):
        raise Failed(f"played {shown + dropped} frames of {players * RATE * SECONDS}")
    return {**usage.figures(), "dropped": dropped}
