// SPDX-License-Identifier: Apache-2.0
// Media pulled from a stream source, whatever the source lacks or does wrong.
#include <orvtarn/PlayerTypes.h>

#include <algorithm>
#include <chrono>
#include <thread>

#include "FakeStream.h"
#include "LogCapture.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class StreamSourceTest : public PlayerTest {
protected:
    // Before the stream that its source leads to.
    ~StreamSourceTest() override { player->release(); }

    void makeStream(const char* name) { stream = std::make_unique<FakeStream>(mediaPath(name)); }

    status_t prepareStream() {
        EXPECT_EQ(NO_ERROR, player->setDataSource(stream->forEngine()));
        return player->prepare();
    }

    // Everything that was delivered is what the file holds there.
    void expectDeliveredWhole() { EXPECT_EQ(stream->content(), stream->delivered()); }

    std::unique_ptr<FakeStream> stream;
};

TEST_F(StreamSourceTest, DeliversByteForByte) {
    makeStream("short.mp4");
    ASSERT_EQ(NO_ERROR, prepareStream());
    EXPECT_NEAR(3000, duration(), 50);
    playToEnd();
    expectDeliveredWhole();
    player->reset();
    EXPECT_EQ(1, stream->mCloses);
    EXPECT_EQ(1, stream->mDeletes);
    EXPECT_FALSE(stream->isValid());
    EXPECT_TRUE(stream->isThreadSelf());
}

TEST_F(StreamSourceTest, NeedsNeitherSeeksNorLength) {
    makeStream("short.ts");
    stream->mSeekable = false;
    stream->mHasLength = false;
    ASSERT_EQ(NO_ERROR, prepareStream());
    EXPECT_FALSE(player->canDoSeek(1000));
    EXPECT_FALSE(player->canDoTrick(-2000));
    EXPECT_TRUE(player->canDoTrick(2000));
    EXPECT_EQ(INVALID_OPERATION, player->setSpeed(-2000));
    EXPECT_EQ(INVALID_OPERATION, player->seekTo(1000, 0));
    playToEnd();
    EXPECT_EQ(INVALID_OPERATION, player->start()) << "it cannot be played again";
    EXPECT_EQ(duration(), position());
    EXPECT_FALSE(player->isPlaying());
    EXPECT_EQ(0, stream->mSeeks);
    expectDeliveredWhole();
    ASSERT_EQ(NO_ERROR, player->stop());
    EXPECT_EQ(ORV_ERROR_IO, player->prepare()) << "nor opened";
}

TEST_F(StreamSourceTest, WhatCannotSeekDoesNotLoop) {
    for (const char* name : {"short.ts", "tone.mp3"}) {
        SCOPED_TRACE(name);
        const int before = events->count(MEDIA_PLAYBACK_COMPLETE);
        player->reset();
        makeStream(name);
        stream->mSeekable = false;
        ASSERT_EQ(NO_ERROR, player->setLooping(1));
        ASSERT_EQ(NO_ERROR, prepareStream());
        ASSERT_EQ(NO_ERROR, player->start());
        LogCapture log;
        ASSERT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE, before + 1));
        EXPECT_TRUE(remains([&] { return complaints(log).empty(); })) << "the core tries in vain";
        EXPECT_EQ(INVALID_OPERATION, player->start());
    }
}

TEST_F(StreamSourceTest, TakesSmallReads) {
    makeStream("silent.mp4");
    stream->mLongestRead = 1;
    ASSERT_EQ(NO_ERROR, prepareStream());
    playToEnd();
    expectDeliveredWhole();
}

TEST_F(StreamSourceTest, SurvivesReadsThatClaimTooMuch) {
    makeStream("short.mp4");
    stream->mOverreport = 100;
    ASSERT_EQ(NO_ERROR, prepareStream());
    playToEnd();
    expectDeliveredWhole();
}

