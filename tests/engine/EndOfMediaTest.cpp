// SPDX-License-Identifier: Apache-2.0
// The end of media, however it is reached, and what follows it.
#include <media/MediaTrack.h>

#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

using Mode = MediaTrack::ReadOptions;

class EndOfMediaTest : public PlayerTest {
protected:
    void expectCompleted(int times = 1) {
        ASSERT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE, times));
        EXPECT_FALSE(player->isPlaying());
        EXPECT_EQ(duration(), position());
    }
};

TEST_F(EndOfMediaTest, AStepPastTheLastFrameIsRefused) {
    open("silent.mp4");
    ASSERT_EQ(NO_ERROR, player->seekTo(1900, Mode::SEEK_CLOSEST));
    EXPECT_FALSE(player->step(1000));
    EXPECT_NEAR(1967, position(), 1) << "the last frame";
    EXPECT_FALSE(player->step(1));
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
    EXPECT_TRUE(player->step(-1));
}

TEST_F(EndOfMediaTest, StartOnTheLastFrameCompletes) {
    open("silent.mp4");
    ASSERT_EQ(NO_ERROR, player->seekTo(1900, Mode::SEEK_CLOSEST));
    ASSERT_FALSE(player->step(1000));
    ASSERT_EQ(NO_ERROR, player->start());
    expectCompleted();
}

TEST_F(EndOfMediaTest, StartAfterASeekBeyondTheEndCompletes) {
    for (const char* name : {"silent.mp4", "short.mp4", "tone.mp3"}) {
        SCOPED_TRACE(name);
        const int before = events->count(MEDIA_PLAYBACK_COMPLETE);
        player->reset();
        open(name);
        ASSERT_EQ(NO_ERROR, player->seekTo(1000000, Mode::SEEK_CLOSEST));
        ASSERT_EQ(NO_ERROR, player->start());
        expectCompleted(before + 1);
    }
}

TEST_F(EndOfMediaTest, StartOnTheLastFrameOfALoopGoesRound) {
    open("silent.mp4");
    ASSERT_EQ(NO_ERROR, player->setLooping(1));
    ASSERT_EQ(NO_ERROR, player->seekTo(1900, Mode::SEEK_CLOSEST));
    ASSERT_FALSE(player->step(1000));
    ASSERT_NEAR(1967, position(), 1);
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return position() < 1000; }));
    EXPECT_TRUE(player->isPlaying());
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(EndOfMediaTest, WhilePlayingASeekBeyondTheEndCompletes) {
    for (int mode : {Mode::SEEK_NEXT_SYNC, Mode::SEEK_CLOSEST}) {
        SCOPED_TRACE(mode);
        player->reset();
        open("short.mp4");
        ASSERT_EQ(NO_ERROR, player->start());
        const int before = events->count(MEDIA_PLAYBACK_COMPLETE);
        ASSERT_EQ(NO_ERROR, player->seekTo(1000000, mode));
        expectCompleted(before + 1);
    }
}

// The way to the nearer key frame leads over the end.
TEST_F(EndOfMediaTest, ASeekThatOnlyTouchesTheEndDoesNotComplete) {
    open("distant.mkv");
    ASSERT_EQ(NO_ERROR, player->start());
    for (int i = 0; i < 5; i++) {
        ASSERT_EQ(NO_ERROR, player->seekTo(17000 + i, Mode::SEEK_CLOSEST_SYNC));
        // It plays on from there: what the seek met of the end is reported before.
        EXPECT_TRUE(eventually([&] { return position() > 15200 && position() < 17000; }));
        EXPECT_TRUE(player->isPlaying());
    }
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
}

}  // namespace
