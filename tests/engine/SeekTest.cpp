// SPDX-License-Identifier: Apache-2.0
// Moving the position, by times and by bytes.
#include <media/MediaTrack.h>

#include <future>
#include <thread>

#include "CoreCalls.h"
#include "FakeStream.h"
#include "MediaPackets.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

using Mode = MediaTrack::ReadOptions;

// feature.mkv has a key frame every two seconds, long.mkv every second.
class SeekTest : public PlayerTest {
protected:
    int positionAfter(int msec, int mode) {
        EXPECT_EQ(NO_ERROR, player->seekTo(msec, mode));
        return position();
    }
};

TEST_F(SeekTest, PreviousSyncGoesToTheKeyFrameBefore) {
    open("feature.mkv");
    EXPECT_EQ(4000, positionAfter(5500, Mode::SEEK_PREVIOUS_SYNC));
    EXPECT_EQ(6000, positionAfter(6000, Mode::SEEK_PREVIOUS_SYNC)) << "an exact hit stays";
    EXPECT_EQ(0, positionAfter(1990, Mode::SEEK_PREVIOUS_SYNC));
    EXPECT_TRUE(events->waitFor(MEDIA_SEEK_COMPLETE, 3));
}

TEST_F(SeekTest, NextSyncGoesToTheKeyFrameBehind) {
    open("feature.mkv");
    EXPECT_EQ(6000, positionAfter(4500, Mode::SEEK_NEXT_SYNC));
    EXPECT_EQ(4000, positionAfter(4000, Mode::SEEK_NEXT_SYNC));
    EXPECT_EQ(2000, positionAfter(500, Mode::SEEK_NEXT_SYNC));
}

TEST_F(SeekTest, ClosestSyncGoesToTheNearerOne) {
    open("feature.mkv");
    EXPECT_EQ(4000, positionAfter(4900, Mode::SEEK_CLOSEST_SYNC));
    EXPECT_EQ(6000, positionAfter(5100, Mode::SEEK_CLOSEST_SYNC));
}

TEST_F(SeekTest, ClosestGoesToTheFrameItself) {
    open("feature.mkv");
    EXPECT_NEAR(5500, positionAfter(5500, Mode::SEEK_CLOSEST), 34);
}

// Without an index a guess leads to the key frame after the time, and past the
// last one there is none.
TEST_F(SeekTest, FindsKeyFramesAndFramesInFormatsWithoutAnIndex) {
    struct Expected {
        int msec, previous, closest;
    };
    // The sound begins 11 ms before the picture.
    const Expected stream[] = {
        {7300, 6011, 7311}, {8600, 8011, 8611}, {1400, 11, 1411}, {2500, 2011, 2511}};
    open("stream.ts");
    for (const Expected& one : stream) {
        EXPECT_NEAR(one.previous, positionAfter(one.msec, Mode::SEEK_PREVIOUS_SYNC), 1) << one.msec;
        EXPECT_NEAR(one.closest, positionAfter(one.msec, Mode::SEEK_CLOSEST), 1) << one.msec;
    }
    for (const char* name : {"distant.ts", "distant.mpg"}) {
        player->reset();
        open(name);
        EXPECT_NEAR(11, positionAfter(7300, Mode::SEEK_PREVIOUS_SYNC), 1) << name;
        EXPECT_NEAR(20031, positionAfter(23500, Mode::SEEK_PREVIOUS_SYNC), 21) << name;
        EXPECT_NEAR(19921, positionAfter(19900, Mode::SEEK_CLOSEST), 11) << name;
    }
}

TEST_F(SeekTest, ShowsTheFrameOfTheNewPosition) {
    open("feature.mkv");
    const Picture first = sink->newest();
    const uint64_t before = sink->frameCount();
    ASSERT_EQ(NO_ERROR, player->seekTo(6000, 0));
    ASSERT_TRUE(sink->waitFor(before, [](const Picture& p) { return p.timestampUs == 6000000; }));
    EXPECT_GT(sink->newest().differences(first), 10000);
}

