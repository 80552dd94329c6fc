// SPDX-License-Identifier: Apache-2.0
// Track tables of the player and the choice among them.
#include <string>

#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class TracksTest : public PlayerTest {
protected:
    int audioIndex() const {
        int index = -7;
        EXPECT_NE(0, player->getCurrentAudioIndex(&index));
        return index;
    }
    int subtitleIndex() const {
        int index = -7;
        EXPECT_NE(0, player->getCurrentSubtitleIndex(&index));
        return index;
    }
};

constexpr int32_t fourCC(char a, char b, char c, char d) { return a | b << 8 | c << 16 | d << 24; }

TEST_F(TracksTest, CountsTheTracks) {
    open("feature.mkv");
    int video = -1;
    int audio = -1;
    int subtitles = -1;
    EXPECT_TRUE(player->getVideoTrackCount(video));
    EXPECT_TRUE(player->getAudioTrackCount(audio));
    EXPECT_TRUE(player->getSubtitleTrackCount(subtitles));
    EXPECT_EQ(1, video);
    EXPECT_EQ(2, audio);
    EXPECT_EQ(2, subtitles);
}

TEST_F(TracksTest, DescribesTheTracks) {
    open("feature.mkv");
    VideoCodecInfo video;
    ASSERT_TRUE(player->getVideoCodecInfo(video));
    EXPECT_EQ(fourCC('h', '2', '6', '4'), video.mCodec);
    EXPECT_EQ(1280, video.mWidth);
    EXPECT_EQ(720, video.mHeight);
    EXPECT_EQ(30000, video.mFrameRate);
    AudioTrackInfo audio;
    ASSERT_TRUE(player->getAudioTrackInfo(true, 1, audio));
    EXPECT_EQ(1, audio.mChannels);
    EXPECT_EQ(44100, audio.mSampleRate);
    EXPECT_STREQ("fra", audio.mLanguage);
    EXPECT_EQ(u'C', audio.mTitle[0]);
    SubtitleTrackInfo subtitle;
    ASSERT_TRUE(player->getSubtitleTrackInfo(1, subtitle));
    EXPECT_STREQ("deu", subtitle.mLanguage);
    EXPECT_STREQ("deu;Untertitel", subtitle.mText);
}

TEST_F(TracksTest, ListsChaptersUntilTheLast) {
    open("feature.mkv");
    SubtitleTrackInfo chapter;
    ASSERT_TRUE(player->getSubtitleTrackInfo(ORV_CHAPTER_INDEX_BASE + 1, chapter));
    EXPECT_EQ(ORV_CHAPTER_CODEC, chapter.mCodec);
    EXPECT_EQ(2500, chapter.mTrackId);
    EXPECT_EQ(6000, chapter.mFlags);
    EXPECT_TRUE(player->getSubtitleTrackInfo(ORV_CHAPTER_INDEX_BASE + 2, chapter));
    EXPECT_FALSE(player->getSubtitleTrackInfo(ORV_CHAPTER_INDEX_BASE + 3, chapter));
}

TEST_F(TracksTest, IndicesOutsideAreRefused) {
    open("feature.mkv");
    VideoCodecInfo video;
    AudioTrackInfo audio;
    SubtitleTrackInfo subtitle;
    for (int index : {-1, 2, INT32_MAX, INT32_MIN}) {
        EXPECT_FALSE(player->getVideoCodecInfo(index, video)) << index;
        EXPECT_FALSE(player->getAudioTrackInfo(true, index, audio)) << index;
        EXPECT_FALSE(player->getSubtitleTrackInfo(index, subtitle)) << index;
        EXPECT_FALSE(player->selectAudioTrack(index)) << index;
        EXPECT_FALSE(player->onSubtitleTrack(index)) << index;
    }
    EXPECT_FALSE(player->selectTrack(5));
    EXPECT_FALSE(player->selectTrack(-1));
    EXPECT_FALSE(player->deselectTrack(5));
    EXPECT_EQ(0, audioIndex()) << "nothing has changed";
    EXPECT_EQ(-1, subtitleIndex());
}

TEST_F(TracksTest, ChoosesAudioAndSubtitles) {
    open("feature.mkv");
    EXPECT_TRUE(player->selectAudioTrack(1));
    EXPECT_EQ(1, audioIndex());
    EXPECT_TRUE(player->onSubtitleTrack(1));
    EXPECT_EQ(1, subtitleIndex());
    EXPECT_TRUE(player->offSubtitleTrack());
    EXPECT_EQ(-1, subtitleIndex());
    EXPECT_EQ(0, position());
}

TEST_F(TracksTest, NumbersRunOverAllKinds) {
    open("feature.mkv");
    EXPECT_TRUE(player->selectTrack(2));
    EXPECT_EQ(1, audioIndex());
    EXPECT_TRUE(player->selectTrack(3));
    EXPECT_EQ(0, subtitleIndex());
    EXPECT_FALSE(player->deselectTrack(4)) << "not the one that is on";
    EXPECT_TRUE(player->deselectTrack(3));
    EXPECT_EQ(-1, subtitleIndex());
    EXPECT_TRUE(player->deselectTrack(2));
    EXPECT_EQ(-1, audioIndex());
    EXPECT_FALSE(player->deselectTrack(0)) << "nothing would be left to play";
    EXPECT_TRUE(player->selectTrack(1));
    EXPECT_EQ(0, audioIndex());
}

// What was described before has changed by then.
TEST_F(TracksTest, DescriptionsFollowChoicesFilesAndMedia) {
    open("feature.mkv");
    const auto isSelected = [this](int index) {
        AudioTrackInfo audio;
        EXPECT_TRUE(player->getAudioTrackInfo(false, index, audio));
        return (audio.mFlags & ORV_TRACK_FLAG_SELECTED) != 0;
    };
    EXPECT_TRUE(isSelected(0));
    ASSERT_TRUE(player->selectAudioTrack(1));
    EXPECT_FALSE(isSelected(0));
    EXPECT_TRUE(isSelected(1));
    ASSERT_TRUE(player->deselectTrack(2));
    EXPECT_FALSE(isSelected(1));
    SubtitleTrackInfo subtitle;
    EXPECT_FALSE(player->getSubtitleTrackInfo(2, subtitle));
    ASSERT_TRUE(player->addTimedTextSource(mediaPath("words.idx").c_str()));
    EXPECT_TRUE(player->getSubtitleTrackInfo(2, subtitle));
    ASSERT_EQ(NO_ERROR, player->reset());
    open("video.mp4");
    AudioTrackInfo audio;
    EXPECT_FALSE(player->getAudioTrackInfo(false, 1, audio));
    ASSERT_TRUE(player->getAudioTrackInfo(false, 0, audio));
    EXPECT_STRNE("fra", audio.mLanguage);
}

TEST_F(TracksTest, BeforeTheMediaNothingIsKnown) {
    int count = 5;
    int index = 5;
    EXPECT_FALSE(player->getAudioTrackCount(count));
    EXPECT_EQ(0, player->getCurrentAudioIndex(&index));
    EXPECT_EQ(0, player->getCurrentSubtitleIndex(&index));
    EXPECT_FALSE(player->selectAudioTrack(0));
}

TEST_F(TracksTest, AnEmbeddedPictureIsNoVideoTrack) {
    open("covered.mp3");
    int count = -1;
    EXPECT_TRUE(player->getVideoTrackCount(count));
    EXPECT_EQ(0, count);
    VideoCodecInfo video;
    EXPECT_FALSE(player->getVideoCodecInfo(video));
}

}  // namespace
