// SPDX-License-Identifier: Apache-2.0
// Several threads that release one player, or reset it meanwhile: when a call has
// returned, what the player got is free.
#include <chrono>
#include <future>

#include "FakeStream.h"
#include "OtherThread.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

// A source that is slow to close.
class SlowStream : public FakeStream {
public:
    using FakeStream::FakeStream;

    void closeStream() override {
        mClosing.set_value();
        mGo.get_future().wait();
    }

    std::promise<void> mClosing;
    std::promise<void> mGo;
};

class ReleaseTest : public PlayerTest {
protected:
    ReleaseTest() { EXPECT_EQ(NO_ERROR, player->setDataSource(stream.forEngine())); }
    // Before the stream that its source leads to.
    ~ReleaseTest() override { player->release(); }

    // Releases on another thread, up to the source's close.
    void beginRelease() {
        released = std::async(std::launch::async, [this] { return player->release(); });
        ASSERT_EQ(std::future_status::ready, closing.wait_for(std::chrono::seconds(10)));
    }

    void expectWaits(const std::function<status_t()>& operation, status_t answer) {
        status_t answered = 99;
        OtherThread later([&] { answered = operation(); });
        EXPECT_TRUE(later.isAsleep());
        stream.mGo.set_value();
        later.join();
        EXPECT_EQ(answer, answered);
        EXPECT_EQ(NO_ERROR, released.get());
    }

    SlowStream stream{mediaPath("short.mp4")};
    std::future<void> closing = stream.mClosing.get_future();
    std::future<status_t> released;
};

TEST_F(ReleaseTest, ASecondOneWaitsForTheFirst) {
    ASSERT_NO_FATAL_FAILURE(beginRelease());
    expectWaits([this] { return player->release(); }, NO_ERROR);
}

TEST_F(ReleaseTest, AResetWaitsForItAndIsRefused) {
    ASSERT_NO_FATAL_FAILURE(beginRelease());
    expectWaits([this] { return player->reset(); }, INVALID_OPERATION);
}

// It waits for the listener, too.
TEST_F(ReleaseTest, TheListenersOwnDoesNotWait) {
    std::promise<void> goOn;
    std::promise<status_t> listeners;
    events->setReaction([&](const Event& event) {
        if (event.msg != MEDIA_PREPARED) return;
        goOn.get_future().wait();
        listeners.set_value(player->release());
    });
    ASSERT_EQ(NO_ERROR, player->prepare());
    ASSERT_NO_FATAL_FAILURE(beginRelease());
    goOn.set_value();
    std::future<status_t> answer = listeners.get_future();
    ASSERT_EQ(std::future_status::ready, answer.wait_for(std::chrono::seconds(10)));
    EXPECT_EQ(NO_ERROR, answer.get());
    stream.mGo.set_value();
    EXPECT_EQ(NO_ERROR, released.get());
}

}  // namespace
