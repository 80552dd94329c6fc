// SPDX-License-Identifier: Apache-2.0
// Speeds, single frames, repeated sections, and how much is there to be played.
#include "KitTest.h"

using android::BAD_VALUE;
using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kDouble = 2 * ORV_SPEED_NORMAL;
constexpr int kFrameMs = 100;  // a frame of ten in a second, or shorter
constexpr int kHalfFrameMs = kFrameMs / 2;

class SpeedTest : public KitTest {
protected:
    int speed() const {
        int value = -1;
        EXPECT_TRUE(player->getSpeed(value));
        return value;
    }

    // Opens the film for an engine that plays at that speed.
    void openFor(int wanted) {
        ORV_OPEN();
        ORV_NOT_OFFERED_IF(!player->canDoTrick(wanted),
                           "it does not play at speed " + std::to_string(wanted));
    }
};

TEST_F(SpeedTest, ASpeedThatIsPossibleIsTaken) {
    checks("canDoTrick", "whether that speed is");
    ORV_OPEN();
    for (const int wanted : {+ORV_SPEED_NORMAL, kDouble, ORV_SPEED_NORMAL / 2, -ORV_SPEED_NORMAL}) {
        EXPECT_EQ(player->canDoTrick(wanted), player->setSpeed(wanted) == NO_ERROR) << wanted;
    }
}

TEST_F(SpeedTest, ASpeedIsKept) {
    checks("setSpeed", "Does not start playback");
    openFor(kDouble);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->setSpeed(kDouble));
    EXPECT_EQ(kDouble, speed());
    EXPECT_FALSE(player->isPlaying());
    playBeyond(kNearMs);
    EXPECT_EQ(kDouble, speed());
}

TEST_F(SpeedTest, SpeedsOutsideAreRefused) {
    checks("setSpeed", "Thousandths, from 250 to 32000 forward or backward");
    ORV_OPEN();
    for (const int wanted : {0, 100, -100, ORV_SPEED_MAX + 1, ORV_SPEED_MIN - 1}) {
        EXPECT_FALSE(player->canDoTrick(wanted)) << wanted;
        EXPECT_EQ(BAD_VALUE, player->setSpeed(wanted)) << wanted;
    }
    EXPECT_EQ(ORV_SPEED_NORMAL, speed());
}

TEST_F(SpeedTest, BackwardEndsAtTheStart) {
    checks("setSpeed", "Media that play backward to their start go on forward");
    openFor(-kDouble);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->seekTo(kMiddleMs, 0));
    const int begin = position();
    ASSERT_EQ(NO_ERROR, player->setSpeed(-kDouble));
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return position() < begin - kNearMs; }));
    EXPECT_TRUE(eventually([&] { return speed() == ORV_SPEED_NORMAL; }));
    EXPECT_TRUE(eventually([&] { return position() > kNearMs; }));
}

TEST_F(SpeedTest, TheSpeedEndsWithAReset) {
    checks("getSpeed", "speed, repeated section, subtitle files and look do not");
    openFor(kDouble);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->setSpeed(kDouble));
    ASSERT_EQ(NO_ERROR, player->reset());
    ORV_OPEN();
    EXPECT_EQ(ORV_SPEED_NORMAL, speed());
}

TEST_F(SpeedTest, TheUsualSpeedIsNormal) {
    checks("getSpeed", "A player is idle, initialized (setDataSource)");
    ORV_OPEN();
    EXPECT_EQ(ORV_SPEED_NORMAL, speed());
}

TEST_F(SpeedTest, AStepIsAFrameAndPauses) {
    checks("step", "Pauses, and blocks until the last one is shown");
    ORV_OPEN();
    playBeyond(kNearMs);
    ORV_NOT_OFFERED_IF(!player->step(1), "it does not step");
    EXPECT_FALSE(player->isPlaying());
    const int place = position();
    ASSERT_TRUE(player->step(2));
    EXPECT_GT(position(), place);
    EXPECT_LE(position(), place + 2 * kFrameMs);
    ASSERT_TRUE(player->step(-2));
    EXPECT_NEAR(place, position(), kHalfFrameMs);
}

TEST_F(SpeedTest, NoStepLeadsOutOfTheMedia) {
    checks("step", "for a frame before the first or past the last");
    EXPECT_FALSE(player->step(1)) << "without media";
    ORV_OPEN();
    EXPECT_FALSE(player->step(-1));
    EXPECT_NEAR(0, position(), kNearMs);
}

TEST_F(SpeedTest, ASectionIsRepeated) {
    checks("setABRepeat", "E_ORV_AB_REPEAT_SET_B: end it here and repeat it from now on");
    ORV_OPEN();
    playBeyond(kNearMs);
    ORV_NOT_OFFERED_IF(player->setABRepeat(E_ORV_AB_REPEAT_SET_A) == 0, "it repeats no sections");
    const int begin = position();
    ASSERT_TRUE(eventually([&] { return position() > begin + 3 * kNearMs; }));
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B));
    const int end = position();
    const auto isBack = [&] { return position() < begin + 2 * kNearMs; };
    EXPECT_TRUE(eventually(isBack));
    EXPECT_TRUE(eventually([&] { return position() > begin + 2 * kNearMs; }));
    EXPECT_TRUE(eventually(isBack)) << "again";
    ASSERT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_OFF));
    EXPECT_TRUE(eventually([&] { return position() > end + kNearMs; }));
}

TEST_F(SpeedTest, OtherMarksAreRefused) {
    checks("setABRepeat", "An E_Orv_AB_Repeat_Type; non-zero for success");
    ORV_OPEN();
    EXPECT_EQ(0, player->setABRepeat(3));
    EXPECT_EQ(0, player->setABRepeat(-1));
}

TEST_F(SpeedTest, ThereIsSomethingToPlay) {
    checks("getBufferPercent", "Percent of the duration that is there to be played");
    ORV_OPEN();
    EXPECT_TRUE(eventually([&] { return player->getBufferPercent() > 0; }));
    EXPECT_LE(player->getBufferPercent(), 100);
}

TEST_F(SpeedTest, TheTimeShiftSettingMayLack) {
    checks("setTS", "False without such a setting");
    ORV_OPEN();
    ORV_NOT_OFFERED_IF(!player->setTS(1), "it has no such setting");
    EXPECT_TRUE(player->setTS(0));
}

TEST_F(SpeedTest, APinHasFourDigits) {
    checks("setUnLockPin", "BAD_VALUE for what is no PIN of four digits");
    const android::status_t status = player->setUnLockPin(-1);
    ORV_NOT_OFFERED_IF(status == android::INVALID_OPERATION, "it locks nothing");
    EXPECT_EQ(BAD_VALUE, status);
    EXPECT_EQ(BAD_VALUE, player->setUnLockPin(10000));
}

}  // namespace
}  // namespace orvkit
