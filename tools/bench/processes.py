# SPDX-License-Identifier: Apache-2.0
"""Commands that end by themselves: what a user waits for, and what it costs."""

import itertools
import os
import tempfile

from figures import Comparison, Goal, Quantity, Side
from tree import run

FILM = "1080p60.mkv"
LONG = "three-hours.mkv"
NEAR_THE_END = 7199  # seconds: 1:59:59
THUMBNAILS = 100
PROCESSES = 10  # of which a thumbnail's share is taken
FILM_MILLIS = 15000
KEY_FRAME_MILLIS = 2000


def costs(goal=None):
    return (Quantity("time", "s", goal), Quantity("cpu", "s"), Quantity("memory", "MiB"))


def comparisons(place):
    return [_info(place), *_thumbnail(place), *_thumbnails(place)]


def command_side(name, command, environment):
    return Side(name, lambda: run(command, environment=environment).figures())


def _info(place):
    film, environment = place.media(FILM), place.environment()
    return Comparison(
        "info", costs(Goal(2.5)),
        command_side("./orv info", place.orv("info", film), environment),
        command_side("ffprobe", ["ffprobe", "-v", "error", "-show_format", "-show_streams",
                                 "-show_chapters", film], environment),
        lambda: place.make_media(FILM))


def _thumbnail(place):
    for name, media, at in (("thumbnail", FILM, 5), ("thumbnail-1:59:59", LONG, NEAR_THE_END)):
        yield Comparison(
            name, costs(Goal(3)),
            _picture_side("./orv thumbnail", place,
                          lambda out, media=media, at=at: _orv_thumbnail(place, media, at, out)),
            _picture_side("ffmpegthumbnailer", place,
                          lambda out, media=media, at=at: _thumbnailer(place, media, at, out)),
            lambda media=media: place.make_media(media))


def _orv_thumbnail(place, media, at, out):
    return place.orv("thumbnail", place.media(media), "--at", str(at), "--size", "320x180", out)


def _thumbnailer(place, media, at, out):
    hours, minutes, seconds = int(at) // 3600, int(at) // 60 % 60, int(at) % 60
    return ["ffmpegthumbnailer", "-i", place.media(media), "-s", "320",
            "-t", f"{hours:02}:{minutes:02}:{seconds:02}", "-o", out]


def _ffmpeg_picture(place, media, at, out):
    return ["ffmpeg", "-nostdin", "-v", "error", "-y", "-ss", str(at), "-i", place.media(media),
            "-frames:v", "1", "-s", "320x180", out]


def _picture_side(name, place, command):
    def take():
        with tempfile.TemporaryDirectory() as folder:
            return run(command(os.path.join(folder, "out.png")),
                       environment=place.environment()).figures()
    return Side(name, take)


# The share of one in a program that draws a hundred, its start included.
def _thumbnails(place):
    spread = [FILM_MILLIS * i // THUMBNAILS for i in range(THUMBNAILS)]
    keys = list(itertools.islice(
        itertools.cycle(range(0, FILM_MILLIS, KEY_FRAME_MILLIS)), THUMBNAILS))
    rows = (("thumbnails-100", "ffmpeg each", _ffmpeg_picture, spread, None),
            ("thumbnails-100-key-frames", "ffmpegthumbnailer each", _thumbnailer, keys,
             Goal(0.04)))
    for name, peer, command, times, goal in rows:
        yield Comparison(name, (Quantity("time", "ms", goal), Quantity("cpu", "ms")),
                         _together(place, times), _each(peer, place, command, times),
                         lambda: place.make_media(FILM))


def _together(place, times):
    program = place.java("com.quintora.mmp.Thumbnails", place.media(FILM), *map(str, times))
    return Side(f"{THUMBNAILS} in a Java program", lambda: _share(
        [run(program, environment=place.environment())], THUMBNAILS))


def _each(name, place, command, times):
    some = times[::THUMBNAILS // PROCESSES]
    def take():
        with tempfile.TemporaryDirectory() as folder:
            out = os.path.join(folder, "out.png")
            return _share([run(command(place, FILM, at / 1000, out),
                               environment=place.environment()) for at in some], PROCESSES)
    return Side(name, take)


def _share(usages, count):
    return {"time": 1000 * sum(usage.wall for usage in usages) / count,
            "cpu": 1000 * sum(usage.cpu for usage in usages) / count}