TEST_F(StreamSourceTest, SeeksOnDemand) {
    makeStream("feature.mkv");
    ASSERT_EQ(NO_ERROR, prepareStream());
    EXPECT_EQ(NO_ERROR, player->seekTo(8500, 0));
    EXPECT_EQ(8000, position());
    EXPECT_GT(stream->mSeeks, 0);
}

TEST_F(StreamSourceTest, ASourceThatOnlySaysThatItSeeksDoesNot) {
    makeStream("short.ts");
    stream->mSeeksFail = true;
    ASSERT_EQ(NO_ERROR, prepareStream());
    EXPECT_FALSE(player->canDoSeek(1000));
    playToEnd();
    expectDeliveredWhole();
}

TEST_F(StreamSourceTest, SeeksThatFailDoNotEndPlayback) {
    makeStream("feature.mkv");
    ASSERT_EQ(NO_ERROR, prepareStream());
    stream->mSeeksFail = true;
    player->seekTo(8000, 0);
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] {
        int msec = 0;
        return player->getCurrentPosition(&msec) != NO_ERROR || msec > 500;
    }));
    stream->mSeeksFail = false;
    player->reset();
    open("short.mp4");
}

TEST_F(StreamSourceTest, AReadErrorInMidStreamIsAnError) {
    makeStream("feature.mkv");
    stream->mFailsAt = 1500000;
    ASSERT_EQ(NO_ERROR, prepareStream());
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(events->waitFor(MEDIA_ERROR));
    int msec = 0;
    EXPECT_EQ(ORV_ERROR_IO, player->getCurrentPosition(&msec));
    EXPECT_FALSE(player->isPlaying());
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(StreamSourceTest, AReadErrorAtOnceEndsPrepare) {
    makeStream("short.mp4");
    stream->mFailsAt = 0;
    EXPECT_EQ(ORV_ERROR_IO, prepareStream());
}

TEST_F(StreamSourceTest, AnEarlyEndIsTheEnd) {
    makeStream("short.ts");
    stream->mEndsAt = 150000;
    ASSERT_EQ(NO_ERROR, prepareStream());
    playToEnd();
}

TEST_F(StreamSourceTest, ASourceThatMayStallIsWaitedFor) {
    makeStream("short.ts");
    stream->mStalling = true;
    stream->mSeekable = false;
    stream->mEndsAtNow = 150000;
    ASSERT_EQ(NO_ERROR, prepareStream());
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return stream->getCurrentPosition() == 150000; }));
    const int reads = stream->mReads;
    ASSERT_TRUE(eventually([&] { return stream->mReads > reads + 3; })) << "asks again";
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
    stream->mEndsAtNow = INT64_MAX;
    ASSERT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
    expectDeliveredWhole();
}

class BlockedReadTest : public StreamSourceTest {
protected:
    // Runs the operation while a read blocks in the middle of the media: that ends the
    // read, and does not wait until the engine gives a read up, after half a minute.
    void expectPrompt(const std::function<void()>& operation) {
        const auto begin = std::chrono::steady_clock::now();
        operation();
        const auto end = std::chrono::steady_clock::now();
        EXPECT_GT(stream->unblockedAt(), begin);
        EXPECT_LE(stream->unblockedAt(), end);
        EXPECT_LT(end - begin, std::chrono::seconds(15));
        EXPECT_GE(stream->mCancels, 1);
    }

    void blockInTheMiddle() {
        makeStream("feature.mkv");
        stream->blockAt(3000000);
        ASSERT_EQ(NO_ERROR, prepareStream());
        ASSERT_EQ(NO_ERROR, player->start());
        ASSERT_TRUE(stream->waitUntilBlocked());
    }
};

TEST_F(BlockedReadTest, StopEndsIt) {
    blockInTheMiddle();
    expectPrompt([&] { EXPECT_EQ(NO_ERROR, player->stop()); });
    // The source is as good as before.
    stream->letGo();
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(0, position());
}

