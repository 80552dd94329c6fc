# SPDX-License-Identifier: Apache-2.0
"""What ffprobe and ffmpeg say of a file."""

import json

import child

# Formats that are guessed from a name, and are text.
NO_MEDIA = {"tty"}
# AVPROBE_SCORE_RETRY of libavformat.
WEAK_SCORE = 25
# How far ahead of a moment its frame is looked for, in seconds.
WINDOWS = (2, 20, None)


class Reference:
    """One file. `streams` and `format` are ffprobe's; empty when it cannot
    read it."""

    def __init__(self, path, limit):
        self.path = path
        self.limit = limit
        probe = self._probe()
        self.format = probe.get("format", {})
        self.streams = probe.get("streams", [])
        if self.format.get("format_name") in NO_MEDIA:
            self.streams = []

    def video(self):
        """Its video streams, without attached pictures."""
        return [s for s in self._of_type("video") if not s["disposition"].get("attached_pic")]

    def audio(self):
        return self._of_type("audio")

    def subtitles(self):
        return self._of_type("subtitle")

    def duration(self):
        """Seconds, or None when unknown."""
        return _number(self.format.get("duration"))

    def is_media(self):
        """Whether ffmpeg decodes any video or sound of it."""
        if not self.video() and not self.audio():
            return False
        done = self._ffmpeg("-t", "5", "-i", self.path, "-map", "0:V?", "-map", "0:a?",
                            "-progress", "-", "-f", "null", "/dev/null")
        ends = [line.split("=")[1] for line in done.out.decode(errors="replace").splitlines()
                if line.startswith(("out_time_us=", "frame="))]
        return done.succeeded() and any(_number(end) for end in ends)

    def is_guess(self):
        """Whether ffprobe itself would rather have read more before it said
        which format this is."""
        return self.format.get("probe_score", 0) <= WEAK_SCORE

    def packet_times(self, stream, start, seconds=None):
        """The presentation times of a stream's packets from `start` on, in
        seconds from the start of the media, sorted."""
        origin = _number(self.format.get("start_time")) or 0
        # FFmpeg 7 reads nothing of an interval without an end.
        interval = [] if seconds is None else [
            "-read_intervals", f"{start + origin:.3f}%+{seconds}"]
        done = child.run(
            ["ffprobe", "-v", "error", "-select_streams", str(stream["index"]),
             "-show_entries", "packet=pts_time", "-of", "csv=p=0", *interval, self.path],
            self.limit)
        times = (_number(line.strip(",")) for line in done.out.decode().splitlines())
        return sorted(time - origin for time in times if time is not None and time - origin >= start)

    def picture(self, stream, at, size):
        """The frame that is shown at that time as RGB bytes, or None: of the
        last frames before it the last."""
        width, height = size
        deinterlace = "bwdif=deint=interlaced," if is_interlaced(stream) else ""
        for window in WINDOWS:
            start = 0 if window is None else max(0, at - window)
            seek = ["-ss", f"{start:.3f}"] if start else []
            # An option -t would round to whole frames.
            filters = f"trim=end={at - start + 0.0005:.4f},{deinterlace}" \
                      f"scale={width}:{height}:in_color_matrix={matrix(stream)}"
            done = self._ffmpeg(
                *seek, "-i", self.path, "-map", f"0:{stream['index']}", "-vf", filters,
                "-fps_mode", "passthrough", "-f", "rawvideo", "-pix_fmt", "rgb24", "-")
            picture = done.out[-width * height * 3:]
            if len(picture) == width * height * 3:
                return picture
        return None

    def _of_type(self, kind):
        return [s for s in self.streams if s.get("codec_type") == kind]

    def _probe(self):
        done = child.run(["ffprobe", "-v", "error", "-show_format", "-show_streams", "-of", "json",
                          self.path], self.limit)
        return json.loads(done.out) if done.succeeded() else {}

    def _ffmpeg(self, *arguments):
        return child.run(["ffmpeg", "-nostdin", "-v", "error", "-y", *arguments], self.limit)


def is_interlaced(stream):
    return stream.get("field_order", "progressive") not in ("progressive", "unknown")


def matrix(stream):
    """The colour matrix as the filter scale has it: of large video that does
    not name one players take that of high definition, ffmpeg does not."""
    unnamed = stream.get("color_space", "unknown") == "unknown"
    large = stream.get("width", 0) >= 1280 or stream.get("height", 0) > 576
    return "bt709" if unnamed and large else "auto"


def is_hdr(stream):
    return stream.get("color_transfer") in ("smpte2084", "arib-std-b67")


def shape(stream):
    """Width by height of the picture as it is shown, upright and with square
    pixels; None when unknown."""
    width, height = stream.get("width", 0), stream.get("height", 0)
    if not width or not height:
        return None
    across, _, down = stream.get("sample_aspect_ratio", "1:1").partition(":")
    aspect = width * (int(across) or 1) / (int(down or 1) or 1) / height
    turns = [data["rotation"] for data in stream.get("side_data_list", []) if "rotation" in data]
    return 1 / aspect if turns and round(turns[0] / 90) % 2 else aspect


def _number(text):
    try:
        return float(text)
    except (TypeError, ValueError):
        return None
