// SPDX-License-Identifier: Apache-2.0
// Tables of tracks, and which of them plays.
#include <orvtarn/MediaDescription.h>

#include "KitTest.h"

using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kTracks = 2;  // of sound, and as many of subtitles, in tracks.mp4
constexpr int kVideoWidth = 320;
constexpr int kVideoHeight = 180;

class TracksTest : public KitTest {
protected:
    static constexpr const char* kFile = "tracks.mp4";

    int audioTrack() const {
        int index = -2;
        EXPECT_NE(0, player->getCurrentAudioIndex(&index));
        return index;
    }
    int subtitleTrack() const {
        int index = -2;
        EXPECT_NE(0, player->getCurrentSubtitleIndex(&index));
        return index;
    }

    // An engine without subtitles counts none.
    void openWithSubtitles() {
        ORV_OPEN(mediaPath(kFile));
        int count = 0;
        ORV_NOT_OFFERED_IF(!player->getSubtitleTrackCount(count) || count == 0,
                           "it has no subtitle tracks");
        ASSERT_EQ(kTracks, count);
    }
    void openWithSound() {
        ORV_OPEN(mediaPath(kFile));
        int count = 0;
        ORV_NOT_OFFERED_IF(!player->getAudioTrackCount(count) || count == 0,
                           "it has no audio tracks");
        ASSERT_EQ(kTracks, count);
    }
};

TEST_F(TracksTest, VideoTracksAreCountedOncePrepared) {
    checks("getVideoTrackCount", "Tracks are known once the media are prepared");
    int count = -1;
    EXPECT_FALSE(player->getVideoTrackCount(count));
    ORV_OPEN();
    ASSERT_TRUE(player->getVideoTrackCount(count));
    EXPECT_EQ(1, count);
}

TEST_F(TracksTest, TheTrackThatIsShownIsDescribed) {
    checks("getVideoCodecInfo(info)", "Of the video track that is shown");
    ORV_OPEN();
    VideoCodecInfo info;
    ORV_NOT_OFFERED_IF(!player->getVideoCodecInfo(info), "it describes no video tracks");
    EXPECT_NE(0, info.mCodec);
    EXPECT_GT(info.mWidth, 0);
    EXPECT_GT(info.mHeight, 0);
    EXPECT_TRUE(info.mFlags & ORV_TRACK_FLAG_SELECTED);
}

TEST_F(TracksTest, VideoTracksHaveIndicesOfTheirOwn) {
    checks("getVideoCodecInfo(index, info)", "indices are positions in the table of their kind");
    ORV_OPEN();
    VideoCodecInfo shown;
    ORV_NOT_OFFERED_IF(!player->getVideoCodecInfo(shown), "it describes no video tracks");
    VideoCodecInfo info;
    ASSERT_TRUE(player->getVideoCodecInfo(0, info));
    EXPECT_EQ(shown.mCodec, info.mCodec);
    EXPECT_FALSE(player->getVideoCodecInfo(1, info));
    EXPECT_FALSE(player->getVideoCodecInfo(-1, info));
}

TEST_F(TracksTest, ThePictureHasTheSizeThatItIsSeenAt) {
    checks("getVideoWidth", "Pixels as the picture is meant to be seen");
    openFile("rotated.mp4");
    if (IsSkipped() || HasFailure()) return;
    int width = 0;
    ASSERT_EQ(NO_ERROR, player->getVideoWidth(&width));
    EXPECT_EQ(kVideoHeight, width) << "it lies in the file";
}

TEST_F(TracksTest, SoundHasNoPicture) {
    checks("getVideoWidth", "0 without a picture");
    openFile("tagged.mp3");
    if (IsSkipped() || HasFailure()) return;
    int width = -1;
    EXPECT_EQ(NO_ERROR, player->getVideoWidth(&width));
    EXPECT_EQ(0, width);
}