TEST_F(SeekTest, TimesOutsideAreTheStartAndTheEnd) {
    open("short.mp4");
    EXPECT_EQ(0, positionAfter(-5000, 0));
    EXPECT_LE(positionAfter(1000000, 0), duration());
    EXPECT_GE(position(), 1900);
}

TEST_F(SeekTest, WhilePlayingGoesOnFromThere) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->seekTo(8000, 0));
    EXPECT_GE(position(), 8000);
    EXPECT_TRUE(player->isPlaying());
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(SeekTest, FromTheEndGoesBackWithoutPlaying) {
    open("silent.mp4");
    playToEnd();
    EXPECT_EQ(1000, positionAfter(1000, 0));
    EXPECT_FALSE(player->isPlaying());
    EXPECT_TRUE(newestPause());
    EXPECT_EQ(1000, position());
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_GE(position(), 1000) << "not from the beginning";
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE, 2));
}

TEST_F(SeekTest, ManyAtOnceAllArrive) {
    open("long.mkv");
    std::vector<std::thread> threads;
    threads.reserve(4);
    for (int i = 0; i < 4; i++) {
        threads.emplace_back([&, i] {
            for (int n = 0; n < 5; n++) {
                EXPECT_EQ(NO_ERROR, player->seekTo((i * 5 + n) * 2500, 0));
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_TRUE(events->waitFor(MEDIA_SEEK_COMPLETE, 20));
    EXPECT_EQ(7000, positionAfter(7300, 0));
}

// The second waits for the first, and has as long as that in all.
TEST_F(SeekTest, WithoutDataTimesOut) {
    FakeStream stream(mediaPath("long.mkv"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(stream.forEngine()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    stream.blockAt(0);
    const auto seek = [&] { return player->seekTo(50000, Mode::SEEK_CLOSEST_SYNC); };
    std::future<status_t> first = std::async(std::launch::async, seek);
    ASSERT_TRUE(stream.waitUntilBlocked());
    std::future<status_t> second = std::async(std::launch::async, seek);
    EXPECT_EQ(std::future_status::ready, second.wait_for(std::chrono::seconds(14)));
    EXPECT_EQ(TIMED_OUT, first.get());
    EXPECT_EQ(TIMED_OUT, second.get());
    player->release();
}

TEST_F(SeekTest, RefusesModesThatAreNone) {
    open("short.mp4");
    EXPECT_EQ(BAD_VALUE, player->seekTo(1000, 4));
    EXPECT_EQ(BAD_VALUE, player->seekTo(1000, -1));
    EXPECT_EQ(0, position());
}

class ByteSeekTest : public SeekTest, public testing::WithParamInterface<const char*> {};

TEST_P(ByteSeekTest, GoesToTheFrameAtTheByteAndSaysSo) {
    const std::vector<MediaPacket> packets = packetsOf(GetParam());
    ASSERT_GT(packets.size(), 49u);
    open(GetParam());
    for (size_t i : {5u, 31u, 40u, 49u, 12u}) {
        ASSERT_TRUE(player->seekToPosition(packets[i].position + 1)) << i;
        EXPECT_NEAR(1000 * packets[i].time, position(), 2) << i;
        int bytes = 0;
        EXPECT_EQ(NO_ERROR, player->getCurrentBytePosition(&bytes));
        EXPECT_EQ(packets[i].position, bytes) << i;
    }
}

INSTANTIATE_TEST_SUITE_P(Containers, ByteSeekTest,
                         testing::Values("short.mp4", "short.ts", "silent.mkv", "feature.mkv"),
                         [](const auto& info) {
                             std::string name = info.param;
                             name[name.find('.')] = '_';
                             return name;
                         });

TEST_F(SeekTest, BytesOutsideOfTheMediaAreRefused) {
    open("short.mp4");
    EXPECT_FALSE(player->seekToPosition(1ull << 40));
    EXPECT_FALSE(player->seekToPosition(static_cast<unsigned long long>(-16LL)));
    EXPECT_EQ(0, position());
}

}  // namespace
