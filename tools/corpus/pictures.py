# SPDX-License-Identifier: Apache-2.0
"""Compares pictures."""

import math

import child

HEIGHT = 180
WIDEST = 8192


def size_for(aspect):
    """The size at which pictures of a shape are compared."""
    return max(1, min(WIDEST, round(HEIGHT * aspect))), HEIGHT


def read_png(path, limit):
    """A PNG file's RGB bytes; empty when it is none."""
    return child.run(["ffmpeg", "-nostdin", "-v", "error", "-i", path, "-f", "rawvideo",
                      "-pix_fmt", "rgb24", "-"], limit).out


def psnr(one, other):
    """The peak signal-to-noise ratio of two pictures in dB; 0 when they are
    not of one size, infinite when they are equal."""
    if len(one) != len(other) or not one:
        return 0.0
    squares = sum((a - b) * (a - b) for a, b in zip(one, other))
    return 10 * math.log10(255 * 255 * len(one) / squares) if squares else math.inf
