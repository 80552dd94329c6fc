# SPDX-License-Identifier: Apache-2.0
"""The player that is examined: its commands, and what they print."""

import dataclasses
import json
import os
import re

import child


@dataclasses.dataclass
class Played:
    """What play --stats printed; None for what it did not."""
    shown: int | None
    dropped: int | None
    ended_at: float | None  # seconds


class Player:
    def __init__(self, command, limit):
        self.command = command
        self.limit = limit
        # Java reads names of files in the locale's encoding.
        self.environment = {**os.environ, "ORV_LOG": "silent", "LC_ALL": "C.UTF-8"}
        for display in ("DISPLAY", "WAYLAND_DISPLAY"):
            self.environment.pop(display, None)

    def describe(self, path):
        """(Outcome, what info --json says or None)"""
        outcome = self._run("info", "--json", path)
        return outcome, _object(outcome)

    def picture(self, path, at, size, out):
        """Writes the picture of a moment, in seconds, as a PNG file."""
        width, height = size
        return self._run("thumbnail", path, "--at", f"{at:.3f}", "--size", f"{width}x{height}", out)

    def play(self, path, start, seconds):
        """(Outcome, Played): from a time on, for about that many seconds, which
        are added to the limit."""
        outcome = self._run("play", "--no-window", "--stats", "--start", f"{start:.3f}", path,
                            limit=self.limit + seconds)
        return outcome, _played(outcome.out.decode(errors="replace"))

    def _run(self, *arguments, limit=None):
        return child.run([*self.command, *arguments], limit or self.limit, self.environment)


def _object(outcome):
    if not outcome.succeeded():
        return None
    try:
        value = json.loads(outcome.out)
    except ValueError:
        return None
    return value if isinstance(value, dict) else None


def _played(text):
    counts = re.search(r"(\d+) frames shown, (\d+) dropped$", text.rstrip())
    places = re.findall(r"^([\d.]+) s of ", text, re.MULTILINE)
    return Played(int(counts[1]) if counts else None, int(counts[2]) if counts else None,
                  float(places[-1]) if places else None)
