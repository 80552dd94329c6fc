// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>

extern "C" {
#include <libavcodec/packet.h>
}

struct AVBufferSrcParameters;
struct AVFrame;
struct AVStream;

// All that the engine knows of the differences between releases of its
// libraries: mpv 0.35 to 0.40, FFmpeg 5.1 to 7.1.

namespace orvtarn {

// The name that earlier releases of mpv have for an option or property; null
// for a name that never changed.
const char* formerMpvName(const char* name);

// What the container says of a whole stream; null without, or where it is
// shorter than the size. The stream keeps it.
const uint8_t* streamSideData(const AVStream& stream, AVPacketSideDataType type, size_t size);

// Whether a decoded frame is two fields of different moments.
bool isInterlaced(const AVFrame& frame);

// Says which colours the frames of a filter graph's source have, where it wants
// to know beforehand.
void setSourceColors(AVBufferSrcParameters& parameters, const AVFrame& like);

}  // namespace orvtarn
