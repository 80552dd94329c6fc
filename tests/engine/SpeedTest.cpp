// SPDX-License-Identifier: Apache-2.0
// Speeds, backward play, single frames and repeated sections.
#include <fcntl.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <fstream>

#include "CoreCalls.h"
#include "FakeStream.h"
#include "HttpServer.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class SpeedTest : public PlayerTest {
protected:
    // Whether playback comes to about that speed, in media seconds for a second of
    // the clock. It is measured again and again: a busy machine lets playback wait
    // and then catch up.
    bool comesTo(double factor) {
        return eventually([&] {
            measured = measure(std::abs(factor) * 1000);
            return std::abs(measured - factor) < std::abs(factor) * 0.2;
        });
    }

    double measured = 0;

private:
    // From one change of the position to another that far away.
    double measure(double milliseconds) const {
        const int shown = position();
        eventually([&] { return position() != shown; });
        const int begin = position();
        const auto beginTime = std::chrono::steady_clock::now();
        int end = begin;
        eventually([&] {
            end = position();
            return std::abs(end - begin) >= milliseconds;
        });
        const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - beginTime;
        return (end - begin) / 1000.0 / taken.count();
    }
};

class ForwardSpeedTest : public SpeedTest, public testing::WithParamInterface<int> {};

TEST_P(ForwardSpeedTest, PlaysAtThatSpeed) {
    open("light.mkv");
    ASSERT_EQ(NO_ERROR, player->setSpeed(GetParam()));
    EXPECT_EQ(GetParam(), speed());
    EXPECT_FALSE(player->isPlaying()) << "a speed does not start";
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(comesTo(GetParam() / 1000.0)) << measured;
}

INSTANTIATE_TEST_SUITE_P(Speeds, ForwardSpeedTest,
                         testing::Values(250, 500, 1500, 2000, 4000, 8000, 16000, 32000));

class BackwardSpeedTest : public SpeedTest, public testing::WithParamInterface<int> {};

TEST_P(BackwardSpeedTest, PlaysBackAtThatSpeed) {
    open("light.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(295000, 0));
    ASSERT_EQ(NO_ERROR, player->setSpeed(GetParam()));
    EXPECT_EQ(GetParam(), speed());
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(player->isPlaying());
    EXPECT_TRUE(comesTo(GetParam() / 1000.0)) << measured;
}

INSTANTIATE_TEST_SUITE_P(Speeds, BackwardSpeedTest,
                         testing::Values(-1000, -2000, -8000, -16000, -32000),
                         [](const auto& info) { return "Minus" + std::to_string(-info.param); });

class RewindTest : public SpeedTest, public testing::WithParamInterface<int> {};

TEST_P(RewindTest, AtTheStartGoesOnForward) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(6000, 0));
    ASSERT_EQ(NO_ERROR, player->setSpeed(GetParam()));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return speed() == 1000; }, 30));
    ASSERT_TRUE(eventually([&] { return position() > 300 && position() < 3000; }));
    EXPECT_TRUE(player->isPlaying());
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
}

INSTANTIATE_TEST_SUITE_P(Speeds, RewindTest, testing::Values(-4000, -32000),
                         [](const auto& info) { return "Minus" + std::to_string(-info.param); });

TEST_F(SpeedTest, RewindingPausesAndGoesOn) {
    open("long.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(50000, 0));
    ASSERT_EQ(NO_ERROR, player->setSpeed(-16000));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() < 45000; }));
    ASSERT_EQ(NO_ERROR, player->pause());
    const int held = position();
    EXPECT_TRUE(remains([&] { return position() > held - 3000; }));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() < held - 5000; }));
    ASSERT_EQ(NO_ERROR, player->setSpeed(1000));
    const int turned = position();
    ASSERT_TRUE(eventually([&] { return position() > turned + 500; }));
    EXPECT_LT(position(), turned + 5000);
}

TEST_F(SpeedTest, RefusesWhatIsNoSpeed) {
    open("short.mp4");
    for (int wrong : {0, 249, -249, 32001, -32001, INT32_MAX, INT32_MIN}) {
        EXPECT_EQ(BAD_VALUE, player->setSpeed(wrong)) << wrong;
        EXPECT_FALSE(player->canDoTrick(wrong)) << wrong;
    }
    EXPECT_EQ(1000, speed());
}

