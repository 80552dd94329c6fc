// SPDX-License-Identifier: Apache-2.0
// What the listener receives, and where.
#include <atomic>
#include <set>
#include <thread>

#include "KitTest.h"

using android::MEDIA_ERROR;
using android::MEDIA_PLAYBACK_COMPLETE;
using android::MEDIA_PREPARED;
using android::MEDIA_SEEK_COMPLETE;
using android::MEDIA_SET_VIDEO_SIZE;
using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kRestMs = 300;

class EventsTest : public KitTest {
protected:
    // The place of the first event of a kind; that of the end when there is none.
    size_t placeOf(int msg) const {
        size_t place = 0;
        for (const orvtest::Event& event : events->events()) {
            if (event.msg == msg) break;
            place++;
        }
        return place;
    }
};

TEST_F(EventsTest, MediaThatAreReadyAreReportedOnce) {
    checks("the player", "Media that are ready are one MEDIA_PREPARED");
    ORV_OPEN();
    EXPECT_TRUE(events->waitFor(MEDIA_PREPARED));
    playBeyond(kNearMs);
    EXPECT_EQ(1, events->count(MEDIA_PREPARED));
    EXPECT_EQ(0, events->count(MEDIA_ERROR));
}

TEST_F(EventsTest, TheSizeComesBefore) {
    checks("the player", "The picture's size is MEDIA_SET_VIDEO_SIZE, before the media are ready");
    ORV_OPEN();
    ASSERT_TRUE(events->waitFor(MEDIA_PREPARED));
    const size_t place = placeOf(MEDIA_SET_VIDEO_SIZE);
    ASSERT_LT(place, placeOf(MEDIA_PREPARED));
    int width = 0;
    int height = 0;
    player->getVideoWidth(&width);
    player->getVideoHeight(&height);
    EXPECT_EQ(width, events->events()[place].ext1);
    EXPECT_EQ(height, events->events()[place].ext2);
}

TEST_F(EventsTest, ASeekThatWasDoneIsReported) {
    checks("the player", "each seek that was done is one MEDIA_SEEK_COMPLETE");
    ORV_OPEN();
    ORV_NOT_OFFERED_IF(!player->canDoSeek(0), "it does not seek");
    ASSERT_EQ(NO_ERROR, player->seekTo(kMiddleMs, 0));
    ASSERT_EQ(NO_ERROR, player->seekTo(0, 0));
    EXPECT_TRUE(events->waitFor(MEDIA_SEEK_COMPLETE, 2));
    playBeyond(kNearMs);
    EXPECT_EQ(2, events->count(MEDIA_SEEK_COMPLETE));
}

TEST_F(EventsTest, TheEndIsReportedOnce) {
    checks("the player", "the end is one MEDIA_PLAYBACK_COMPLETE");
    ORV_OPEN();
    player->seekTo(duration() - kRestMs, 0);
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
    EXPECT_FALSE(player->isPlaying());
    EXPECT_TRUE(remains([&] { return events->count(MEDIA_PLAYBACK_COMPLETE) == 1; }));
}

TEST_F(EventsTest, WhatEndsTheMediaIsReported) {
    checks("the player", "what ends the media otherwise one MEDIA_ERROR");
    setSource(mediaPath("garbage.bin"));
    if (IsSkipped() || HasFailure()) return;
    EXPECT_NE(NO_ERROR, player->prepare());
    EXPECT_TRUE(events->waitFor(MEDIA_ERROR));
    EXPECT_TRUE(remains([&] { return events->count(MEDIA_ERROR) == 1; }));
    EXPECT_EQ(0, events->count(MEDIA_PREPARED));
}

TEST_F(EventsTest, TheyComeOnAThreadOfTheEngines) {
    checks("the player", "None calls the listener on the caller's thread");
    std::atomic<bool> onCallers{false};
    const std::thread::id caller = std::this_thread::get_id();
    events->setReaction([&, caller](const orvtest::Event&) {
        if (std::this_thread::get_id() == caller) onCallers = true;
    });
    ORV_OPEN();
    EXPECT_TRUE(events->waitFor(MEDIA_PREPARED));
    if (player->seekTo(kMiddleMs, 0) == NO_ERROR) {
        EXPECT_TRUE(events->waitFor(MEDIA_SEEK_COMPLETE));
    }
    EXPECT_FALSE(onCallers);
    events->setReaction(nullptr);
}

TEST_F(EventsTest, TheListenerMayCallThePlayer) {
    checks("the player", "Events go to the listener on a thread of the engine's own");
    std::atomic<int> started{1};
    events->setReaction([&](const orvtest::Event& event) {
        if (event.msg == MEDIA_PREPARED) started = player->start();
    });
    setSource();
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->prepareAsync());
    EXPECT_TRUE(eventually([&] { return started <= 0; }));
    EXPECT_EQ(NO_ERROR, started);
    EXPECT_TRUE(eventually([&] { return isReady() && position() > kNearMs; }));
    events->setReaction(nullptr);
    player->release();
}

TEST_F(EventsTest, TheListenerMayReleaseThePlayer) {
    checks("release", "May be called again, and by the listener");
    std::atomic<int> released{1};
    events->setReaction([&](const orvtest::Event& event) {
        if (event.msg == MEDIA_PREPARED) released = player->release();
    });
    setSource();
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->prepareAsync());
    EXPECT_TRUE(eventually([&] { return released <= 0; }));
    EXPECT_EQ(NO_ERROR, released);
    EXPECT_EQ(android::INVALID_OPERATION, player->start());
    player->release();
}

TEST_F(EventsTest, NoneComesAfterARelease) {
    checks("release", "For good");
    ORV_OPEN();
    playBeyond(0);
    ASSERT_EQ(NO_ERROR, player->release());
    const size_t before = events->events().size();
    EXPECT_TRUE(remains([&] { return events->events().size() == before; }));
}

}  // namespace
}  // namespace orvkit