TEST_F(TracksTest, ThePictureHasItsHeight) {
    checks("getVideoHeight", "Pixels as the picture is meant to be seen");
    openFile(kFile);
    if (IsSkipped() || HasFailure()) return;
    int width = 0;
    int height = 0;
    ASSERT_EQ(NO_ERROR, player->getVideoWidth(&width));
    ASSERT_EQ(NO_ERROR, player->getVideoHeight(&height));
    EXPECT_EQ(kVideoWidth, width);
    EXPECT_EQ(kVideoHeight, height);
}

TEST_F(TracksTest, AudioTracksAreCounted) {
    checks("getAudioTrackCount", "Tracks are known once the media are prepared");
    int count = -1;
    EXPECT_FALSE(player->getAudioTrackCount(count));
    openWithSound();
}

TEST_F(TracksTest, AudioTracksAreDescribed) {
    checks("getAudioTrackInfo", "also fill the descriptive texts");
    openWithSound();
    if (IsSkipped() || HasFailure()) return;
    for (int index = 0; index < kTracks; index++) {
        AudioTrackInfo info;
        ORV_NOT_OFFERED_IF(!player->getAudioTrackInfo(false, index, info),
                           "it describes no audio tracks");
        EXPECT_NE(0, info.mCodec) << index;
        EXPECT_GT(info.mChannels, 0) << index;
        EXPECT_GT(info.mSampleRate, 0) << index;
        ASSERT_TRUE(player->getAudioTrackInfo(true, index, info)) << index;
        EXPECT_NE(0, info.mCodecName[0]) << index;
    }
    AudioTrackInfo info;
    EXPECT_FALSE(player->getAudioTrackInfo(true, kTracks, info));
}

TEST_F(TracksTest, AudioTracksCanBeChosen) {
    checks("selectAudioTrack", "indices are positions in the table of their kind");
    openWithSound();
    if (IsSkipped() || HasFailure()) return;
    for (const int index : {1, 0}) {
        ORV_NOT_OFFERED_IF(!player->selectAudioTrack(index), "it chooses no audio tracks");
        EXPECT_TRUE(eventually([&] { return audioTrack() == index; })) << index;
    }
    EXPECT_FALSE(player->selectAudioTrack(kTracks));
    EXPECT_EQ(0, audioTrack());
}

TEST_F(TracksTest, TheAudioIndexIsAnsweredByNotZero) {
    checks("getCurrentAudioIndex", "Non-zero when the index is known");
    ORV_OPEN();
    int index = -2;
    EXPECT_NE(0, player->getCurrentAudioIndex(&index));
    EXPECT_GE(index, -1);
}

TEST_F(TracksTest, SubtitleTracksAreCounted) {
    checks("getSubtitleTrackCount", "Tracks are known once the media are prepared");
    openWithSubtitles();
}

TEST_F(TracksTest, SubtitleTracksAreDescribed) {
    checks("getSubtitleTrackInfo", "Subtitle tracks have the indices from 0");
    openWithSubtitles();
    if (IsSkipped() || HasFailure()) return;
    const char* const languages[kTracks] = {"eng", "jpn"};
    for (int index = 0; index < kTracks; index++) {
        SubtitleTrackInfo info;
        ORV_NOT_OFFERED_IF(!player->getSubtitleTrackInfo(index, info),
                           "it describes no subtitle tracks");
        EXPECT_NE(0, info.mCodec) << index;
        EXPECT_STREQ(languages[index], info.mLanguage);
    }
    SubtitleTrackInfo info;
    EXPECT_FALSE(player->getSubtitleTrackInfo(kTracks, info));
}

