# SPDX-License-Identifier: Apache-2.0
"""Seeks to the frame of a time in media that rests: the player's window's and
mpv's own, which is driven through its socket and reports the end of each."""

import json
import os
import socket
import statistics
import tempfile
import time

from figures import Comparison, Failed, Goal, Quantity, Side
from playing import mpv
from tree import run
from watching import await_true, watch

# Forward and back, near and far, in a film of 15 s; the first one warms up.
TIMES = (5000, 1230, 9870, 10010, 4440, 13370, 12900, 250, 7770, 6660, 11110)  # ms
LIMIT = 120


def comparisons(place):
    return [_exact(place, name) for name in ("1080p60", "2160p30")]


def _exact(place, name):
    film = place.media(f"{name}.mkv")
    program = place.java("com.quintora.orv.player.ExactSeeks", film, *map(str, TIMES))
    environment = {**place.environment(), "ORV_LOG": "silent"}
    return Comparison(
        f"exact-seek-{name}", (Quantity("", "ms", Goal(1.05)),),
        Side("the player's seek", lambda: _mean(
            map(float, run(program, LIMIT, environment).out.split()))),
        Side("mpv's exact seek", lambda: _mean(_mpv_seeks(film, environment))),
        lambda: place.make_media(f"{name}.mkv"))


def _mean(times):
    return {"": statistics.fmean(list(times)[1:])}


def _mpv_seeks(film, environment):
    """What each took, in milliseconds."""
    with tempfile.TemporaryDirectory() as folder:
        path = os.path.join(folder, "socket")
        command = mpv("--vo=null", "--pause", "--keep-open=yes", "--msg-level=all=error",
                      f"--input-ipc-server={path}", film)
        times, _ = watch(command, environment, lambda tree: _drive(path, tree))
    return times


def _drive(path, tree):
    await_true(lambda: os.path.exists(path), tree, LIMIT, "its socket", 0.01)
    with socket.socket(socket.AF_UNIX) as connection:
        connection.settimeout(LIMIT)
        connection.connect(path)
        lines = connection.makefile("r", encoding="utf-8")
        _await_media(connection, lines)
        return [_seek(connection, lines, time_ms / 1000) for time_ms in TIMES]


def _await_media(connection, lines):
    """mpv has shown the first frame when it knows the time of it."""
    until = time.monotonic() + LIMIT
    while time.monotonic() < until:
        _send(connection, "get_property", "time-pos")
        answer = _next(lines, lambda message: "error" in message)
        if answer["error"] == "success":
            return
        time.sleep(0.05)
    raise Failed("no picture")


def _seek(connection, lines, seconds):
    begin = time.monotonic()
    _send(connection, "seek", seconds, "absolute+exact")
    _next(lines, lambda message: message.get("event") == "playback-restart")
    return 1000 * (time.monotonic() - begin)


def _send(connection, *command):
    connection.sendall(json.dumps({"command": command}).encode() + b"\n")


def _next(lines, matches):
    try:
        for line in lines:
            if matches(message := json.loads(line)):
                return message
    except TimeoutError as error:
        raise Failed(f"no answer within {LIMIT} s") from error
    raise Failed("mpv closed its socket")
