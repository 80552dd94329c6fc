# SPDX-License-Identifier: Apache-2.0
"""What differs between the player's word on a file and the reference's."""

import dataclasses
import os
import tempfile

import pictures
import reference as ref
from reference import Reference

# Worst first.
KINDS = ("crash", "hang", "refused", "playback", "picture", "duration", "tracks", "size", "frames",
         "codec", "extra")

ALIKE_DB = 25
PARTS = (0, 0.45, 0.9)  # of the duration, at which pictures are compared
# Longer media are played for the last so many seconds.
SECTION = 5
ROUNDING = 0.1  # seconds


@dataclasses.dataclass
class Difference:
    kind: str
    file: str
    where: str  # the command, and of what
    ours: str
    theirs: str


class Examination:
    """One file, examined from all sides. `differences` is what was found,
    `notes` what could not be compared."""

    def __init__(self, player, path, name):
        self.player = player
        self.path = path
        self.name = name
        self.differences = []
        self.notes = []
        self.reference = Reference(path, player.limit)

    def run(self):
        outcome, info = self.player.describe(self.path)
        ended = self._ended("info", outcome)
        is_media = self.reference.is_media()
        if ended and info is None and is_media and not self.reference.is_guess():
            self._add("refused", "info", outcome.reason(), self.reference.format["format_name"])
        if info is not None and not is_media:
            self._add("extra", "info", info.get("container", "readable"), "not readable")
        if info is not None and is_media:
            self._compare_info(info)
            self._compare_pictures()
        self._compare_playback(info is not None and is_media)
        return self

    def _add(self, kind, where, ours, theirs):
        self.differences.append(Difference(kind, self.name, where, str(ours), str(theirs)))

    def _ended(self, where, outcome):
        """Whether it ended by itself, well or not; adds how else it ended."""
        if outcome.hung():
            self._add("hang", where, f"killed after {self.player.limit:g} s", "")
        elif outcome.crashed():
            self._add("crash", where, outcome.reason(), "")
        else:
            return True
        return False

    def _compare_info(self, info):
        self._compare_duration(info.get("durationMs", 0) / 1000)
        for kind, theirs in (("video", self.reference.video()), ("audio", self.reference.audio()),
                             ("subtitles", self.reference.subtitles())):
            ours = info.get(kind, [])
            if len(ours) != len(theirs):
                self._add("tracks", f"info {kind}", len(ours), len(theirs))
                continue
            for index, (our_track, their_track) in enumerate(zip(ours, theirs)):
                self._compare_track(f"info {kind} {index}", our_track, their_track)

    def _compare_duration(self, ours):
        theirs = self.reference.duration()
        if theirs is not None and abs(ours - theirs) > ROUNDING + theirs / 1000:
            self._add("duration", "info", f"{ours:.3f} s", f"{theirs:.3f} s")

    def _compare_track(self, where, ours, theirs):
        if not is_same_codec(ours, theirs):
            self._add("codec", where, ours.get("codec"), theirs.get("codec_name"))
        for name, their_name in (("width", "width"), ("height", "height"), ("channels", "channels"),
                                 ("sampleRate", "sample_rate")):
            # A probe without the codec's parameters says 0.
            known = int(theirs.get(their_name) or 0)
            if name in ours and known and ours[name] != known:
                self._add("size", f"{where} {name}", ours[name], known)

    def _compare_pictures(self):
        streams = self.reference.video()
        aspect = ref.shape(streams[0]) if streams else None
        if aspect is None:
            return
        if ref.is_hdr(streams[0]):
            self.notes.append("pictures: their dynamic range is mapped in more than one way")
            return
        duration = self.reference.duration() or 0
        for part in PARTS if duration else (0,):
            self._compare_picture(streams[0], part * duration, pictures.size_for(aspect))

    def _compare_picture(self, stream, near, size):
        at = self._between_frames(stream, near)
        where = f"thumbnail --at {at:.3f}"
        with tempfile.TemporaryDirectory() as folder:
            out = os.path.join(folder, "out.png")
            outcome = self.player.picture(self.path, at, size, out)
            if not self._ended(where, outcome):
                return
            theirs = self.reference.picture(stream, at, size)
            if theirs is None:
                self.notes.append(f"{where}: ffmpeg gives no picture")
            elif not outcome.succeeded():
                self._add("picture", where, outcome.reason(), "a picture")
            else:
                likeness = pictures.psnr(pictures.read_png(out, self.player.limit), theirs)
                if likeness < ALIKE_DB:
                    self._add("picture", where, f"{likeness:.1f} dB", f"{ALIKE_DB} dB")

    def _between_frames(self, stream, near):
        """A time at which rounding cannot decide which frame is shown."""
        times = self.reference.packet_times(stream, near, 5)
        return (times[0] + times[1]) / 2 if len(times) > 1 else near

    def _compare_playback(self, is_readable):
        duration = self.reference.duration() or 0
        start = duration - SECTION if duration > 2 * SECTION else 0
        outcome, played = self.player.play(self.path, start, duration - start)
        if not self._ended("play", outcome) or not is_readable:
            return
        if not outcome.succeeded():
            self._add("playback", "play", outcome.reason(), "decodes")
            return
        if duration and (played.ended_at or 0) < duration - 1:
            self._add("playback", "play", f"ended at {played.ended_at} s", f"{duration:.1f} s")
        self._compare_frames(played, start)

    def _compare_frames(self, played, start):
        streams = self.reference.video()
        if not streams or played.shown is None:
            return
        theirs = len(self.reference.packet_times(streams[0], start))
        slack = 2 + theirs // 50
        # A busy machine drops frames: those are counted, not lost.
        if played.shown > theirs + slack or played.shown + played.dropped < theirs - slack:
            self._add("frames", f"play --start {start:.3f}",
                      f"{played.shown} shown, {played.dropped} dropped", theirs)


def is_same_codec(ours, theirs):
    """Whether any name that the player has for a codec is one of ffprobe's."""
    names = {str(value).lower().strip() for key, value in ours.items() if key.startswith("codec")}
    known = {str(theirs.get(key, "")).lower() for key in ("codec_name", "codec_tag_string")}
    long_name = theirs.get("codec_long_name", "").lower()
    return bool(names & known) or any(name and name in long_name for name in names)
