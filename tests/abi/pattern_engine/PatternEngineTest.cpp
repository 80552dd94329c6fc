// SPDX-License-Identifier: Apache-2.0
// The sample engine's operations, called directly.
#include <gtest/gtest.h>
#include <orvtarn/TarnPlayer.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <set>
#include <thread>
#include <vector>

#include "FrameSink.h"

using android::sp;
using android::TarnPlayer;
using orvtest::FrameSink;

namespace {

constexpr std::chrono::seconds kLimit{20};
constexpr int64_t kFrameUs = 40'000;

class Recorder : public android::MediaPlayerBase::Listener {
public:
    void notify(int msg, int, int, const android::Parcel*) override {
        if (action) action(msg);
        std::lock_guard<std::mutex> lock(mMutex);
        mSeen.insert(msg);
        mThreads.insert(std::this_thread::get_id());
        mChanged.notify_all();
    }
    bool sees(int msg) {
        std::unique_lock<std::mutex> lock(mMutex);
        return mChanged.wait_for(lock, kLimit, [&] { return mSeen.count(msg) != 0; });
    }
    std::set<std::thread::id> threads() {
        std::lock_guard<std::mutex> lock(mMutex);
        return mThreads;
    }

    std::function<void(int)> action;  // set before the first event

private:
    std::mutex mMutex;
    std::condition_variable mChanged;
    std::multiset<int> mSeen;
    std::set<std::thread::id> mThreads;
};

bool becomes(const std::function<bool()>& condition) {
    const auto end = std::chrono::steady_clock::now() + kLimit;
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    return true;
}

class PatternEngineTest : public testing::Test {
protected:
    PatternEngineTest() { player->setNotifyCallback(recorder); }
    ~PatternEngineTest() override { player->release(); }

    void prepare(const char* url = "pattern://60") {
        player->setVideoSurfaceTexture(sink);
        ASSERT_EQ(player->setDataSource(url, nullptr), 0);
        ASSERT_EQ(player->prepare(), 0);
    }
    int position() {
        int msec = -1;
        EXPECT_EQ(player->getCurrentPosition(&msec), 0);
        return msec;
    }