TEST_F(SpeedTest, PromisesOnlyWhatItCanDo) {
    EXPECT_FALSE(player->canDoSeek(1000)) << "without media";
    EXPECT_FALSE(player->canDoTrick(2000));
    EXPECT_EQ(INVALID_OPERATION, player->setSpeed(2000));
    open("short.mp4");
    EXPECT_TRUE(player->canDoSeek(1000));
    EXPECT_TRUE(player->canDoTrick(32000));
    EXPECT_TRUE(player->canDoTrick(-32000));
}

TEST_F(SpeedTest, StaysBackwardAtTheStartUntilItPlays) {
    open("long.mkv");
    ASSERT_EQ(NO_ERROR, player->setSpeed(-250));
    EXPECT_TRUE(remains([&] { return speed() == -250; }));
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return speed() == 1000 && position() > 100; }));
}

TEST_F(SpeedTest, NewMediaPlaysAtTheNormalSpeed) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->setSpeed(-2000));
    player->reset();
    open("short.mp4");
    EXPECT_EQ(1000, speed());
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return position() > 500; }));
}

// mpv would take the single frame for a still picture, and know no positions any more.
TEST_F(SpeedTest, PlaysOnAfterItWasBackwardAtTheStart) {
    open("slides.mkv");
    ASSERT_EQ(NO_ERROR, player->setSpeed(-4000));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return speed() == 1000; }));
    for (int step = 0; step < 5; step++) {
        const int shown = position();
        ASSERT_TRUE(eventually([&] { return position() > shown; })) << step;
    }
}

// mpv does not find back from the end that they have.
TEST_F(SpeedTest, RewindsMediaThatEndTooEarly) {
    const int file = ::open(mediaPath("silent.mkv").c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_EQ(NO_ERROR, player->setDataSource(file, 0, 21044));
    close(file);
    ASSERT_EQ(NO_ERROR, player->prepare());
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return events->count(MEDIA_PLAYBACK_COMPLETE) > 0; }));
    // For a second after its last read, mpv would look for more by itself.
    const sp<EventRecorder> seen = new EventRecorder;
    const sp<TarnPlayer> other = new TarnPlayer(-1);
    other->setNotifyCallback(seen);
    ASSERT_EQ(NO_ERROR, other->setDataSource(mediaPath("silent.mkv").c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, other->prepare());
    ASSERT_EQ(NO_ERROR, other->start());
    ASSERT_TRUE(seen->waitFor(MEDIA_PLAYBACK_COMPLETE));
    other->release();
    ASSERT_EQ(NO_ERROR, player->setSpeed(-1000));
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return speed() == 1000; }, 30)) << "the start is reached";
    ASSERT_EQ(NO_ERROR, player->seekTo(0, 0));
    EXPECT_TRUE(eventually([&] { return position() > 100; }));
}

// All of them is kept by mpv, and has no key frame but the first.
TEST_F(SpeedTest, PlaysSlidesOfAServerBackward) {
    HttpServer server(mediaPath("slides.mkv"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url().c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, player->prepare());
    ASSERT_EQ(NO_ERROR, player->seekTo(6000, 3));
    ASSERT_TRUE(player->canDoTrick(-4000));
    ASSERT_EQ(NO_ERROR, player->setSpeed(-4000));
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return position() < 6000; }));
}

// Whether one of the process's threads has that name.
bool hasThread(const std::string& name) {
    // Threads may end while they are listed.
    std::error_code error;
    std::filesystem::directory_iterator task("/proc/self/task", error);
    for (; !error && task != end(task); task.increment(error)) {
        std::string line;
        std::getline(std::ifstream(task->path() / "comm"), line);
        if (line == name) return true;
    }
    return false;
}

TEST_F(SpeedTest, EndsWithTheMedia) {
    for (const bool stops : {true, false}) {
        SCOPED_TRACE(stops ? "stop" : "reset");
        player->reset();
        open("long.mkv");
        ASSERT_EQ(NO_ERROR, player->seekTo(50000, 0));
        ASSERT_EQ(NO_ERROR, player->setSpeed(-16000));
        ASSERT_EQ(NO_ERROR, player->start());
        EXPECT_TRUE(eventually([] { return hasThread("orv-rewind"); }));
        ASSERT_EQ(NO_ERROR, stops ? player->stop() : player->reset());
        EXPECT_EQ(1000, speed());
        // The kernel lists a thread a moment longer than a join waits for it.
        EXPECT_TRUE(eventually([] { return !hasThread("orv-rewind"); }));
    }
}

