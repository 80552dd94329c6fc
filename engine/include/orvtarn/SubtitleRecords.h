// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

enum E_Subtitle_Attr_Type : int {
    E_SUBTITLE_ATTR_TYPE_TIME_OFFSET = 0,
    E_SUBTITLE_ATTR_TYPE_FONT_INFO = 2,
    E_SUBTITLE_ATTR_TYPE_BG_COLOR = 3,
    E_SUBTITLE_ATTR_TYPE_TEXT_COLOR = 4,
    E_SUBTITLE_ATTR_TYPE_EDGE_COLOR = 5,
    E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET = 8,
};

// Values of Subtitle_TimeOffset::mTimeOffsetType. Others are refused.
enum : int32_t {
    ORV_SUBTITLE_TIME_OFFSET_DELAY = 0,    // show later by the value
    ORV_SUBTITLE_TIME_OFFSET_ADVANCE = 1,  // show earlier by the value
};

// Values of Subtitle_FontInfo::mFontSizeType. Others are refused. Small, medium
// (the usual size) and large are 40, 55 and 75 pixels on a picture of 720 rows.
enum : int32_t {
    ORV_SUBTITLE_FONT_SMALL = 0,
    ORV_SUBTITLE_FONT_MEDIUM = 1,
    ORV_SUBTITLE_FONT_LARGE = 2,
    ORV_SUBTITLE_FONT_CUSTOM = 3,  // mCustomSize counts
};

// For E_SUBTITLE_ATTR_TYPE_TIME_OFFSET: a type and milliseconds.
//
// For E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET: X and Y in thousandths of the
// picture's width and height, -1000 to 1000; others are refused.
// Y moves the text down from its usual place, negative up, as far as 500.
// X above 0 lets lines begin that far from the left edge, below 0 end that far
// from the right edge, as far as 312; 0 centres them. X needs plain text: lines
// of formats with a layout of their own (ASS) and pictures move by Y only.
struct Subtitle_TimeOffset {
    int32_t mTimeOffsetType = 0;
    int32_t mOffsetValue = 0;
};

struct Subtitle_FontInfo {
    int32_t mFontSizeType = 0;
    uint8_t mCustomSize = 0;  // pixels on a picture of 720 rows, 1 to 255
};

// For the background, the text and its outline. A background that is not fully
// transparent is drawn as a box behind the text. Alpha 0 is transparent, 255 opaque.
struct Subtitle_Color {
    uint8_t mA = 0;
    uint8_t mR = 0;
    uint8_t mG = 0;
    uint8_t mB = 0;
};
