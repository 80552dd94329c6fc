// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "RealPlayer.h"
#include "records/SubtitleStyle.h"

namespace orvtarn {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

// "property=value", which reads well in a failure.
std::vector<std::string> texts(const std::vector<MpvAssignment>& style) {
    struct Text {
        std::string operator()(double number) { return std::to_string(number); }
        std::string operator()(int64_t number) { return std::to_string(number); }
        std::string operator()(const std::string& text) { return text; }
    };
    std::vector<std::string> lines;
    lines.reserve(style.size());
    for (const MpvAssignment& one : style) {
        lines.push_back(one.property + "=" + std::visit(Text(), one.value));
    }
    return lines;
}

Subtitle_TimeOffset pair(int32_t first, int32_t second) {
    Subtitle_TimeOffset record;
    record.mTimeOffsetType = first;
    record.mOffsetValue = second;
    return record;
}

std::vector<std::string> styleOf(int type, const void* record) {
    SubtitleStyle style;
    EXPECT_TRUE(style.stage(type, record));
    return texts(style.flush());
}

std::vector<std::string> timeOffset(int32_t type, int32_t milliseconds) {
    const Subtitle_TimeOffset record = pair(type, milliseconds);
    return styleOf(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &record);
}

std::vector<std::string> displayOffset(int32_t x, int32_t y) {
    const Subtitle_TimeOffset record = pair(x, y);
    return styleOf(E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET, &record);
}

std::vector<std::string> font(int32_t type, uint8_t size) {
    Subtitle_FontInfo record;
    record.mFontSizeType = type;
    record.mCustomSize = size;
    return styleOf(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &record);
}

std::vector<std::string> color(int type) {
    const Subtitle_Color record = {0x80, 0x01, 0xFE, 0x0C};
    return styleOf(type, &record);
}

TEST(SubtitleStyle, DelaysAndAdvances) {
    EXPECT_THAT(timeOffset(ORV_SUBTITLE_TIME_OFFSET_DELAY, 1500),
                ElementsAre("sub-delay=1.500000"));
    EXPECT_THAT(timeOffset(ORV_SUBTITLE_TIME_OFFSET_ADVANCE, 1500),
                ElementsAre("sub-delay=-1.500000"));
    EXPECT_THAT(timeOffset(ORV_SUBTITLE_TIME_OFFSET_ADVANCE, INT32_MIN),
                ElementsAre("sub-delay=2147483.648000"));
}

TEST(SubtitleStyle, SetsTheFontSize) {
    EXPECT_THAT(font(ORV_SUBTITLE_FONT_SMALL, 9),
                ElementsAre("sub-ass-override=force", "sub-font-size=40"));
    EXPECT_THAT(font(ORV_SUBTITLE_FONT_MEDIUM, 9),
                ElementsAre("sub-ass-override=force", "sub-font-size=55"));
    EXPECT_THAT(font(ORV_SUBTITLE_FONT_LARGE, 9),
                ElementsAre("sub-ass-override=force", "sub-font-size=75"));
    EXPECT_THAT(font(ORV_SUBTITLE_FONT_CUSTOM, 255),
                ElementsAre("sub-ass-override=force", "sub-font-size=255"));
}

TEST(SubtitleStyle, SetsEachColor) {
    EXPECT_THAT(color(E_SUBTITLE_ATTR_TYPE_BG_COLOR),
                ElementsAre("sub-ass-override=force", "sub-back-color=#8001FE0C"));
    EXPECT_THAT(color(E_SUBTITLE_ATTR_TYPE_TEXT_COLOR),
                ElementsAre("sub-ass-override=force", "sub-color=#8001FE0C"));
    EXPECT_THAT(color(E_SUBTITLE_ATTR_TYPE_EDGE_COLOR),
                ElementsAre("sub-ass-override=force", "sub-outline-color=#8001FE0C"));
}

TEST(SubtitleStyle, MovesTheText) {
    EXPECT_THAT(displayOffset(0, 0),
                ElementsAre("sub-align-x=center", "sub-margin-x=25", "sub-pos=100"));
    EXPECT_THAT(displayOffset(100, -250),
                ElementsAre("sub-align-x=left", "sub-margin-x=96", "sub-pos=75"));
    EXPECT_THAT(displayOffset(-100, 104),
                ElementsAre("sub-align-x=right", "sub-margin-x=96", "sub-pos=110"));
}

TEST(SubtitleStyle, MovesNoFurtherThanThePlayerCan) {
    EXPECT_THAT(displayOffset(1000, 1000),
                ElementsAre("sub-align-x=left", "sub-margin-x=300", "sub-pos=150"));
    EXPECT_THAT(displayOffset(-1000, -1000),
                ElementsAre("sub-align-x=right", "sub-margin-x=300", "sub-pos=0"));
}

TEST(SubtitleStyle, GivesStagedRecordsOutOnceAndTogether) {
    SubtitleStyle style;
    const Subtitle_TimeOffset late = pair(ORV_SUBTITLE_TIME_OFFSET_DELAY, 1000);
    const Subtitle_TimeOffset later = pair(ORV_SUBTITLE_TIME_OFFSET_DELAY, 2000);
    const Subtitle_Color color = {255, 1, 2, 3};
    EXPECT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_TEXT_COLOR, &color));
    EXPECT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_EDGE_COLOR, &color));
    EXPECT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &late));
    EXPECT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &later));
    EXPECT_THAT(texts(style.flush()),
                ElementsAre("sub-delay=2.000000", "sub-ass-override=force", "sub-color=#FF010203",
                            "sub-outline-color=#FF010203"));
    EXPECT_THAT(style.flush(), IsEmpty());
}

