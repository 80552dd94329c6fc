// SPDX-License-Identifier: Apache-2.0
// Subtitle files beside the media, and how subtitles look.
#include "KitTest.h"

using android::NO_ERROR;

namespace orvkit {
namespace {

class SubtitlesTest : public KitTest {
protected:
    // A film without subtitles of its own.
    void openPlain() { openFile("silent.mp4"); }

    int tracks() const {
        int count = -1;
        return player->getSubtitleTrackCount(count) ? count : -1;
    }
    int shown() const {
        int index = -2;
        EXPECT_NE(0, player->getCurrentSubtitleIndex(&index));
        return index;
    }
};

TEST_F(SubtitlesTest, AFileComesAsATrackThatIsOff) {
    checks("addTimedTextSource", "The first leaves its tracks off");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->addTimedTextSource(mediaPath("lines.srt").c_str()),
                       "it takes no subtitle files");
    EXPECT_EQ(1, tracks());
    EXPECT_EQ(-1, shown());
}

TEST_F(SubtitlesTest, WhatIsNoSubtitleFileIsRefused) {
    checks("addTimedTextSource", "false for what is no such file");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_FALSE(player->addTimedTextSource(mediaPath("nowhere.srt").c_str()));
    EXPECT_FALSE(player->addTimedTextSource(mediaPath("garbage.bin").c_str()));
    EXPECT_LE(tracks(), 0);
}

TEST_F(SubtitlesTest, FilesStayUntilReset) {
    checks("addTimedTextSource", "Files stay until reset");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->addTimedTextSource(mediaPath("lines.srt").c_str()),
                       "it takes no subtitle files");
    ASSERT_EQ(NO_ERROR, player->stop());
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(1, tracks());
    ASSERT_EQ(NO_ERROR, player->reset());
    openPlain();
    EXPECT_EQ(0, tracks());
}

TEST_F(SubtitlesTest, TheOtherTurnsItsFirstTrackOn) {
    checks("setSubtitleDataSource", "the others turn their first one on");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->setSubtitleDataSource(mediaPath("lines.srt").c_str()),
                       "it takes no subtitle files");
    EXPECT_EQ(1, tracks());
    EXPECT_EQ(0, shown());
}

TEST_F(SubtitlesTest, APairIsATrack) {
    checks("setSubtitleDataSourceEx", "A VobSub pair");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->setSubtitleDataSourceEx(mediaPath("words.sub").c_str(),
                                                        mediaPath("words.idx").c_str()),
                       "it takes no VobSub pairs");
    EXPECT_EQ(1, tracks());
    EXPECT_EQ(0, shown());
}

TEST_F(SubtitlesTest, HalfAPairIsRefused) {
    checks("setSubtitleDataSourceEx", "false for what is no such file");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_FALSE(player->setSubtitleDataSourceEx(nullptr, nullptr));
    EXPECT_FALSE(player->setSubtitleDataSourceEx(mediaPath("words.sub").c_str(), nullptr));
}

TEST_F(SubtitlesTest, ALookIsStaged) {
    checks("setSubtitleAttr", "Stages one record of the type's kind until flushSubtitleAttr");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    Subtitle_Color yellow;
    yellow.mA = yellow.mR = yellow.mG = 255;
    ORV_NOT_OFFERED_IF(!player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_TEXT_COLOR, &yellow),
                       "subtitles have one look");
    Subtitle_FontInfo large;
    large.mFontSizeType = ORV_SUBTITLE_FONT_LARGE;
    EXPECT_TRUE(player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &large));
}

TEST_F(SubtitlesTest, OtherLooksAreRefused) {
    checks("setSubtitleAttr", "False for types and values that orvtarn/SubtitleRecords.h");
    Subtitle_FontInfo odd;
    odd.mFontSizeType = 99;
    EXPECT_FALSE(player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &odd));
    EXPECT_FALSE(player->setSubtitleAttr(99, &odd));
}

TEST_F(SubtitlesTest, WhatIsStagedIsFlushed) {
    checks("flushSubtitleAttr", "Stages one record of the type's kind until flushSubtitleAttr");
    openPlain();
    if (IsSkipped() || HasFailure()) return;
    Subtitle_TimeOffset later;
    later.mTimeOffsetType = ORV_SUBTITLE_TIME_OFFSET_DELAY;
    later.mOffsetValue = 500;
    ORV_NOT_OFFERED_IF(!player->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &later),
                       "subtitles have one look");
    EXPECT_TRUE(player->flushSubtitleAttr());
}

}  // namespace
}  // namespace orvkit