    const sp<Recorder> recorder = new Recorder;
    const sp<FrameSink> sink = new FrameSink;
    const sp<TarnPlayer> player = new TarnPlayer(-1);
};

TEST_F(PatternEngineTest, OperationsAreRefusedBeforeTheirTime) {
    int value = 0;
    EXPECT_EQ(player->start(), android::INVALID_OPERATION);
    EXPECT_EQ(player->prepare(), android::INVALID_OPERATION);
    EXPECT_EQ(player->getCurrentPosition(&value), android::INVALID_OPERATION);
    EXPECT_FALSE(player->getVideoTrackCount(value));
    EXPECT_EQ(player->setDataSource("pattern://60", nullptr), 0);
    EXPECT_EQ(player->setDataSource("pattern://60", nullptr), android::INVALID_OPERATION);
    EXPECT_EQ(player->seekTo(0, 0), android::INVALID_OPERATION);
}

TEST_F(PatternEngineTest, OnlyItsOwnAddressesAreOpened) {
    for (const char* url : {"", "/film.mkv", "http://host/film", "pattern://", "pattern://0",
                            "pattern://-1", "pattern://6x", "pattern://123456"}) {
        EXPECT_EQ(player->setDataSource(url, nullptr), ORV_ERROR_SCHEME) << url;
    }
    EXPECT_NE(player->setDataSource(0, 0, 1), 0);
    EXPECT_EQ(player->setDataSource("pattern://1", nullptr), 0);
}

TEST_F(PatternEngineTest, PrepareShowsTheFirstFrameAndReportsIt) {
    prepare();
    EXPECT_EQ(sink->frameCount(), 1u);
    EXPECT_EQ(sink->newest().timestampUs, 0);
    EXPECT_TRUE(recorder->sees(android::MEDIA_SET_VIDEO_SIZE));
    EXPECT_TRUE(recorder->sees(android::MEDIA_PREPARED));
    EXPECT_EQ(recorder->threads().count(std::this_thread::get_id()), 0u);
}

TEST_F(PatternEngineTest, FramesHaveTheSizeThatTheSurfaceWants) {
    sink->setDefaultSize(321, 123);
    prepare();
    EXPECT_EQ(sink->newest().width, 321);
    EXPECT_EQ(sink->newest().height, 123);
}

TEST_F(PatternEngineTest, PlayingMovesThePictureAndPausingHoldsIt) {
    prepare();
    const orvtest::Picture first = sink->newest();
    ASSERT_EQ(player->start(), 0);
    ASSERT_TRUE(sink->waitFor(3));
    EXPECT_GT(sink->newest().differences(first), 1000);
    ASSERT_EQ(player->pause(), 0);
    EXPECT_FALSE(player->isPlaying());
    const uint64_t frames = sink->frameCount();
    const int stands = position();
    EXPECT_EQ(sink->newest().timestampUs, stands * int64_t{1000});
    const sp<TarnPlayer> other = new TarnPlayer(-1);
    ASSERT_EQ(other->setDataSource("pattern://60", nullptr), 0);
    ASSERT_EQ(other->prepare(), 0);
    ASSERT_EQ(other->start(), 0);
    int moved = 0;
    EXPECT_TRUE(becomes([&] { return other->getCurrentPosition(&moved) == 0 && moved > 200; }));
    EXPECT_EQ(position(), stands);
    EXPECT_EQ(sink->frameCount(), frames);
}

TEST_F(PatternEngineTest, SeeksAndStepsShowTheirFrameBeforeTheyReturn) {
    prepare();
    ASSERT_EQ(player->seekTo(1030, 0), 0);
    EXPECT_EQ(position(), 1000);
    EXPECT_EQ(sink->newest().timestampUs, 25 * kFrameUs);
    EXPECT_TRUE(player->step(2));
    EXPECT_EQ(sink->newest().timestampUs, 27 * kFrameUs);
    EXPECT_FALSE(player->step(-28));
    EXPECT_EQ(position(), 1080);
    ASSERT_EQ(player->seekTo(-5, 0), 0);
    EXPECT_EQ(position(), 0);
    ASSERT_EQ(player->seekTo(1'000'000, 0), 0);
    EXPECT_EQ(position(), 60'000);
    EXPECT_FALSE(player->step(1));
    EXPECT_TRUE(recorder->sees(android::MEDIA_SEEK_COMPLETE));
}

TEST_F(PatternEngineTest, TheEndCompletesAndStartBeginsAnew) {
    prepare("pattern://1");
    ASSERT_EQ(player->seekTo(900, 0), 0);
    ASSERT_EQ(player->start(), 0);
    ASSERT_TRUE(recorder->sees(android::MEDIA_PLAYBACK_COMPLETE));
    EXPECT_EQ(position(), 1000);
    EXPECT_FALSE(player->isPlaying());
    ASSERT_EQ(player->start(), 0);
    EXPECT_TRUE(player->isPlaying());
    EXPECT_LT(position(), 1000);
}

TEST_F(PatternEngineTest, LoopingBeginsAgainWithoutAnEnd) {
    prepare("pattern://1");
    ASSERT_EQ(player->setLooping(1), 0);
    ASSERT_EQ(player->seekTo(900, 0), 0);
    ASSERT_EQ(player->start(), 0);
    EXPECT_TRUE(becomes([&] { return position() < 500; }));
    EXPECT_TRUE(player->isPlaying());
}

TEST_F(PatternEngineTest, ANewSurfaceGetsThePictureAndTheEarlierOneNothingMore) {
    prepare();
    const sp<FrameSink> other = new FrameSink;
    ASSERT_EQ(player->setVideoSurfaceTexture(other), 0);
    EXPECT_EQ(other->frameCount(), 1u);
    const uint64_t before = sink->frameCount();
    ASSERT_EQ(player->start(), 0);
    ASSERT_TRUE(other->waitFor(4));
    EXPECT_EQ(sink->frameCount(), before);
}

// Refuses its buffer and counts how often.
class BusySink : public FrameSink {
public:
    android::status_t dequeueBuffer(int width, int height, PixelBuffer* buffer) override {
        const android::status_t status = FrameSink::dequeueBuffer(width, height, buffer);
        if (status == android::WOULD_BLOCK) refused++;
        return status;
    }
    std::atomic<int> refused{0};
};

TEST_F(PatternEngineTest, ASurfaceWithoutABufferIsAskedUntilItHasOne) {
    const sp<BusySink> busy = new BusySink;
    prepare();
    ASSERT_EQ(player->setVideoSurfaceTexture(busy), 0);
    busy->block(true);
    ASSERT_EQ(player->seekTo(2000, 0), 0);
    EXPECT_TRUE(becomes([&] { return busy->refused > 20; }));
    busy->block(false);
    EXPECT_TRUE(
        busy->waitFor(1, [](const auto& picture) { return picture.timestampUs == 50 * kFrameUs; }));
}

TEST_F(PatternEngineTest, ASurfaceWithoutAConsumerIsGivenUp) {
    prepare();
    sink->abandon();
    ASSERT_EQ(player->seekTo(2000, 0), 0);
    EXPECT_TRUE(becomes([&] { return sink->getStrongCount() == 1; }));
}

TEST_F(PatternEngineTest, NothingIsDrawnForAPlayerInTheBackground) {
    prepare();
    const uint64_t before = sink->frameCount();
    ASSERT_EQ(player->setPlayerRole(E_ORV_PLAYER_ROLE_BACKGROUND), 0);
    ASSERT_EQ(player->seekTo(2000, 0), 0);
    EXPECT_EQ(sink->frameCount(), before);
    ASSERT_EQ(player->setPlayerRole(E_ORV_PLAYER_ROLE_MAIN), 0);
    EXPECT_EQ(sink->newest().timestampUs, 50 * kFrameUs);
}

TEST_F(PatternEngineTest, ResetLeadsBackToOtherMedia) {
    prepare();
    ASSERT_EQ(player->start(), 0);
    ASSERT_EQ(player->reset(), 0);
    int duration = 0;
    EXPECT_EQ(player->getDuration(&duration), android::INVALID_OPERATION);
    prepare("pattern://2");
    EXPECT_EQ(player->getDuration(&duration), 0);
    EXPECT_EQ(duration, 2000);
}

TEST_F(PatternEngineTest, AReleasedPlayerRefusesAndLetsTheSurfaceGo) {
    prepare();
    ASSERT_EQ(player->start(), 0);
    EXPECT_EQ(player->release(), 0);
    EXPECT_EQ(player->release(), 0);
    EXPECT_EQ(sink->getStrongCount(), 1);
    EXPECT_EQ(player->reset(), android::INVALID_OPERATION);
    EXPECT_EQ(player->start(), android::INVALID_OPERATION);
    EXPECT_EQ(player->setDataSource("pattern://1", nullptr), android::INVALID_OPERATION);
}

TEST_F(PatternEngineTest, AListenerMayReleaseThePlayer) {
    recorder->action = [this](int) { player->release(); };
    prepare();
    EXPECT_TRUE(recorder->sees(android::MEDIA_SET_VIDEO_SIZE));
    EXPECT_EQ(player->start(), android::INVALID_OPERATION);
}

TEST_F(PatternEngineTest, AReleaseWaitsForTheListener) {
    std::atomic<bool> inside{false};
    std::atomic<bool> released{false};
    std::atomic<bool> early{false};
    recorder->action = [&](int) {
        inside = true;
        int duration = 0;
        becomes([&] { return player->getDuration(&duration) != 0; });
        // Only a release that does not wait ends this before its last round.
        for (int i = 0; i < 50 && !early; i++) {
            early = released.load();
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
    };
    prepare();
    ASSERT_TRUE(becomes([&] { return inside.load(); }));
    EXPECT_EQ(player->release(), 0);
    released = true;
    EXPECT_TRUE(recorder->sees(android::MEDIA_SET_VIDEO_SIZE));
    EXPECT_FALSE(early);
}

TEST_F(PatternEngineTest, AnyThreadMayCallAnythingUntilTheReleaseAndAfter) {
    prepare();
    std::atomic<bool> released{false};
    std::atomic<int> calls{0};
    std::vector<std::thread> threads;
    const auto repeat = [&](const std::function<void()>& operation) {
        threads.emplace_back([&, operation] {
            for (int after = 0; after < 10; after += released ? 1 : 0) operation(), calls++;
        });
    };
    repeat([&] { player->start(), player->pause(); });
    repeat([&] { player->seekTo(calls % 60'000, 0), player->step(1); });
    repeat([&] { player->setVideoSurfaceTexture(calls % 2 == 0 ? sink : nullptr); });
    repeat(
        [&] { player->reset(), player->setDataSource("pattern://1", nullptr), player->prepare(); });
    EXPECT_TRUE(becomes([&] { return calls > 400; }));
    EXPECT_EQ(player->release(), 0);
    const uint64_t frames = sink->frameCount();
    released = true;
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(sink->frameCount(), frames);
}

}  // namespace
