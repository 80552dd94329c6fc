// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

// Pixel formats of a thumbnail. Modes that are not named are not drawn. All
// 16-bit formats are in native byte order, the first channel in the high bits.
// Alpha is the picture's own, opaque for nearly all video. The 4:2:2 formats
// are BT.601 in limited range; an odd width ends in half a pair of pixels.
enum : int32_t {
    ORV_COLOR_MODE_RGB565 = 3,
    ORV_COLOR_MODE_ARGB1555 = 4,
    ORV_COLOR_MODE_ARGB8888 = 5,  // bytes B, G, R, A in memory order
    ORV_COLOR_MODE_UYVY422 = 9,   // bytes U, Y, V, Y of two pixels
    ORV_COLOR_MODE_YUYV422 = 10,  // bytes Y, U, Y, V of two pixels
    ORV_COLOR_MODE_ARGB4444 = 11,
    ORV_COLOR_MODE_RGBA8888 = 12,  // bytes R, G, B, A
    ORV_COLOR_MODE_BGR565 = 15,
    ORV_COLOR_MODE_GRAY16 = 16,    // 0 to 65535
    ORV_COLOR_MODE_ABGR8888 = 17,  // bytes A, B, G, R
    ORV_COLOR_MODE_XRGB8888 = 18,  // bytes B, G, R, 255
};

// A request for one picture of the current position, stretched to the width and
// height whatever its proportions. Rows of the buffer are width pixels each,
// padded to a multiple of 64 bytes; the padding is left alone. Sizes go from 1
// to 16384.
struct _Media_Thumbnail_Info_T {
    uint8_t* pBuffer;
    uint32_t u4BufferSize;  // bytes
    int32_t i4CanvasColormode;
    int32_t i4Width;   // pixels
    int32_t i4Height;  // rows
};

// An embedded picture as the media's own bytes: this header and the bytes in
// one block of malloc, given up with free.
struct MediaAlbumArt {
    uint32_t mSize;  // bytes

    uint32_t size() const { return mSize; }
    const uint8_t* data() const { return reinterpret_cast<const uint8_t*>(this + 1); }
    uint8_t* data() { return reinterpret_cast<uint8_t*>(this + 1); }
};
