// SPDX-License-Identifier: Apache-2.0
// Operations from many threads at a time, and players that end in the middle of something.
#include <atomic>
#include <functional>
#include <thread>
#include <vector>

#include "KitTest.h"

using android::INVALID_OPERATION;
using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kRounds = 30;

class ThreadsTest : public KitTest {
protected:
    ~ThreadsTest() override { join(); }

    void repeat(const std::function<void(int)>& operation) {
        mThreads.emplace_back([operation] {
            for (int round = 0; round < kRounds; round++) operation(round);
        });
    }
    void join() {
        for (std::thread& thread : mThreads) thread.join();
        mThreads.clear();
    }
    void begin() {
        setSource();
        if (IsSkipped() || HasFailure()) return;
        ASSERT_EQ(NO_ERROR, player->prepare());
    }
    // What a program asks while another of its threads plays.
    void ask() {
        int value = 0;
        player->getCurrentPosition(&value);
        player->getDuration(&value);
        player->isPlaying();
        player->getBufferPercent();
        player->canDoSeek(0);
    }

private:
    std::vector<std::thread> mThreads;
};

TEST_F(ThreadsTest, AnyThreadMayCallAnyOperation) {
    checks("the player", "Any thread may call any operation at any time");
    begin();
    if (IsSkipped() || HasFailure()) return;
    repeat([&](int) { ask(); });
    repeat([&](int) { player->start(), player->pause(); });
    repeat([&](int round) { player->seekTo(round * 100, 0); });
    repeat([&](int round) { player->setVolume(static_cast<float>(round) / kRounds, 1); });
    join();
    ASSERT_EQ(NO_ERROR, player->reset());
    begin();
    playBeyond(kNearMs);
}

TEST_F(ThreadsTest, AResetMayComeInBetween) {
    checks("reset", "leads back to idle from everywhere but released");
    begin();
    if (IsSkipped() || HasFailure()) return;
    repeat([&](int) { ask(); });
    repeat([&](int) { player->start(); });
    repeat([&](int) { player->seekTo(kMiddleMs, 0); });
    for (int round = 0; round < 3; round++) {
        EXPECT_EQ(NO_ERROR, player->reset());
        EXPECT_EQ(NO_ERROR, player->setDataSource(film().c_str(), nullptr));
        const android::status_t status = player->prepare();
        EXPECT_TRUE(status == NO_ERROR || status == INVALID_OPERATION) << status;
    }
    join();
    EXPECT_EQ(NO_ERROR, player->reset());
    begin();
    EXPECT_EQ(0, position());
}

TEST_F(ThreadsTest, AReleaseMayComeInBetween) {
    checks("release", "A second call returns when the first is done");
    begin();
    if (IsSkipped() || HasFailure()) return;
    repeat([&](int) { ask(); });
    repeat([&](int) { player->start(), player->pause(); });
    repeat([&](int round) { player->seekTo(round * 100, 0); });
    repeat([&](int) { player->release(); });
    join();
    EXPECT_EQ(INVALID_OPERATION, player->start());
}

TEST_F(ThreadsTest, ReleaseEndsEveryState) {
    checks("release", "For good");
    const std::function<void(android::TarnPlayer&)> ways[] = {
        [](android::TarnPlayer&) {},
        [](android::TarnPlayer& other) { other.setDataSource(film().c_str(), nullptr); },
        [](android::TarnPlayer& other) { other.prepareAsync(); },
        [](android::TarnPlayer& other) { other.prepare(); },
        [](android::TarnPlayer& other) { other.start(); },
        [](android::TarnPlayer& other) { other.pause(); },
        [](android::TarnPlayer& other) { other.stop(); },
    };
    // Each is released in the state that the ways up to that one lead to.
    for (size_t last = 0; last < std::size(ways); last++) {
        const android::sp<android::TarnPlayer> other = new android::TarnPlayer(-1);
        for (size_t way = 0; way <= last; way++) ways[way](*other);
        EXPECT_EQ(NO_ERROR, other->release()) << last;
        EXPECT_EQ(INVALID_OPERATION, other->start()) << last;
    }
}

TEST_F(ThreadsTest, PlayersDoNotKnowOfEachOther) {
    checks("TarnPlayer(decoder)", "the number of the hardware decoder to use, -1 for any");
    begin();
    if (IsSkipped() || HasFailure()) return;
    const android::sp<android::TarnPlayer> other = new android::TarnPlayer(0);
    ASSERT_EQ(NO_ERROR, other->setDataSource(film().c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, other->prepare());
    playBeyond(kNearMs);
    int msec = -1;
    EXPECT_EQ(NO_ERROR, other->getCurrentPosition(&msec));
    EXPECT_EQ(0, msec);
    EXPECT_EQ(NO_ERROR, other->release());
    const int place = position();
    EXPECT_TRUE(eventually([&] { return position() > place; }));
}

}  // namespace
}  // namespace orvkit