TEST_F(SpeedTest, ARewindThatGetsNoDataGivesUp) {
    FakeStream stream(mediaPath("long.mkv"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(stream.forEngine()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    ASSERT_EQ(NO_ERROR, player->seekTo(50000, 0));
    stream.blockAt(0);
    ASSERT_EQ(NO_ERROR, player->setSpeed(-16000));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(stream.waitUntilBlocked());
    EXPECT_TRUE(eventually([&] { return speed() == 1000; }));
    stream.letGo();
    const int reached = position();
    EXPECT_TRUE(eventually([&] { return position() > reached + 500; })) << "plays on";
    EXPECT_TRUE(player->isPlaying());
    player->release();
}

TEST_F(SpeedTest, StepsSingleFramesBothWays) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(4000, 0));
    ASSERT_TRUE(player->step(1));
    EXPECT_NEAR(4033, position(), 1);
    ASSERT_TRUE(player->step(5));
    EXPECT_NEAR(4200, position(), 1);
    ASSERT_TRUE(player->step(-2));
    EXPECT_NEAR(4133, position(), 1);
    EXPECT_TRUE(sink->waitFor(0, [](const Picture& p) { return p.timestampUs / 1000 == 4133; }));
    EXPECT_TRUE(player->step(0));
    EXPECT_FALSE(player->isPlaying());
    EXPECT_TRUE(newestPause());
    EXPECT_NEAR(4133, position(), 1);
}

TEST_F(SpeedTest, SteppingPausesPlayback) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > 200; }));
    ASSERT_TRUE(player->step(1));
    EXPECT_FALSE(player->isPlaying());
    const int held = position();
    EXPECT_TRUE(remains([&] { return position() == held; }));
}

TEST_F(SpeedTest, StepsNeedAPictureAndAFrame) {
    open("tone.mp3");
    EXPECT_FALSE(player->step(1));
    player->reset();
    open("short.mp4");
    EXPECT_FALSE(player->step(-1)) << "before the first frame";
    EXPECT_EQ(0, position());
}

TEST_F(SpeedTest, RepeatsASection) {
    open("long.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(10000, 0));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    ASSERT_EQ(NO_ERROR, player->seekTo(11000, 0));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B));
    ASSERT_EQ(NO_ERROR, player->seekTo(10000, 0));
    ASSERT_EQ(NO_ERROR, player->start());
    for (int round = 0; round < 2; round++) {
        ASSERT_TRUE(eventually([&] { return position() > 10700; }));
        ASSERT_TRUE(eventually([&] { return position() < 10500; }));
        EXPECT_GE(position(), 9900);
    }
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_OFF));
    EXPECT_TRUE(eventually([&] { return position() > 11500; }));
}

// One frame would be a still picture to mpv, without a position from then on.
TEST_F(SpeedTest, PlaysOnAfterASectionOfOneFrame) {
    open("long.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(10000, 0));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    ASSERT_TRUE(player->step(1));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B));
    ASSERT_EQ(NO_ERROR, player->seekTo(10000, 0));
    ASSERT_EQ(NO_ERROR, player->start());
    for (int round = 0; round < 3; round++) {
        ASSERT_TRUE(eventually([&] { return position() > 10000; })) << round;
        ASSERT_TRUE(eventually([&] { return position() == 10000; })) << round;
    }
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_OFF));
    EXPECT_TRUE(eventually([&] { return position() > 11000; }));
}

TEST_F(SpeedTest, RefusesSectionsWithoutALength) {
    open("long.mkv");
    EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B)) << "no beginning yet";
    ASSERT_EQ(NO_ERROR, player->seekTo(5000, 0));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B)) << "no length";
    ASSERT_EQ(NO_ERROR, player->seekTo(2000, 0));
    EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B)) << "before the beginning";
    EXPECT_EQ(0, player->setABRepeat(3));
    EXPECT_EQ(0, player->setABRepeat(-1));
}

}  // namespace
