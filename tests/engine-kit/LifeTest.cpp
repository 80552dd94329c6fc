// SPDX-License-Identifier: Apache-2.0
// A player's life: idle, prepared, stopped, reset, released.
#include "KitTest.h"

using android::INVALID_OPERATION;
using android::NO_ERROR;

namespace orvkit {
namespace {

class LifeTest : public KitTest {
protected:
    void expectRefusals() {
        int msec = -1;
        EXPECT_EQ(INVALID_OPERATION, player->getCurrentPosition(&msec));
        EXPECT_EQ(INVALID_OPERATION, player->start());
        EXPECT_EQ(INVALID_OPERATION, player->pause());
        EXPECT_EQ(INVALID_OPERATION, player->seekTo(0, 0));
        EXPECT_FALSE(player->isPlaying());
    }
};

TEST_F(LifeTest, ANewPlayerIsIdle) {
    checks("TarnPlayer(decoder)", "the number of the hardware decoder to use, -1 for any");
    expectRefusals();
    EXPECT_EQ(INVALID_OPERATION, player->prepare());
    setSource();
}

TEST_F(LifeTest, PrepareBlocksUntilTheMediaAreReady) {
    checks("prepare", "Blocks until the media is ready");
    setSource();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_FALSE(isReady());
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(0, position());
    EXPECT_FALSE(player->isPlaying());
}

TEST_F(LifeTest, PrepareNeedsASource) {
    checks("prepare", "An operation that its state does not allow");
    EXPECT_EQ(INVALID_OPERATION, player->prepare());
    EXPECT_EQ(INVALID_OPERATION, player->prepareAsync());
}

TEST_F(LifeTest, NoiseIsAnUnknownFormat) {
    checks("prepare", "ORV_ERROR_MALFORMED: unknown format");
    setSource(mediaPath("garbage.bin"));
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(ORV_ERROR_MALFORMED, player->prepare());
}

TEST_F(LifeTest, AnEmptyFileHasACauseOfItsOwn) {
    checks("prepare", "ORV_ERROR_EMPTY: not a single byte");
    setSource(mediaPath("empty.bin"));
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(ORV_ERROR_EMPTY, player->prepare());
}

TEST_F(LifeTest, TheCauseStaysWhereProgramsAskForIt) {
    checks("getCurrentPosition", "the error that ended it in the error state");
    setSource(mediaPath("garbage.bin"));
    if (IsSkipped() || HasFailure()) return;
    const android::status_t cause = player->prepare();
    int msec = -1;
    EXPECT_NE(NO_ERROR, cause);
    EXPECT_EQ(cause, player->getCurrentPosition(&msec));
}

TEST_F(LifeTest, PrepareAsyncIsFollowedByThePosition) {
    checks("prepareAsync", "follow a player by asking for its position");
    setSource();
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->prepareAsync());
    EXPECT_TRUE(eventually([&] { return isReady(); }));
    EXPECT_EQ(0, position());
}

TEST_F(LifeTest, PrepareAsyncFailsThere) {
    checks("prepareAsync", "or ends with the cause");
    setSource(mediaPath("garbage.bin"));
    if (IsSkipped() || HasFailure()) return;
    if (player->prepareAsync() != NO_ERROR) return;
    int msec = -1;
    EXPECT_TRUE(
        eventually([&] { return player->getCurrentPosition(&msec) == ORV_ERROR_MALFORMED; }));
}

TEST_F(LifeTest, AStoppedPlayerCanBePreparedAgain) {
    checks("stop", "The media can be prepared again");
    ORV_OPEN();
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->stop());
    EXPECT_FALSE(player->isPlaying());
    EXPECT_EQ(INVALID_OPERATION, player->start());
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(0, position());
    EXPECT_EQ(NO_ERROR, player->start());
}

TEST_F(LifeTest, StopNeedsMedia) {
    checks("stop", "An operation that its state does not allow");
    EXPECT_EQ(INVALID_OPERATION, player->stop());
}

TEST_F(LifeTest, TheDurationOutlastsAStop) {
    checks("getDuration", "Until reset, when stopped");
    ORV_OPEN();
    const int before = duration();
    ASSERT_EQ(NO_ERROR, player->stop());
    EXPECT_EQ(before, duration());
    ASSERT_EQ(NO_ERROR, player->reset());
    int msec = 0;
    EXPECT_TRUE(player->getDuration(&msec) != NO_ERROR || msec == 0) << msec;
}

TEST_F(LifeTest, ResetLeadsBackToOtherMedia) {
    checks("reset", "leads back to idle from everywhere but released");
    ORV_OPEN();
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->reset());
    expectRefusals();
    ORV_OPEN();
    EXPECT_EQ(0, position());
    EXPECT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(NO_ERROR, player->reset()) << "of an idle player";
}

TEST_F(LifeTest, ResetLeadsOutOfAnError) {
    checks("reset", "leads back to idle from everywhere but released");
    setSource(mediaPath("garbage.bin"));
    if (IsSkipped() || HasFailure()) return;
    EXPECT_NE(NO_ERROR, player->prepare());
    ASSERT_EQ(NO_ERROR, player->reset());
    ORV_OPEN();
    EXPECT_EQ(0, position());
}

TEST_F(LifeTest, NoResetLeadsOutOfARelease) {
    checks("reset", "Waits for a release under way, which leaves it INVALID_OPERATION");
    ORV_OPEN();
    ASSERT_EQ(NO_ERROR, player->release());
    EXPECT_EQ(INVALID_OPERATION, player->reset());
}

TEST_F(LifeTest, ReleaseIsForGood) {
    checks("release", "For good");
    ORV_OPEN();
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_EQ(NO_ERROR, player->release());
    expectRefusals();
    EXPECT_EQ(INVALID_OPERATION, player->setDataSource(film().c_str(), nullptr));
    EXPECT_EQ(INVALID_OPERATION, player->prepare());
}

TEST_F(LifeTest, ReleaseMayComeAgain) {
    checks("release", "May be called again, and by the listener");
    ORV_OPEN();
    EXPECT_EQ(NO_ERROR, player->release());
    EXPECT_EQ(NO_ERROR, player->release());
}

}  // namespace
}  // namespace orvkit