TEST(SubtitleStyle, RefusesWhatItDoesNotKnowAndKeepsWhatWasStaged) {
    SubtitleStyle style;
    const Subtitle_TimeOffset good = pair(ORV_SUBTITLE_TIME_OFFSET_DELAY, 1000);
    ASSERT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &good));
    for (int type : {-1, 1, 6, 7, 9, INT32_MAX, INT32_MIN}) {
        EXPECT_FALSE(style.stage(type, &good)) << type;
    }
    for (int type : {0, 2, 3, 4, 5, 8}) EXPECT_FALSE(style.stage(type, nullptr)) << type;
    for (int unit : {-1, 2}) {
        const Subtitle_TimeOffset bad = pair(unit, 5);
        EXPECT_FALSE(style.stage(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &bad)) << unit;
    }
    EXPECT_THAT(texts(style.flush()), ElementsAre("sub-delay=1.000000"));
}

TEST(SubtitleStyle, RefusesFontsAndOffsetsOutOfRange) {
    SubtitleStyle style;
    for (int32_t type : {-1, 4}) {
        Subtitle_FontInfo font;
        font.mFontSizeType = type;
        font.mCustomSize = 20;
        EXPECT_FALSE(style.stage(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &font)) << type;
    }
    Subtitle_FontInfo nothing;
    nothing.mFontSizeType = ORV_SUBTITLE_FONT_CUSTOM;
    EXPECT_FALSE(style.stage(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &nothing));
    for (const Subtitle_TimeOffset& far :
         {pair(1001, 0), pair(-1001, 0), pair(0, 1001), pair(0, -1001), pair(INT32_MIN, 0)}) {
        EXPECT_FALSE(style.stage(E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET, &far));
    }
    EXPECT_THAT(style.flush(), IsEmpty());
}

TEST(SubtitleStyle, ForgetsStagedRecords) {
    SubtitleStyle style;
    const Subtitle_Color color;
    EXPECT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_TEXT_COLOR, &color));
    style.clear();
    EXPECT_THAT(style.flush(), IsEmpty());
}

// Every property at its extremes, so that no name, type or range is a guess.
TEST(SubtitleStyle, IsTakenByThePlayer) {
    orvtest::RealPlayer player;
    for (int sign : {-1, 1}) {
        SubtitleStyle style;
        const Subtitle_TimeOffset time = pair(ORV_SUBTITLE_TIME_OFFSET_DELAY, sign * INT32_MAX);
        const Subtitle_TimeOffset place = pair(sign * 1000, sign * 1000);
        const Subtitle_Color color = {0x80, 1, 2, 3};
        Subtitle_FontInfo font;
        font.mFontSizeType = ORV_SUBTITLE_FONT_CUSTOM;
        font.mCustomSize = sign < 0 ? 1 : 255;
        ASSERT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &time));
        ASSERT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET, &place));
        ASSERT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &font));
        for (int type : {3, 4, 5}) ASSERT_TRUE(style.stage(type, &color));
        for (const MpvAssignment& one : style.flush()) {
            EXPECT_EQ(assign(player.handle(), one), 0) << one.property;
        }
        EXPECT_EQ(player.text("sub-color"), "#80010203");
        EXPECT_EQ(std::stod(player.text("sub-pos")), sign < 0 ? 0 : 150);
    }
}

TEST(SubtitleStyle, GoesBackToThePlayersOwnLook) {
    orvtest::RealPlayer fresh;
    orvtest::RealPlayer restyled;
    SubtitleStyle style;
    style.readUsual(fresh.handle());
    ASSERT_GE(style.usual().size(), 9u);
    for (const char* property : {"sub-font-size", "sub-margin-x", "sub-pos"}) {
        EXPECT_EQ(assign(restyled.handle(), {property, int64_t{77}}), 0) << property;
    }
    EXPECT_EQ(assign(restyled.handle(), {"sub-outline-color", std::string("#80010203")}), 0);
    for (const MpvAssignment& one : style.usual()) {
        EXPECT_EQ(assign(restyled.handle(), one), 0) << one.property;
        const std::optional<MpvAssignment> now =
            currentValue(restyled.handle(), one.property.c_str());
        ASSERT_TRUE(now.has_value()) << one.property;
        EXPECT_EQ(texts({*now}), texts({one}));
    }
}

TEST(SubtitleStyle, MeasuresFontsByThePlayersOwn) {
    orvtest::RealPlayer player;
    ASSERT_EQ(assign(player.handle(), {"sub-font-size", int64_t{110}}), 0);
    SubtitleStyle style;
    style.readUsual(player.handle());
    const auto sizeOf = [&](int32_t type) {
        Subtitle_FontInfo record;
        record.mFontSizeType = type;
        EXPECT_TRUE(style.stage(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &record));
        return texts(style.flush()).back();
    };
    EXPECT_EQ(sizeOf(ORV_SUBTITLE_FONT_SMALL), "sub-font-size=80");
    EXPECT_EQ(sizeOf(ORV_SUBTITLE_FONT_MEDIUM), "sub-font-size=110");
    EXPECT_EQ(sizeOf(ORV_SUBTITLE_FONT_LARGE), "sub-font-size=150");
}

}  // namespace
}  // namespace orvtarn
