// SPDX-License-Identifier: Apache-2.0
// Opening and playing media from start to end.
#include <orvtarn/PlayerTypes.h>

#include <algorithm>
#include <chrono>

#include "CoreCalls.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class PlaybackTest : public PlayerTest {};

TEST_F(PlaybackTest, PrepareKnowsTheMediaAndShowsItsFirstFrame) {
    open("feature.mkv");
    EXPECT_EQ(0, position());
    EXPECT_NEAR(10000, duration(), 100);
    int width = 0;
    int height = 0;
    EXPECT_EQ(NO_ERROR, player->getVideoWidth(&width));
    EXPECT_EQ(NO_ERROR, player->getVideoHeight(&height));
    EXPECT_EQ(1280, width);
    EXPECT_EQ(720, height);
    EXPECT_FALSE(player->isPlaying());
    ASSERT_GE(sink->frameCount(), 1u);
    EXPECT_EQ(1280, sink->newest().width);
    EXPECT_EQ(720, sink->newest().height);
    EXPECT_GT(sink->newest().brightness(), 20);
}

TEST_F(PlaybackTest, PlaysToTheEndInRealTime) {
    open("short.mp4");
    const auto begin = std::chrono::steady_clock::now();
    playToEnd();
    // However busy the machine is, it is not over before its time.
    const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - begin;
    EXPECT_GE(taken.count(), duration() / 1000.0 - 0.5);
    EXPECT_EQ(duration(), position());
    EXPECT_FALSE(player->isPlaying());
    const auto isLast = [&](const Picture& p) { return p.timestampUs / 1000 > duration() - 70; };
    EXPECT_TRUE(sink->waitFor(0, isLast)) << "one of the last frames";
    const std::vector<int64_t> times = sink->timestamps();
    const auto late = std::is_sorted_until(times.begin(), times.end());
    EXPECT_EQ(times.end(), late) << (late == times.end() ? 0 : *late) << " us is too early";
    EXPECT_EQ(0, times.front());
}

TEST_F(PlaybackTest, TellsTheListenerInOrder) {
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("silent.mp4").c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, player->prepareAsync());
    ASSERT_TRUE(events->waitFor(MEDIA_PREPARED));
    playToEnd();
    std::vector<Event> order;
    for (const Event& event : events->events()) {
        if (event.msg != MEDIA_BUFFERING_UPDATE && event.msg != MEDIA_INFO) order.push_back(event);
    }
    const std::vector<Event> expected = {
        {MEDIA_SET_VIDEO_SIZE, 320, 180}, {MEDIA_PREPARED, 0, 0}, {MEDIA_PLAYBACK_COMPLETE, 0, 0}};
    EXPECT_EQ(expected, order);
    const std::vector<Event> all = events->events();
    const Event renderingStart = {MEDIA_INFO, MEDIA_INFO_RENDERING_START, 0};
    EXPECT_EQ(1, std::count(all.begin(), all.end(), renderingStart));
}

TEST_F(PlaybackTest, PauseHoldsThePosition) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(player->isPlaying());
    ASSERT_TRUE(eventually([&] { return position() > 300; }));
    ASSERT_EQ(NO_ERROR, player->pause());
    EXPECT_FALSE(player->isPlaying());
    EXPECT_TRUE(newestPause());
    const int held = position();
    // A frame that was on its way may still change the position a little.
    EXPECT_TRUE(remains([&] { return position() < held + 100; }));
}

TEST_F(PlaybackTest, StartAfterTheEndPlaysAgain) {
    open("silent.mp4");
    playToEnd();
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(player->isPlaying());
    EXPECT_LT(position(), duration());
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE, 2));
}

TEST_F(PlaybackTest, AudioAlonePlaysWithoutASurface) {
    player->setVideoSurfaceTexture(nullptr);
    open("tone.mp3");
    EXPECT_NEAR(3000, duration(), 100);
    int width = -1;
    EXPECT_EQ(NO_ERROR, player->getVideoWidth(&width));
    EXPECT_EQ(0, width);
    playToEnd();
    EXPECT_EQ(duration(), position());
    EXPECT_EQ(0u, sink->frameCount());
}

TEST_F(PlaybackTest, VideoThatShowsNothingLeavesTheSound) {
    open("unseen.mkv");
    EXPECT_NEAR(2000, duration(), 100);
    playToEnd();
    EXPECT_EQ(duration(), position());
    EXPECT_EQ(0u, sink->frameCount());
}

TEST_F(PlaybackTest, NothingToSeeOrHearIsAnError) {
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("dead.mkv").c_str(), nullptr));
    EXPECT_EQ(ORV_ERROR_NOTHING_INSIDE - E_ORV_FORMAT_MATROSKA, player->prepare());
}

TEST_F(PlaybackTest, LoopingStartsAgainWithoutAnEnd) {
    open("silent.mp4");
    ASSERT_EQ(NO_ERROR, player->setLooping(1));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > 1500; }));
    ASSERT_TRUE(eventually([&] { return position() < 1000; }));
    EXPECT_TRUE(player->isPlaying());
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
    EXPECT_EQ(0, events->count(MEDIA_SEEK_COMPLETE));
    ASSERT_EQ(NO_ERROR, player->setLooping(0));
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
}

}  // namespace
