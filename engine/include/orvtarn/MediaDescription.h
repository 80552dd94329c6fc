// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

// What the media say of themselves beyond the records: a text of any length that
// getSubtitleTrackInfo hands out in pieces of its mText, in the order of the
// indices from ORV_DESCRIPTION_INDEX_BASE on until it answers false. mCodec is
// ORV_DESCRIPTION_CODEC, the other members are 0 and empty. The text stays the
// same from one prepare to the next load; it is empty for media that cannot be
// read twice. An engine without it answers false at once.
//
// The text is UTF-8 in lines that end in '\n'. A line "[media]" begins what is
// said of the whole, a line "[stream]" each of its streams, in the container's
// order; the rest are "name=value". In values "\\" stands for a backslash, "\n"
// and "\r" for line breaks. Values that are unknown have no line; names that a
// reader does not know are for it to pass over. Names of formats, codecs and
// colours are FFmpeg's, numbers are decimal with a point.
//
// [media]: format, formatName (in words), durationUs, startUs (the first
// timestamp), bitRate (bits per second), size (bytes), streams (how many).
//
// [stream]: index (from 0), kind (video, picture, audio, subtitle, attachment,
// data), track (position in the table of its kind, for those that are tracks),
// codec, codecName (in words), codecTag (the container's code), profile, level,
// language (ISO 639), title, flags (FFmpeg's dispositions, with commas),
// startUs, durationUs, bitRate.
//   video and picture: width and height (stored pixels), displayWidth and
//   displayHeight (square pixels, turned), pixelAspect and displayAspect (w:h, as
//   stored), rotation (degrees clockwise to turn for display), mirrored (1: then
//   left and right change sides), pixelFormat, bitDepth (of a component),
//   fieldOrder (progressive, tt, bb, tb, bt), primaries, transfer, matrix, range
//   (tv or pc), chromaLocation, frameRate (frames/seconds, the average),
//   masteringMinLuminance, masteringMaxLuminance, maxContentLight and
//   maxFrameAverageLight (cd/m²), dolbyVisionProfile.
//   audio: sampleRate (Hz, as decoded), channels, channelLayout, sampleFormat,
//   bitsPerSample.
//   attachment: fileName, mimeType, size (bytes).
enum : int32_t {
    ORV_DESCRIPTION_INDEX_BASE = 0x20000,
    ORV_DESCRIPTION_CODEC = 'd' | 'e' << 8 | 's' << 16 | 'c' << 24,
};
