# SPDX-License-Identifier: Apache-2.0
"""Fifteen seconds of film at their own speed, without a window and in one, and
how long a picture takes to come. mpv plays as it does for its users, but for
its configuration file and for the drivers, which are those that the engine tries."""

import re
import time

from display import is_green, is_magenta
from figures import Comparison, Failed, Goal, Quantity, Side
from tree import run
from watching import await_true, watch

FILMS = (("1080p60", 60, Goal(1.3), Goal(1.0)), ("2160p30", 30, Goal(1.15), Goal(0.9)))
SECONDS = 15
PLAY_LIMIT = 120
PICTURE_LIMIT = 60
WINDOW = "2048x1280"  # at most, as the player's own in that screen

PACED = (Quantity("memory", "MiB"), Quantity("time", "s"), Quantity("dropped", "frames"))
SHOWN = (Quantity("memory", "MiB"), Quantity("display-cpu", "s"), Quantity("time", "s"),
         Quantity("picture-width", "px"))


def comparisons(place):
    for name, rate, without, within in FILMS:
        yield _without_window(place, name, rate, without)
        yield _in_window(place, name, within)
    yield _first_frame(place)


def mpv(*options):
    return ["mpv", "--no-config", "--ao=pulse,alsa,null", *options]


def _without_window(place, name, rate, goal):
    film, environment = place.media(f"{name}.mkv"), place.environment()
    return Comparison(
        f"no-window-{name}", (Quantity("cpu", "s", goal), *PACED),
        Side("./orv play --no-window", lambda: _figures(
            run(place.orv("play", "--no-window", "--stats", film), PLAY_LIMIT, environment),
            r"(?P<shown>\d+) frames shown, (?P<dropped>\d+) dropped", rate)),
        Side("mpv --vo=null", lambda: _figures(
            run(mpv("--vo=null", "--msg-level=all=error,statusline=status", "--term-status-msg="
                    "dropped ${frame-drop-count} of ${estimated-frame-number}", film),
                PLAY_LIMIT, environment),
            r"dropped (?P<dropped>\d+) of (?P<shown>\d+)", rate)),
        lambda: place.make_media(f"{name}.mkv"))


def _figures(usage, pattern, rate):
    """Refuses a run that did not get to the end of the film."""
    counts = [*re.finditer(pattern, usage.out + usage.err)]
    if not counts:
        raise Failed("did not say how many frames it showed")
    shown, dropped = int(counts[-1]["shown"]), int(counts[-1]["dropped"])
    if shown + dropped < rate * (SECONDS - 1):
        raise Failed(f"played {shown + dropped} frames of {rate * SECONDS}")
    return {**usage.figures(), "dropped": dropped}


def _in_window(place, name, goal):
    film = place.media(f"{name}.mkv")
    return Comparison(
        f"window-{name}", (Quantity("cpu", "s", goal), *SHOWN),
        Side("./orv play", lambda: _play_in_window(place.display(), place.orv("play", film))),
        Side("mpv --vo=x11", lambda: _play_in_window(place.display(), _mpv_in_window(film))),
        lambda: place.make_media(f"{name}.mkv"))


def _mpv_in_window(film):
    return mpv("--vo=x11", f"--autofit-larger={WINDOW}", "--keep-open=yes", film)


def _play_in_window(display, command):
    """From the command to the film's last second, when it is ended."""
    def look(tree):
        await_true(lambda: display.middle(is_magenta), tree, PICTURE_LIMIT, "the picture", 0.005)
        first = time.monotonic()
        await_true(lambda: display.middle(is_green), tree, PLAY_LIMIT, "the end", 0.02)
        return {"time": time.monotonic() - first, "picture-width": 2 * display.extent(is_green),
                "display-cpu": display.processor_seconds() - before}
    before = display.processor_seconds()
    seen, usage = watch(command, display.environment(), look)
    return {**usage.figures(), **seen}


def _first_frame(place):
    film = place.media("1080p60.mkv")
    return Comparison(
        "first-frame", (Quantity("time", "s", Goal(1.0)), Quantity("cpu", "s")),
        Side("./orv play", lambda: _until_picture(place.display(), place.orv("play", film))),
        Side("mpv --vo=x11", lambda: _until_picture(place.display(), _mpv_in_window(film))),
        lambda: place.make_media("1080p60.mkv"))


def _until_picture(display, command):
    def look(tree):
        await_true(lambda: display.middle(is_magenta), tree, PICTURE_LIMIT, "the picture", 0.002)
        return time.monotonic() - tree.started
    waited, usage = watch(command, display.environment(), look)
    return {"time": waited, "cpu": usage.cpu}
