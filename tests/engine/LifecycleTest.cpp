// SPDX-License-Identifier: Apache-2.0
// States, operations in the wrong one, and threads that do not wait for each
// other.
#include <math.h>
#include <orvtarn/PlayerTypes.h>

#include <atomic>
#include <chrono>
#include <thread>

#include "FakeStream.h"
#include "LogCapture.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class LifecycleTest : public PlayerTest {
protected:
    status_t setFile(const char* name) {
        return player->setDataSource(mediaPath(name).c_str(), nullptr);
    }

    // What needs media that are open.
    void expectClosed() {
        int value = 7;
        EXPECT_EQ(INVALID_OPERATION, player->start());
        EXPECT_EQ(INVALID_OPERATION, player->pause());
        EXPECT_EQ(INVALID_OPERATION, player->seekTo(0, 0));
        EXPECT_EQ(INVALID_OPERATION, player->getCurrentPosition(&value));
        EXPECT_EQ(0, value);
        EXPECT_EQ(INVALID_OPERATION, player->setSpeed(1000));
        EXPECT_EQ(INVALID_OPERATION, player->getCurrentBytePosition(&value));
        EXPECT_FALSE(player->isPlaying());
        EXPECT_FALSE(player->step(1));
        EXPECT_FALSE(player->seekToPosition(0));
        EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
        EXPECT_FALSE(player->canDoSeek(1000));
        MetaDataInfo info;
        EXPECT_FALSE(player->getMetaDataInfo(info));
    }
};

TEST_F(LifecycleTest, IdleRefusesWhatNeedsMedia) {
    expectClosed();
    EXPECT_EQ(INVALID_OPERATION, player->prepare());
    EXPECT_EQ(INVALID_OPERATION, player->prepareAsync());
    EXPECT_EQ(INVALID_OPERATION, player->stop());
    int value = 7;
    EXPECT_EQ(INVALID_OPERATION, player->getDuration(&value));
    EXPECT_EQ(NO_ERROR, player->getVideoWidth(&value));
    EXPECT_EQ(0, value);
    EXPECT_EQ(nullptr, player->extractAlbumArt());
}

TEST_F(LifecycleTest, ASourceIsSetOnce) {
    ASSERT_EQ(NO_ERROR, setFile("short.mp4"));
    EXPECT_EQ(INVALID_OPERATION, setFile("short.mp4"));
    expectClosed();
    ASSERT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(NO_ERROR, setFile("silent.mp4"));
}

TEST_F(LifecycleTest, PrepareIsForSourcesThatAreNotOpen) {
    open("short.mp4");
    EXPECT_EQ(INVALID_OPERATION, player->prepare());
    EXPECT_EQ(INVALID_OPERATION, player->prepareAsync());
    EXPECT_EQ(INVALID_OPERATION, player->pause()) << "nothing is playing";
    EXPECT_EQ(INVALID_OPERATION, setFile("short.mp4"));
    EXPECT_EQ(NO_ERROR, player->start());
}

TEST_F(LifecycleTest, StoppedMediaArePreparedAgain) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > 200; }));
    ASSERT_EQ(NO_ERROR, player->stop());
    expectClosed();
    EXPECT_EQ(NO_ERROR, player->stop());
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(0, position());
    EXPECT_FALSE(player->isPlaying());
    playToEnd();
}

TEST_F(LifecycleTest, StoppedMediaForgetHowTheyWerePlayed) {
    open("tracks.mkv");
    int track = -1;
    ASSERT_NE(0, player->getCurrentAudioIndex(&track));
    const int usual = track;
    ASSERT_TRUE(player->selectAudioTrack(1 - usual));
    ASSERT_TRUE(player->onSubtitleTrack(1));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    ASSERT_EQ(NO_ERROR, player->setSpeed(2000));
    ASSERT_EQ(NO_ERROR, player->stop());
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(1000, speed());
    ASSERT_NE(0, player->getCurrentAudioIndex(&track));
    EXPECT_EQ(usual, track);
    ASSERT_NE(0, player->getCurrentSubtitleIndex(&track));
    EXPECT_EQ(-1, track);
    ASSERT_EQ(NO_ERROR, player->seekTo(2000, 0));
    EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B)) << "no beginning";
}

TEST_F(LifecycleTest, StartAndPauseMayBeRepeated) {
    open("short.mp4");
    EXPECT_EQ(NO_ERROR, player->start());
    EXPECT_EQ(NO_ERROR, player->start());
    EXPECT_EQ(NO_ERROR, player->pause());
    EXPECT_EQ(NO_ERROR, player->pause());
    EXPECT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(player->isPlaying());
}

