// SPDX-License-Identifier: Apache-2.0
#include "records/SubtitleStyle.h"

#include <stdio.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace orvtarn {
namespace {

// Sizes of mpv's sub-font-size, which counts pixels on a picture of 720 rows,
// beside the medium one, which is mpv's own.
const double kSmallFont = 40.0 / 55;
const double kLargeFont = 75.0 / 55;

// mpv lays plain-text subtitles out on a canvas 960 units wide and takes
// margins of up to 300.
const double kCanvasWidth = 960;
const int64_t kMaxMargin = 300;

const int64_t kUsualPosition = 100;  // percent of the picture's height
const int64_t kMaxPosition = 150;

// All that an attribute may change. mpv 0.35 has no border style.
const char kBorderStyle[] = "sub-border-style";
const char* const kLook[] = {
    "sub-delay",         "sub-ass-override", "sub-font-size", "sub-back-color", "sub-color",
    "sub-outline-color", "sub-align-x",      "sub-margin-x",  "sub-pos",        kBorderStyle,
};

double numberOf(const MpvAssignment& assignment) {
    if (const double* number = std::get_if<double>(&assignment.value)) return *number;
    const int64_t* integer = std::get_if<int64_t>(&assignment.value);
    return integer != nullptr ? static_cast<double>(*integer) : 0;
}

bool isTimeOffset(const Subtitle_TimeOffset& offset) {
    return offset.mTimeOffsetType == ORV_SUBTITLE_TIME_OFFSET_DELAY ||
           offset.mTimeOffsetType == ORV_SUBTITLE_TIME_OFFSET_ADVANCE;
}

bool isDisplayOffset(const Subtitle_TimeOffset& offset) {
    const auto inPicture = [](int32_t value) { return value >= -1000 && value <= 1000; };
    return inPicture(offset.mTimeOffsetType) && inPicture(offset.mOffsetValue);
}

double delaySeconds(const Subtitle_TimeOffset& offset) {
    const double seconds = offset.mOffsetValue / 1000.0;
    return offset.mTimeOffsetType == ORV_SUBTITLE_TIME_OFFSET_ADVANCE ? -seconds : seconds;
}

std::string colorText(const Subtitle_Color& color) {
    char text[10];
    snprintf(text, sizeof(text), "#%02X%02X%02X%02X", color.mA, color.mR, color.mG, color.mB);
    return text;
}

int64_t marginOf(int x) {
    return std::min<int64_t>(std::llround(std::abs(x) * kCanvasWidth / 1000), kMaxMargin);
}

void addVertical(int y, std::vector<MpvAssignment>& style) {
    const int64_t position = kUsualPosition + std::lround(y / 10.0);
    style.push_back({"sub-pos", std::clamp<int64_t>(position, 0, kMaxPosition)});
}

// Copies the record into its place, if it is one that the check takes.
template <typename Record, typename Check>
bool put(const void* record, std::optional<Record>& place, Check check) {
    const Record& value = *static_cast<const Record*>(record);
    if (!check(value)) return false;
    place = value;
    return true;
}

}  // namespace

// The number of mpv for a font, or 0 for one that is refused.
int64_t SubtitleStyle::fontSize(const Subtitle_FontInfo& font) const {
    switch (font.mFontSizeType) {
        case ORV_SUBTITLE_FONT_SMALL:
            return std::llround(mMediumFont * kSmallFont);
        case ORV_SUBTITLE_FONT_MEDIUM:
            return std::llround(mMediumFont);
        case ORV_SUBTITLE_FONT_LARGE:
            return std::llround(mMediumFont * kLargeFont);
        case ORV_SUBTITLE_FONT_CUSTOM:
            return font.mCustomSize;
        default:
            return 0;
    }
}

// A ground is a box behind the line. Without a border style a colour that can be
// seen makes the box by itself; with one it would colour the shadow.
void SubtitleStyle::addGround(const Subtitle_Color& color,
                              std::vector<MpvAssignment>& style) const {
    style.push_back({"sub-back-color", colorText(color)});
    if (!mHasBorderStyle) return;
    style.push_back(
        {kBorderStyle, std::string(color.mA > 0 ? "background-box" : "outline-and-shadow")});
}

void SubtitleStyle::addHorizontal(int x, std::vector<MpvAssignment>& style) const {
    style.push_back({"sub-align-x", std::string(x > 0 ? "left" : x < 0 ? "right" : "center")});
    style.push_back({"sub-margin-x", x == 0 ? mUsualMargin : marginOf(x)});
}

bool SubtitleStyle::stage(int type, const void* record) {
    const auto anyColor = [](const Subtitle_Color&) { return true; };
    const auto knownFont = [this](const Subtitle_FontInfo& font) { return fontSize(font) != 0; };
    if (record == nullptr) return false;
    switch (type) {
        case E_SUBTITLE_ATTR_TYPE_TIME_OFFSET:
            return put(record, mTimeOffset, isTimeOffset);
        case E_SUBTITLE_ATTR_TYPE_FONT_INFO:
            return put(record, mFontInfo, knownFont);
        case E_SUBTITLE_ATTR_TYPE_BG_COLOR:
            return put(record, mBackColor, anyColor);
        case E_SUBTITLE_ATTR_TYPE_TEXT_COLOR:
            return put(record, mTextColor, anyColor);
        case E_SUBTITLE_ATTR_TYPE_EDGE_COLOR:
            return put(record, mEdgeColor, anyColor);
        case E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET:
            return put(record, mDisplayOffset, isDisplayOffset);
        default:
            return false;
    }
}

std::vector<MpvAssignment> SubtitleStyle::flush() {
    std::vector<MpvAssignment> style;
    if (mTimeOffset) style.push_back({"sub-delay", delaySeconds(*mTimeOffset)});
    // Formats with a style of their own keep it otherwise.
    if (mFontInfo || mBackColor || mTextColor || mEdgeColor) {
        style.push_back({"sub-ass-override", std::string("force")});
    }
    if (mFontInfo) style.push_back({"sub-font-size", fontSize(*mFontInfo)});
    if (mBackColor) addGround(*mBackColor, style);
    if (mTextColor) style.push_back({"sub-color", colorText(*mTextColor)});
    if (mEdgeColor) style.push_back({"sub-outline-color", colorText(*mEdgeColor)});
    if (mDisplayOffset) {
        addHorizontal(mDisplayOffset->mTimeOffsetType, style);
        addVertical(mDisplayOffset->mOffsetValue, style);
    }
    clear();
    return style;
}

void SubtitleStyle::clear() {
    mTimeOffset.reset();
    mFontInfo.reset();
    mBackColor.reset();
    mTextColor.reset();
    mEdgeColor.reset();
    mDisplayOffset.reset();
}

void SubtitleStyle::readUsual(mpv_handle* mpv) {
    mUsual.clear();
    mHasBorderStyle = false;
    for (const char* property : kLook) {
        const std::optional<MpvAssignment> now = currentValue(mpv, property);
        if (!now) continue;
        mUsual.push_back(*now);
        if (now->property == "sub-font-size") mMediumFont = numberOf(*now);
        if (now->property == "sub-margin-x") mUsualMargin = std::llround(numberOf(*now));
        if (now->property == kBorderStyle) mHasBorderStyle = true;
    }
}

}  // namespace orvtarn
