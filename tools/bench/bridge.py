# SPDX-License-Identifier: Apache-2.0
"""Calls between Java and the library, and the library's own parts, each beside
the least that the same can be done with. Both are rows of the program in
bench/, which has a process of its own for each sample. The time of short calls
is little on a machine that others use, too: what they cost is processor time."""

import json
import os
import re
import subprocess
import tempfile

from figures import Comparison, Failed, Goal, Quantity, Side
from tree import run

FOREIGN_JAVA = 22
LIMIT = 300
SECONDS_EACH = 0.2
UNITS = {"ns": 1, "us": 1e3, "ms": 1e6}

POSITION, EMPTY = "call/current_position", "by_hand/empty_native"
OF_A_STREAM = Goal(1.1)

# Name, the program's row for it, that beside it, a goal of the processor time.
PAIRS = (
    ("position", POSITION, EMPTY, Goal(40, "over")),
    ("position-jna", POSITION, "by_hand/empty_jna", None),
    ("position-foreign", POSITION, "by_hand/empty_foreign", None),
    ("service", "service/position", "engine/position", None),
    ("engine", "engine/position", "by_hand/virtual_call", None),
    ("stream-4KiB", "stream/read/4096", "by_hand/read/4096", OF_A_STREAM),
    ("stream-64KiB", "stream/read/65536", "by_hand/read/65536", OF_A_STREAM),
    ("stream-4KiB-memcpy", "stream/read/4096", "by_hand/memcpy/4096", None),
    ("stream-64KiB-memcpy", "stream/read/65536", "by_hand/memcpy/65536", None),
    ("event", "event/post", "by_hand/event", None),
    ("pool-4KiB", "pool/allocate_and_free/4096", "by_hand/map_and_unmap/4096", None),
    ("pool-64KiB", "pool/allocate_and_free/65536", "by_hand/map_and_unmap/65536", None),
    ("log-line", "log/line", "by_hand/line", None),
)

# Name, the program's row for it and its unit, for which there is no less.
ALONE = (
    ("duration-silent", "call/duration/log:silent", "ns"),
    ("duration-logged", "call/duration/log:info", "ns"),
    ("audio-tracks", "call/audio_tracks", "ns"),
    ("pcm-description", "call/pcm_description", "ns"),
    ("create-and-release", "player/create_and_release", "ms"),
    ("open", "player/open", "ms"),
    ("key-frame-seek", "player/seek", "ms"),
    ("thumbnail-in-player", "player/thumbnail", "ms"),
)

# Of so many at once, the share of one, beside that when there is but one.
PENDING = (10, 100, 1000, 10000, 100000)
TRACKS = (8, 64)


def comparisons(place):
    return [*(_pair(place, *pair) for pair in PAIRS
              if pair[0] != "position-foreign" or _java_version(place) >= FOREIGN_JAVA),
            *(_alone(place, *row) for row in ALONE),
            *(_growth(place, f"pending-events-{count}", "event/pending/{}", count)
              for count in PENDING),
            *(_growth(place, f"tracks-{count}", "call/tracks:{}", count) for count in TRACKS)]


def _pair(place, name, here, peer, goal):
    return Comparison(name, (Quantity("cpu", "ns", goal), Quantity("time", "ns")),
                      Side(here, lambda: _take(place, here)),
                      Side(peer.replace("by_hand/", "by hand: ").replace("_", " "),
                           lambda: _take(place, peer)), lambda: _prepare(place))


def _alone(place, name, row, unit):
    return Comparison(name, (Quantity("time", unit), Quantity("cpu", unit)),
                      Side(row, lambda: _take(place, row, UNITS[unit])),
                      prepare=lambda: _prepare(place))


def _growth(place, name, row, count):
    def side(number):
        return lambda: _take(place, row.format(number), 1000 * number)
    return Comparison(name, (Quantity("cpu", "us each"), Quantity("time", "us each")),
                      Side(f"of {count}", side(count)), Side("a single one", side(1)),
                      lambda: _prepare(place))


def _prepare(place):
    place.make_media("tracks-1.mka", *(f"tracks-{count}.mka" for count in TRACKS))
    script = os.path.join(place.root, "tests", "media", "make-media.sh")
    done = subprocess.run([script, os.path.join(place.build, "media"), "feature.mkv",
                           "tone-s16le.pcm"], capture_output=True, text=True, check=False)
    if done.returncode != 0:
        raise Failed(f"the media cannot be made: {done.stderr.strip()}")


def _take(place, row, divisor=1):
    """The row's times in nanoseconds, divided."""
    with tempfile.TemporaryDirectory() as folder:
        out = os.path.join(folder, "out.json")
        run([os.path.join(place.build, "bin", "orv_bench"),
             f"--benchmark_filter=^{re.escape(row)}(/process_time)?(/real_time)?$",
             f"--benchmark_min_time={SECONDS_EACH}", f"--benchmark_out={out}",
             "--benchmark_out_format=json"], LIMIT, place.environment())
        with open(out, encoding="utf-8") as file:
            found = json.load(file)["benchmarks"]
    if len(found) != 1:
        raise Failed(f"{len(found)} rows of the program in bench/ are named {row}")
    scale = UNITS[found[0]["time_unit"]] / divisor
    return {"time": found[0]["real_time"] * scale, "cpu": found[0]["cpu_time"] * scale}


def _java_version(place):
    """The major one, of the Java that everything is built with; 0 when unknown."""
    home = os.path.dirname(os.path.dirname(os.path.realpath(place.player[0])))
    try:
        with open(os.path.join(home, "release"), encoding="utf-8") as file:
            found = re.search(r'^JAVA_VERSION="(\d+)', file.read(), re.MULTILINE)
    except FileNotFoundError:
        return 0
    return int(found[1]) if found else 0
