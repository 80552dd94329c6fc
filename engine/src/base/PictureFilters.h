// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <string>

extern "C" {
#include <libavutil/pixfmt.h>
}

namespace orvtarn {

// How a picture is turned for display: first clockwise, then mirrored.
struct Orientation {
    int rotation = 0;         // degrees clockwise: 0, 90, 180, 270
    bool isMirrored = false;  // left and right change sides

    bool isUpright() const { return rotation == 0 && !isMirrored; }
    // Width and height change places.
    bool isLying() const { return rotation == 90 || rotation == 270; }
};

// From a display matrix as libavutil/display.h describes it, to the nearest
// quarter; upright without one or for a matrix that cannot be inverted.
Orientation orientationOf(const int32_t* displayMatrix);

// What a decoded picture's look depends on. Members that are left alone mean an
// upright, progressive picture of standard dynamic range.
struct PictureTraits {
    int width = 0;   // stored pixels
    int height = 0;  // stored rows
    Orientation orientation;
    bool isInterlaced = false;
    AVColorTransferCharacteristic transfer = AVCOL_TRC_UNSPECIFIED;
    AVColorPrimaries primaries = AVCOL_PRI_UNSPECIFIED;
    AVColorSpace matrix = AVCOL_SPC_UNSPECIFIED;  // AVCOL_SPC_RGB for RGB pixel formats
    AVColorRange range = AVCOL_RANGE_UNSPECIFIED;
    // The brightest light in the content or of the display it was mastered on, in
    // cd/m²; 0 when unknown.
    double peakLuminance = 0;
};

// PQ (SMPTE ST 2084) or HLG (ARIB STD-B67).
bool isHighDynamicRange(const PictureTraits& traits);

// A libavfilter graph description with one input and one output, in the syntax
// of avfilter_graph_parse2() and of mpv's "lavfi" filter, that makes pictures
// with those traits upright, progressive and BT.709 in standard dynamic range.
// Empty when there is nothing to do. Playback and thumbnails use the same text,
// so that they look the same. Frames keep their number and times. Pixels keep
// their shape: they are not made square. Pure and thread-safe.
//
// Needs FFmpeg with bwdif, hflip, vflip, transpose, and for HDR zscale (libzimg)
// and tonemap; Debian's has them.
std::string pictureFilters(const PictureTraits& traits);

}  // namespace orvtarn
