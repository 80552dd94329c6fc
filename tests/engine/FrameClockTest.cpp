// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "core/FrameClock.h"
#include "core/FrameTiming.h"

namespace orvtarn {
namespace {

constexpr int64_t kStart = 1000000;  // microseconds, on mpv's clock
constexpr int64_t kStep = 40000;     // between frames at the normal speed

// Plays frames of 25 a second whose reports are read in time.
class FrameClockTest : public testing::Test {
protected:
    // The number of the frame whose time is found for a frame that is due at a step,
    // with a report of another one, read after a part of a step.
    double frameFor(double step, double reported, double readAfter) {
        const int64_t due = at(step);
        clock.begin(due);
        return clock.resolve(reported / 25, due + static_cast<int64_t>(readAfter * kStep)) * 25;
    }

    static int64_t at(double step) { return kStart + static_cast<int64_t>(step * kStep); }

    void playUntil(int last) {
        for (int frame = 0; frame <= last; frame++) frameFor(frame, frame, 0.1);
    }

    FrameClock clock;
};

TEST_F(FrameClockTest, AReportInTimeIsTheFrames) {
    for (int frame = 0; frame < 5; frame++) EXPECT_NEAR(frame, frameFor(frame, frame, 0.5), 1e-6);
}

TEST_F(FrameClockTest, ALateReportIsOfTheFrameAfter) {
    playUntil(3);
    EXPECT_NEAR(4, frameFor(4, 5, 1.2), 1e-6);
    EXPECT_NEAR(5, frameFor(5, 6, 1.1), 1e-6);
    EXPECT_NEAR(6, frameFor(6, 6, 1.1), 1e-6) << "the next one is not queued yet";
}

TEST_F(FrameClockTest, FramesThatWereLeftOutChangeNothing) {
    playUntil(3);
    EXPECT_NEAR(7, frameFor(7, 8, 1.2), 1e-6);
}

TEST_F(FrameClockTest, TheTimeIsExpectedByTheFramesBefore) {
    EXPECT_FALSE(clock.begin(at(0)));
    clock.resolve(0, at(0));
    const auto expected = clock.begin(at(1));
    ASSERT_TRUE(expected);
    EXPECT_NEAR(0.04, *expected, 1e-9);
}

TEST_F(FrameClockTest, DistancesThatBeginAnewAreFollowed) {
    playUntil(3);
    // mpv was late by eight steps.
    EXPECT_NEAR(4, frameFor(12, 4, 1.2), 1e-6);
    EXPECT_NEAR(5, frameFor(13, 6, 1.2), 1e-6);
}

TEST_F(FrameClockTest, BackwardPlayCountsDown) {
    clock.setSpeed(-1);
    for (int step = 0; step < 3; step++)
        EXPECT_NEAR(20 - step, frameFor(step, 20 - step, 0.1), 1e-6);
    EXPECT_NEAR(17, frameFor(3, 16, 1.2), 1e-6);
}

TEST_F(FrameClockTest, TheSpeedIsInTheDistances) {
    clock.setSpeed(2);
    for (int step = 0; step < 3; step++) EXPECT_NEAR(2 * step, frameFor(step, 2 * step, 0.1), 1e-6);
    EXPECT_NEAR(6, frameFor(3, 8, 1.2), 1e-6);
}

TEST_F(FrameClockTest, AReportFromBeyondAJumpIsNotTheFrames) {
    playUntil(30);
    EXPECT_NEAR(31, frameFor(31, 0, 0.01), 1e-6);
    EXPECT_NEAR(0, frameFor(31.02, 0, 0.1), 1e-6) << "due at once";
}

TEST_F(FrameClockTest, TheLastFrameBeforeAJumpIsKnownWhenMpvLeaves) {
    playUntil(30);
    clock.begin(at(31));
    const auto time = clock.leave(at(31.5));
    ASSERT_TRUE(time);
    EXPECT_NEAR(31 / 25.0, *time, 1e-6);
    EXPECT_FALSE(clock.begin(at(32))) << "no successor";
}

TEST_F(FrameClockTest, AFrameThatWasDueBeforeAJumpIsOfBefore) {
    playUntil(30);
    clock.leave(at(31.1));
    EXPECT_NEAR(31, frameFor(31, 0, 0.15), 1e-6);
    EXPECT_NEAR(0, frameFor(31.3, 0, 0.1), 1e-6);
    EXPECT_NEAR(1, frameFor(32.3, 1, 0.1), 1e-6);
}

TEST_F(FrameClockTest, AFrameThatIsDueAfterAJumpIsOfBeyond) {
    playUntil(30);
    clock.leave(at(30.9));
    EXPECT_NEAR(75, frameFor(31, 75, 0.1), 1e-6);
}

TEST_F(FrameClockTest, AFrameAtAnotherDistanceIsOfBeyondAJump) {
    playUntil(30);
    // The jump is known late.
    clock.leave(at(32));
    EXPECT_NEAR(0, frameFor(31.6, 0, 0.1), 1e-6);
}

TEST(FrameTiming, MomentsInNanosecondsAreMicroseconds) {
    for (const int64_t now : {int64_t{5000}, int64_t{2000000}, int64_t{3600000000}}) {
        EXPECT_EQ(now + 20000, dueInMicroseconds(now + 20000, now));
        EXPECT_EQ(now - 3000, dueInMicroseconds(now - 3000, now)) << "late";
        EXPECT_EQ(now + 20000, dueInMicroseconds((now + 20000) * 1000, now));
        EXPECT_EQ(now - 3000, dueInMicroseconds((now - 3000) * 1000 + 7, now));
    }
}

TEST_F(FrameClockTest, NothingFollowsFromAFrameThatStandsStill) {
    playUntil(3);
    clock.begin(at(9));
    clock.stand();
    EXPECT_FALSE(clock.begin(at(10)));
}

}  // namespace
}  // namespace orvtarn
