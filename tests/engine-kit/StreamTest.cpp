// SPDX-License-Identifier: Apache-2.0
// Sources that the engine pulls from: whose they are, and how they end.
#include <future>
#include <thread>

#include "FakeStream.h"
#include "KitTest.h"

using android::INVALID_OPERATION;
using android::NO_ERROR;
using orvtest::FakeStream;

namespace orvkit {
namespace {

constexpr int kStreamMs = 3000;

class StreamTest : public KitTest {
protected:
    // The engine may call the source until then.
    ~StreamTest() override { player->release(); }

    void setStream(FakeStream& source) {
        const android::status_t status = player->setDataSource(source.forEngine());
        ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it takes no stream sources");
        ASSERT_EQ(NO_ERROR, status);
    }
    void openStream(FakeStream& source) {
        setStream(source);
        if (IsSkipped() || HasFailure()) return;
        ASSERT_EQ(NO_ERROR, player->prepare());
    }
    static void expectLetGo(const FakeStream& source) {
        EXPECT_EQ(1, source.mDeletes) << "deletions";
        EXPECT_GE(source.mCloses, 1);
        EXPECT_EQ(std::this_thread::get_id(), source.mDeletedOn.load());
    }
    // Begins to prepare on a thread of its own, up to a read that blocks.
    std::future<android::status_t> prepareUntilBlocked() {
        stream.blockAt(0);
        setStream(stream);
        if (IsSkipped() || HasFailure()) return {};
        auto prepared = std::async(std::launch::async, [this] { return player->prepare(); });
        EXPECT_TRUE(stream.waitUntilBlocked()) << "it does not read";
        return prepared;
    }

    FakeStream stream{mediaPath("short.mp4")};
};

TEST_F(StreamTest, AStreamIsPlayed) {
    checks("setDataSource(source)", "The player takes the source over");
    openStream(stream);
    if (IsSkipped() || HasFailure()) return;
    EXPECT_NEAR(kStreamMs, duration(), kNearMs);
    playBeyond(kNearMs);
    EXPECT_EQ(0, stream.mDeletes);
}

TEST_F(StreamTest, ASourceThatIsRefusedIsDeletedAtOnce) {
    checks("setDataSource(source)", "also when it refuses it, which deletes it at once");
    setSource();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(INVALID_OPERATION, player->setDataSource(stream.forEngine()));
    EXPECT_EQ(1, stream.mDeletes) << "deletions";
}

TEST_F(StreamTest, AReleasedPlayerDeletesItToo) {
    checks("setDataSource(source)", "also when it refuses it, which deletes it at once");
    EXPECT_EQ(NO_ERROR, player->release());
    EXPECT_EQ(INVALID_OPERATION, player->setDataSource(stream.forEngine()));
    EXPECT_EQ(1, stream.mDeletes) << "deletions";
}

TEST_F(StreamTest, ResetLetsTheSourceGo) {
    checks("setDataSource(source)", "on the thread that they are called on");
    openStream(stream);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->reset());
    expectLetGo(stream);
    EXPECT_FALSE(stream.isValid());
    const int reads = stream.mReads;
    EXPECT_TRUE(remains([&] { return stream.mReads == reads; })) << "it is read from on";
}

TEST_F(StreamTest, ReleaseLetsTheSourceGo) {
    checks("setDataSource(source)", "on the thread that they are called on");
    openStream(stream);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->release());
    expectLetGo(stream);
}

TEST_F(StreamTest, ASourceThatWasNeverReadIsLetGo) {
    checks("setDataSource(source)", "on the thread that they are called on");
    setStream(stream);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->reset());
    expectLetGo(stream);
}

TEST_F(StreamTest, ResetCancelsAReadThatBlocks) {
    checks("reset", "ends what other threads are waiting for, as stop and release do");
    auto prepared = prepareUntilBlocked();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(INVALID_OPERATION, prepared.get());
    EXPECT_GE(stream.mCancels, 1);
    expectLetGo(stream);
}

TEST_F(StreamTest, ReleaseCancelsAReadThatBlocks) {
    checks("release", "ends what other threads are waiting for, as stop and release do");
    auto prepared = prepareUntilBlocked();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(NO_ERROR, player->release());
    EXPECT_EQ(INVALID_OPERATION, prepared.get());
    expectLetGo(stream);
}

TEST_F(StreamTest, ASourceThatCannotSeekIsPlayed) {
    checks("seekTo", "INVALID_OPERATION for media that cannot seek");
    FakeStream broadcast{mediaPath("short.ts")};
    broadcast.mSeekable = false;
    openStream(broadcast);
    if (!IsSkipped() && !HasFailure()) {
        EXPECT_FALSE(player->canDoSeek(0));
        EXPECT_EQ(INVALID_OPERATION, player->seekTo(kStreamMs / 2, 0));
        playBeyond(kNearMs);
    }
    player->release();
}

TEST_F(StreamTest, WhatCannotSeekEndsInALoopToo) {
    checks("setLooping", "Media that cannot seek end all the same");
    FakeStream broadcast{mediaPath("short.ts")};
    broadcast.mSeekable = false;
    openStream(broadcast);
    if (!IsSkipped() && !HasFailure()) {
        EXPECT_EQ(NO_ERROR, player->setLooping(1));
        EXPECT_EQ(NO_ERROR, player->start());
        EXPECT_TRUE(events->waitFor(android::MEDIA_PLAYBACK_COMPLETE));
        EXPECT_FALSE(player->isPlaying());
    }
    player->release();
}

TEST_F(StreamTest, ASourceMayReportMoreThanItWrote) {
    checks("setDataSource(source)", "may report more than len, but never writes more");
    stream.mOverreport = 100;
    stream.mSeekable = true;
    openStream(stream);
    if (IsSkipped()) return;
    EXPECT_TRUE(isReady());
}

TEST_F(StreamTest, AReadThatFailsIsACause) {
    checks("prepare", "ORV_ERROR_IO: the source could not be opened or read");
    stream.mFailsAt = 0;
    setStream(stream);
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(ORV_ERROR_IO, player->prepare());
}

}  // namespace
}  // namespace orvkit
