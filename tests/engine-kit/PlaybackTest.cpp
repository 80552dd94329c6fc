// SPDX-License-Identifier: Apache-2.0
// Starting, pausing, the end of the media, and what outlasts a reset.
#include <cmath>

#include "KitTest.h"

using android::BAD_VALUE;
using android::INVALID_OPERATION;
using android::MEDIA_PLAYBACK_COMPLETE;
using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kBeforeEndMs = 300;  // what is left to play before the end

class PlaybackTest : public KitTest {
protected:
    // Engines without seeks reach the end by playing all of it.
    void playToEnd() {
        player->seekTo(duration() - kBeforeEndMs, 0);
        ASSERT_EQ(NO_ERROR, player->start());
        ASSERT_TRUE(eventually([&] { return !player->isPlaying() && position() == duration(); }));
    }
};

TEST_F(PlaybackTest, StartPlays) {
    checks("start", "A player is idle, initialized (setDataSource)");
    ORV_OPEN();
    playBeyond(kNearMs);
    EXPECT_TRUE(player->isPlaying());
    EXPECT_EQ(NO_ERROR, player->start()) << "once more";
}

TEST_F(PlaybackTest, StartNeedsMedia) {
    checks("start", "An operation that its state does not allow");
    EXPECT_EQ(INVALID_OPERATION, player->start());
    setSource();
    EXPECT_EQ(INVALID_OPERATION, player->start());
}

TEST_F(PlaybackTest, StartAfterTheEndPlaysAgain) {
    checks("start", "After the end of the media plays them again");
    ORV_OPEN();
    playToEnd();
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return player->isPlaying() && position() < kMiddleMs; }));
}

TEST_F(PlaybackTest, StartAtTheEndCompletesAtOnce) {
    checks("start", "At the end without having played, completes at once");
    ORV_OPEN();
    ORV_NOT_OFFERED_IF(!player->canDoSeek(0), "it does not seek");
    ASSERT_EQ(NO_ERROR, player->seekTo(duration(), 3));
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE));
    EXPECT_FALSE(player->isPlaying());
}

TEST_F(PlaybackTest, PauseHolds) {
    checks("pause", "A player is idle, initialized (setDataSource)");
    ORV_OPEN();
    playBeyond(kNearMs);
    ASSERT_EQ(NO_ERROR, player->pause());
    EXPECT_FALSE(player->isPlaying());
    const int stands = position();
    EXPECT_TRUE(remains([&] { return position() == stands; })) << stands << " to " << position();
    playBeyond(stands + kNearMs);
}

TEST_F(PlaybackTest, PauseNeedsMedia) {
    checks("pause", "An operation that its state does not allow");
    EXPECT_EQ(INVALID_OPERATION, player->pause());
    setSource();
    EXPECT_EQ(INVALID_OPERATION, player->pause());
}

TEST_F(PlaybackTest, IsPlayingGoesFromStartToPause) {
    checks("isPlaying", "True from start to pause, stop, the end or an error");
    ORV_OPEN();
    EXPECT_FALSE(player->isPlaying());
    playBeyond(0);
    EXPECT_TRUE(eventually([&] { return player->isPlaying(); }));
    ASSERT_EQ(NO_ERROR, player->pause());
    EXPECT_FALSE(player->isPlaying());
    playToEnd();
    ASSERT_EQ(NO_ERROR, player->stop());
    EXPECT_FALSE(player->isPlaying());
}

TEST_F(PlaybackTest, ThePositionNeedsPreparedMedia) {
    checks("getCurrentPosition", "INVALID_OPERATION before the media is prepared");
    int msec = -1;
    EXPECT_EQ(INVALID_OPERATION, player->getCurrentPosition(&msec));
    setSource();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_EQ(INVALID_OPERATION, player->getCurrentPosition(&msec));
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(0, position());
}

TEST_F(PlaybackTest, AtTheEndThePositionIsTheDuration) {
    checks("getCurrentPosition", "the position is the duration and isPlaying is false");
    ORV_OPEN();
    playToEnd();
    EXPECT_EQ(duration(), position());
    EXPECT_TRUE(remains([&] { return position() == duration() && !player->isPlaying(); }));
}

TEST_F(PlaybackTest, LoopingOutlastsAReset) {
    checks("setLooping", "Surface, volume, looping, role and parameters outlast a reset");
    const android::status_t status = player->setLooping(1);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it does not loop");
    ASSERT_EQ(NO_ERROR, status);
    ORV_OPEN();
    ASSERT_EQ(NO_ERROR, player->reset());
    ORV_OPEN();
    ORV_NOT_OFFERED_IF(!player->canDoSeek(0), "it does not seek");
    ASSERT_EQ(NO_ERROR, player->seekTo(duration() - kBeforeEndMs, 0));
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(eventually([&] { return position() < kMiddleMs; }));
    EXPECT_TRUE(eventually([&] { return player->isPlaying(); }));
    EXPECT_EQ(0, events->count(MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(PlaybackTest, VolumesAreGains) {
    checks("setVolume", "Linear gains from 0 to 1");
    const android::status_t status = player->setVolume(1, 1);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it sets no volume");
    EXPECT_EQ(NO_ERROR, status);
    ORV_OPEN();
    EXPECT_EQ(NO_ERROR, player->setVolume(0, 0.5f));
    EXPECT_EQ(BAD_VALUE, player->setVolume(NAN, 1));
    EXPECT_EQ(BAD_VALUE, player->setVolume(1, NAN));
}

TEST_F(PlaybackTest, ThereAreThreeRoles) {
    checks("setPlayerRole", "A player is idle, initialized (setDataSource)");
    const android::status_t status = player->setPlayerRole(E_ORV_PLAYER_ROLE_MAIN);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "its players have no roles");
    ORV_OPEN();
    for (const auto role :
         {E_ORV_PLAYER_ROLE_SUB, E_ORV_PLAYER_ROLE_BACKGROUND, E_ORV_PLAYER_ROLE_MAIN}) {
        EXPECT_EQ(NO_ERROR, player->setPlayerRole(role)) << role;
        playBeyond(position());
    }
}

}  // namespace
}  // namespace orvkit