TEST_F(LifecycleTest, AReleasedPlayerRefusesEverything) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->release());
    EXPECT_EQ(NO_ERROR, player->release());
    int value = 0;
    EXPECT_EQ(INVALID_OPERATION, setFile("short.mp4"));
    EXPECT_EQ(INVALID_OPERATION, player->getCurrentPosition(&value));
    EXPECT_EQ(INVALID_OPERATION, player->reset());
    EXPECT_EQ(INVALID_OPERATION, player->setVideoSurfaceTexture(sink));
    EXPECT_EQ(INVALID_OPERATION, player->setVolume(1, 1));
    EXPECT_FALSE(player->isPlaying());
    EXPECT_FALSE(player->getAudioTrackCount(value));
    EXPECT_EQ(0, player->getBufferPercent());
}

TEST_F(LifecycleTest, FailuresLogOneLineEach) {
    LogCapture log;
    player->start();
    player->setUnLockPin(1234);
    player->setTS(5);
    player->setVolume(NAN, 1);
    player->step(1);
    EXPECT_THAT(log.lines("TarnPlayer"),
                LinesAre({error("start: not possible while idle"),
                          error("setUnLockPin: nothing is locked here (status -38)"),
                          error("setTS: 5: transport streams have no such setting here"),
                          error("setVolume: not a number (status -22)"),
                          error("step: not possible while idle")}));
}

TEST_F(LifecycleTest, WithoutAReleaseTheLastReferenceCleansUp) {
    FakeStream stream(mediaPath("short.mp4"));
    {
        sp<TarnPlayer> other = new TarnPlayer(-1);
        ASSERT_EQ(NO_ERROR, other->setDataSource(stream.forEngine()));
        ASSERT_EQ(NO_ERROR, other->prepare());
        ASSERT_EQ(NO_ERROR, other->start());
    }
    EXPECT_EQ(1, stream.mCloses);
}

TEST_F(LifecycleTest, AListenerMayCallThePlayer) {
    std::atomic<int> prepared{-1};
    events->setReaction([&](const Event& event) {
        if (event.msg == MEDIA_PREPARED) prepared = player->start();
        if (event.msg == MEDIA_PLAYBACK_COMPLETE) player->release();
    });
    ASSERT_EQ(NO_ERROR, setFile("silent.mp4"));
    ASSERT_EQ(NO_ERROR, player->prepareAsync());
    ASSERT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
    EXPECT_EQ(NO_ERROR, prepared);
    int msec = 0;
    EXPECT_TRUE(eventually([&] { return player->getCurrentPosition(&msec) != NO_ERROR; }));
}

TEST_F(LifecycleTest, NothingIsToldAfterRelease) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->release());
    const size_t told = events->events().size();
    EXPECT_TRUE(remains([&] { return events->events().size() == told; }));
}

TEST_F(LifecycleTest, ReleaseEndsASeekUnderWay) {
    FakeStream stream(mediaPath("long.mkv"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(stream.forEngine()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    stream.blockAt(0);
    status_t sought = NO_ERROR;
    std::thread seeking([&] { sought = player->seekTo(50000, 3); });
    EXPECT_TRUE(stream.waitUntilBlocked());
    EXPECT_EQ(NO_ERROR, player->release());
    seeking.join();
    EXPECT_EQ(INVALID_OPERATION, sought) << "not its own limit";
}

// Threads call everything at once, one of them resets, then all end.
TEST_F(LifecycleTest, AnyThreadAtAnyTime) {
    LogCapture quiet;
    std::atomic<bool> quit{false};
    std::vector<std::thread> threads;
    const auto loop = [&](const std::function<void(int)>& body) {
        threads.emplace_back([&quit, body] {
            for (int i = 0; !quit; i++) body(i);
        });
    };
    std::atomic<int> rounds{0};
    loop([&](int i) {
        setFile(i % 2 ? "short.mp4" : "tracks.mkv");
        player->prepare();
        player->start();
        player->reset();
        rounds = i;
    });
    loop([&](int i) {
        player->seekTo(i % 3000, i % 4);
        player->setSpeed(i % 5 ? 1000 : -2000);
        player->pause();
    });
    loop([&](int i) {
        MetaDataInfo info;
        player->getMetaDataInfo(info);
        player->onSubtitleTrack(i % 2);
        player->setVolume(0.5f, static_cast<float>(i % 10) / 10);
    });
    loop([&](int i) {
        player->setVideoSurfaceTexture(i % 2 ? sink : nullptr);
        player->stop();
        player->step(i % 3 - 1);
        int value = 0;
        player->getCurrentPosition(&value);
    });
    EXPECT_TRUE(eventually([&] { return rounds >= 5; }, 60));
    quit = true;
    for (std::thread& thread : threads) thread.join();
    player->reset();
    player->setVideoSurfaceTexture(sink);
    open("short.mp4");
    playToEnd();
}

TEST_F(LifecycleTest, ManyPlayersComeAndGo) {
    for (int i = 0; i < 10; i++) {
        sp<TarnPlayer> other = new TarnPlayer(-1);
        other->setVideoSurfaceTexture(sink);
        ASSERT_EQ(NO_ERROR, other->setDataSource(mediaPath("short.mp4").c_str(), nullptr));
        ASSERT_EQ(NO_ERROR, other->prepare());
        ASSERT_EQ(NO_ERROR, other->start());
    }
}

}  // namespace
