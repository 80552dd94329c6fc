// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "base/PictureFilters.h"

extern "C" {
#include <libavutil/mastering_display_metadata.h>
#include <libavutil/rational.h>
}

struct AVFormatContext;
struct AVFrame;
struct AVStream;

// What a video stream says of the look of its pictures. Nothing here reads from
// the file.
namespace orvtarn {

struct LightMetadata {
    const AVMasteringDisplayMetadata* mastering = nullptr;  // null: unknown
    const AVContentLightMetadata* content = nullptr;
};

struct PictureSize {
    int width = 0;   // square pixels
    int height = 0;  // rows
};

Orientation orientationOf(const AVStream& stream);

// Of the stream as a whole, and of one frame where the container says nothing.
LightMetadata lightOf(const AVStream& stream);
LightMetadata lightOf(const AVFrame& frame);

// The shape of stored pixels; 0/1 when unknown, which means square.
AVRational pixelAspect(const AVFormatContext& media, const AVStream& stream);

// For display: pixels made square by stretching the width, as players do, and
// turned. {0, 0} for a stream without a size.
PictureSize displayedSize(const AVFormatContext& media, const AVStream& stream);

// Of a frame of the stream, whose unknown colours are taken as players take
// them: matrix by size, before it is turned.
PictureTraits traitsOf(const AVStream& stream, const AVFrame& frame);

// The matrix of a frame that may not name it.
AVColorSpace matrixOf(const AVFrame& frame);

}  // namespace orvtarn