TEST_F(TracksTest, ChaptersAreTimedTextsToo) {
    checks("getSubtitleTrackInfo", "address the media's chapter marks");
    openFile(kFile);
    if (IsSkipped() || HasFailure()) return;
    SubtitleTrackInfo chapter;
    ORV_NOT_OFFERED_IF(!player->getSubtitleTrackInfo(ORV_CHAPTER_INDEX_BASE + 1, chapter),
                       "it describes no chapters");
    EXPECT_EQ(ORV_CHAPTER_CODEC, chapter.mCodec);
    constexpr int kBeginMs = 2500;
    constexpr int kEndMs = 6000;
    EXPECT_EQ(kBeginMs, chapter.mTrackId);
    EXPECT_EQ(kEndMs, chapter.mFlags);
    EXPECT_FALSE(player->getSubtitleTrackInfo(ORV_CHAPTER_INDEX_BASE + 3, chapter));
}

TEST_F(TracksTest, TheDescriptionEnds) {
    checks("getSubtitleTrackInfo", "An engine without it answers false at once");
    openFile(kFile);
    if (IsSkipped() || HasFailure()) return;
    constexpr int kMostPieces = 10000;
    std::string text;
    SubtitleTrackInfo piece;
    int index = 0;
    while (index < kMostPieces &&
           player->getSubtitleTrackInfo(ORV_DESCRIPTION_INDEX_BASE + index, piece)) {
        EXPECT_EQ(ORV_DESCRIPTION_CODEC, piece.mCodec);
        text += piece.mText;
        index++;
    }
    ORV_NOT_OFFERED_IF(index == 0, "it has no description");
    EXPECT_LT(index, kMostPieces) << "it does not end";
    EXPECT_EQ(0u, text.find("[media]\n")) << text;
    EXPECT_NE(std::string::npos, text.find("[stream]\n")) << text;
}

TEST_F(TracksTest, NoSubtitleIsOnAtFirst) {
    checks("getCurrentSubtitleIndex", "-1 for none");
    ORV_OPEN();
    EXPECT_EQ(-1, subtitleTrack());
}

TEST_F(TracksTest, ASubtitleIsTurnedOn) {
    checks("onSubtitleTrack", "No subtitle is on before one of these turns it on");
    openWithSubtitles();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(-1, subtitleTrack());
    ORV_NOT_OFFERED_IF(!player->onSubtitleTrack(1), "it turns no subtitles on");
    EXPECT_TRUE(eventually([&] { return subtitleTrack() == 1; }));
    EXPECT_FALSE(player->onSubtitleTrack(kTracks));
}

TEST_F(TracksTest, ASubtitleIsTurnedOff) {
    checks("offSubtitleTrack", "No subtitle is on before one of these turns it on");
    openWithSubtitles();
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->onSubtitleTrack(0), "it turns no subtitles on");
    ASSERT_TRUE(player->offSubtitleTrack());
    EXPECT_TRUE(eventually([&] { return subtitleTrack() == -1; }));
}

TEST_F(TracksTest, NumbersGoOverAllKinds) {
    checks("selectTrack", "Track numbers over all kinds: video, then audio, then subtitle tracks");
    openWithSubtitles();
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->selectTrack(1 + 1), "it selects no tracks by number");
    EXPECT_TRUE(eventually([&] { return audioTrack() == 1; }));
    ASSERT_TRUE(player->selectTrack(1 + kTracks));
    EXPECT_TRUE(eventually([&] { return subtitleTrack() == 0; }));
    EXPECT_FALSE(player->selectTrack(1 + 2 * kTracks));
    EXPECT_FALSE(player->selectTrack(-1));
}

TEST_F(TracksTest, WhatIsNotSelectedIsNotDeselected) {
    checks("deselectTrack", "False for tracks that are not selected");
    openWithSubtitles();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_FALSE(player->deselectTrack(1 + kTracks));
    ORV_NOT_OFFERED_IF(!player->selectTrack(1 + kTracks), "it selects no tracks by number");
    ORV_NOT_OFFERED_IF(!player->deselectTrack(1 + kTracks), "it deselects no tracks");
    EXPECT_TRUE(eventually([&] { return subtitleTrack() == -1; }));
}

}  // namespace
}  // namespace orvkit
