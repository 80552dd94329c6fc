// SPDX-License-Identifier: Apache-2.0
// What the player knows of itself, without a core.
#include <gtest/gtest.h>

#include "core/PlayerState.h"

namespace orvtarn {
namespace {

// A seek as the operations and the event loop report it.
class PlayerStateSeekTest : public testing::Test {
protected:
    void begin() {
        values.seeking = true;
        values.beginSeek();
    }
    void restart() { values.restarts++; }

    PlayerState::Values values;
};

TEST_F(PlayerStateSeekTest, IsUnderWayFromItsBeginningToTheRestartAfterIt) {
    EXPECT_FALSE(values.isArriving());
    begin();
    EXPECT_TRUE(values.isArriving());
    values.onSeek();
    EXPECT_TRUE(values.isArriving());
    restart();
    EXPECT_FALSE(values.isArriving());
}

TEST_F(PlayerStateSeekTest, ARestartThatIsReportedBeforeItBeganIsAnEarlierOnes) {
    begin();
    restart();
    EXPECT_TRUE(values.isArriving());
    values.onSeek();
    EXPECT_TRUE(values.isArriving()) << "the restart came before";
    restart();
    EXPECT_FALSE(values.isArriving());
}

// mpv may split one up, as over the end of a loop.
TEST_F(PlayerStateSeekTest, OfTwoTheRestartAfterTheFirstIsEnough) {
    begin();
    values.onSeek();
    restart();
    values.onSeek();
    EXPECT_FALSE(values.isArriving());
}

TEST_F(PlayerStateSeekTest, TheNextOneBeginsAnew) {
    begin();
    values.onSeek();
    restart();
    begin();
    EXPECT_TRUE(values.isArriving());
    restart();
    values.onSeek();
    EXPECT_TRUE(values.isArriving());
    restart();
    EXPECT_FALSE(values.isArriving());
}

TEST_F(PlayerStateSeekTest, NoneIsUnderWayThatWasGivenUp) {
    begin();
    values.seeking = false;
    EXPECT_FALSE(values.isArriving());
}

TEST(PlayerStateTest, ForgetsTheMediaAndKeepsWhoAttendsASeek) {
    for (const bool attended : {false, true}) {
        PlayerState::Values values;
        values.seeking = values.fileStarted = values.restarted = values.framed = true;
        values.hasVideo = values.seekable = values.buffering = values.looping = true;
        values.attended = attended;
        values.startUs = 1;
        values.position = values.duration = 2;
        values.width = values.height = values.bufferPercent = 3;
        values.forgetMedia();
        EXPECT_EQ(attended, values.seeking);
        EXPECT_FALSE(values.fileStarted || values.restarted || values.framed);
        EXPECT_FALSE(values.hasVideo || values.seekable || values.buffering);
        EXPECT_FALSE(values.startUs.has_value());
        EXPECT_EQ(0, values.position + values.duration);
        EXPECT_EQ(0, values.width + values.height + values.bufferPercent);
        EXPECT_TRUE(values.looping);
    }
}

TEST(PlayerStateTest, OnlyMediaThatAreOpenOrComingFail) {
    const auto fails = [](Phase phase) {
        PlayerState::Values values;
        values.phase = phase;
        const bool failed = values.fail(-5);
        EXPECT_EQ(failed ? Phase::Error : phase, values.phase);
        EXPECT_EQ(failed ? -5 : 0, values.error);
        return failed;
    };
    for (const Phase phase :
         {Phase::Preparing, Phase::Prepared, Phase::Started, Phase::Paused, Phase::Completed}) {
        EXPECT_TRUE(fails(phase)) << phaseName(phase);
    }
    for (const Phase phase :
         {Phase::Idle, Phase::Initialized, Phase::Stopped, Phase::Error, Phase::Released}) {
        EXPECT_FALSE(fails(phase)) << phaseName(phase);
    }
}

TEST(PlayerStateTest, ThePositionIsThatOfThePhase) {
    const auto positionIn = [](Phase phase, double position, double duration) {
        PlayerState state;
        state.update([&](PlayerState::Values& v) {
            v.phase = phase;
            v.error = -7;
            v.position = position;
            v.duration = duration;
        });
        return state.currentPosition();
    };
    EXPECT_EQ(1500, positionIn(Phase::Started, 1.5, 4).msec);
    EXPECT_EQ(4000, positionIn(Phase::Paused, 5, 4).msec) << "not beyond the end";
    EXPECT_EQ(5000, positionIn(Phase::Paused, 5, 0).msec) << "the end is unknown";
    EXPECT_EQ(4000, positionIn(Phase::Completed, 3.9, 4).msec);
    EXPECT_EQ(android::NO_ERROR, positionIn(Phase::Completed, 3.9, 4).status);
    EXPECT_EQ(-7, positionIn(Phase::Error, 1, 4).status);
    EXPECT_EQ(android::INVALID_OPERATION, positionIn(Phase::Stopped, 1, 4).status);
}

}  // namespace
}  // namespace orvtarn