TEST_F(BlockedReadTest, ResetEndsItAndLetsTheSourceGo) {
    blockInTheMiddle();
    expectPrompt([&] { EXPECT_EQ(NO_ERROR, player->reset()); });
    stream.reset();
    open("short.mp4");
}

TEST_F(BlockedReadTest, ReleaseEndsItAndLetsTheSourceGo) {
    blockInTheMiddle();
    expectPrompt([&] { EXPECT_EQ(NO_ERROR, player->release()); });
    stream.reset();
}

TEST_F(BlockedReadTest, WhilePreparingResetEndsBoth) {
    makeStream("feature.mkv");
    stream->blockAt(100);
    ASSERT_EQ(NO_ERROR, player->setDataSource(stream->forEngine()));
    std::thread preparing([&] { EXPECT_EQ(INVALID_OPERATION, player->prepare()); });
    ASSERT_TRUE(stream->waitUntilBlocked());
    expectPrompt([&] { EXPECT_EQ(NO_ERROR, player->reset()); });
    preparing.join();
}

TEST_F(BlockedReadTest, WhilePreparingIsWaitedForHalfAMinute) {
    makeStream("feature.mkv");
    stream->blockAt(0);
    EXPECT_EQ(TIMED_OUT, prepareStream());
    int msec = 0;
    EXPECT_EQ(TIMED_OUT, player->getCurrentPosition(&msec));
    ASSERT_EQ(NO_ERROR, player->reset());
    open("short.mp4");
}

TEST_F(StreamSourceTest, BecomingInvalidIsAnError) {
    makeStream("feature.mkv");
    stream->blockAt(1500000);
    ASSERT_EQ(NO_ERROR, prepareStream());
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(stream->waitUntilBlocked());
    stream->setInvalid();
    stream->letGo();
    ASSERT_TRUE(events->waitFor(MEDIA_ERROR));
}

TEST_F(StreamSourceTest, AnInvalidSourceDoesNotOpen) {
    makeStream("short.mp4");
    stream->setInvalid();
    EXPECT_EQ(ORV_ERROR_IO, prepareStream());
}

TEST_F(StreamSourceTest, TellsAboutItselfWhilePlaying) {
    makeStream("tracks.mkv");
    ASSERT_EQ(NO_ERROR, prepareStream());
    ASSERT_EQ(NO_ERROR, player->start());
    SubtitleTrackInfo chapter;
    EXPECT_TRUE(player->getSubtitleTrackInfo(ORV_CHAPTER_INDEX_BASE, chapter));
    MetaDataInfo info;
    EXPECT_TRUE(player->getMetaDataInfo(info));
    EXPECT_EQ(3, info.mChapterCount);
    EXPECT_NEAR(10000, info.mDuration, 100);
    EXPECT_TRUE(player->isPlaying());
}

TEST_F(StreamSourceTest, ReleaseDeletesTheSource) {
    makeStream("short.mp4");
    ASSERT_EQ(NO_ERROR, prepareStream());
    EXPECT_EQ(0, stream->mDeletes);
    player->release();
    EXPECT_EQ(1, stream->mCloses);
    EXPECT_EQ(1, stream->mDeletes);
}

TEST_F(StreamSourceTest, ASourceThatIsRefusedIsDeletedAtOnce) {
    makeStream("short.mp4");
    ASSERT_EQ(NO_ERROR, prepareStream());
    FakeStream second(mediaPath("short.mp4"));
    EXPECT_EQ(INVALID_OPERATION, player->setDataSource(second.forEngine()));
    EXPECT_EQ(1, second.mDeletes);
    EXPECT_EQ(0, second.mReads + second.mCloses);
    player->release();
    EXPECT_EQ(INVALID_OPERATION, player->setDataSource(second.forEngine()));
    EXPECT_EQ(2, second.mDeletes);
}

TEST_F(StreamSourceTest, ANullSourceIsRefused) {
    EXPECT_EQ(BAD_VALUE, player->setDataSource(static_cast<IOrvStreamSource*>(nullptr)));
}

}  // namespace
