// SPDX-License-Identifier: Apache-2.0
// Places in the media: by time and by byte.
#include <media/MediaTrack.h>

#include "KitTest.h"

using android::BAD_VALUE;
using android::INVALID_OPERATION;
using android::NO_ERROR;

namespace orvkit {
namespace {

using Options = android::MediaTrack::ReadOptions;
constexpr int kBetweenKeysMs = 2000;

class SeekTest : public KitTest {
protected:
    // To the key frame before, as the library asks for it.
    void seek(int msec) {
        const android::status_t status = player->seekTo(msec, Options::SEEK_PREVIOUS_SYNC);
        ORV_NOT_OFFERED_IF(status == INVALID_OPERATION && !player->canDoSeek(0),
                           "it does not seek");
        ASSERT_EQ(NO_ERROR, status) << msec;
    }

    void expectAtKeyBefore(int msec) {
        EXPECT_LE(position(), msec + kNearMs);
        EXPECT_GE(position(), msec - kBetweenKeysMs - kNearMs);
    }
};

TEST_F(SeekTest, ASeekEndsAtThePlace) {
    checks("seekTo", "Blocks until the new position is shown");
    ORV_OPEN();
    seek(kMiddleMs);
    if (IsSkipped() || HasFailure()) return;
    expectAtKeyBefore(kMiddleMs);
    seek(0);
    EXPECT_NEAR(0, position(), kNearMs);
}

TEST_F(SeekTest, AnExactSeekIsExact) {
    checks("seekTo", "a MediaTrack::ReadOptions::SeekMode; BAD_VALUE for others");
    ORV_OPEN();
    ORV_NOT_OFFERED_IF(!player->canDoSeek(0), "it does not seek");
    constexpr int kBetween = kMiddleMs + 1000;
    ASSERT_EQ(NO_ERROR, player->seekTo(kBetween, Options::SEEK_CLOSEST));
    EXPECT_NEAR(kBetween, position(), kNearMs);
}

TEST_F(SeekTest, OtherModesAreRefused) {
    checks("seekTo", "a MediaTrack::ReadOptions::SeekMode; BAD_VALUE for others");
    ORV_OPEN();
    ORV_NOT_OFFERED_IF(!player->canDoSeek(0), "it does not seek");
    EXPECT_EQ(BAD_VALUE, player->seekTo(kMiddleMs, 4));
    EXPECT_EQ(BAD_VALUE, player->seekTo(kMiddleMs, -1));
    EXPECT_NEAR(0, position(), kNearMs);
}

TEST_F(SeekTest, TimesOutsideAreTheEnds) {
    checks("seekTo", "Times outside of the media are their start and end");
    ORV_OPEN();
    seek(kMiddleMs);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->seekTo(-5000, Options::SEEK_CLOSEST));
    EXPECT_NEAR(0, position(), kNearMs);
    ASSERT_EQ(NO_ERROR, player->seekTo(duration() + 5000, Options::SEEK_CLOSEST));
    EXPECT_NEAR(duration(), position(), kNearMs);
}

TEST_F(SeekTest, ASeekAfterTheEndLeadsToPaused) {
    checks("seekTo", "After the end of the media leads to paused");
    ORV_OPEN();
    seek(duration());
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return !player->isPlaying() && position() == duration(); }));
    ASSERT_EQ(NO_ERROR, player->seekTo(kMiddleMs, Options::SEEK_CLOSEST));
    EXPECT_FALSE(player->isPlaying());
    EXPECT_NEAR(kMiddleMs, position(), kNearMs);
    playBeyond(position());
}

TEST_F(SeekTest, PlaybackGoesOnFromThere) {
    checks("seekTo", "Blocks until the new position is shown");
    ORV_OPEN();
    playBeyond(0);
    seek(kMiddleMs);
    if (IsSkipped() || HasFailure()) return;
    EXPECT_GE(position(), kMiddleMs - kBetweenKeysMs - kNearMs);
    const int place = position();
    EXPECT_TRUE(eventually([&] { return position() > place; }));
    EXPECT_TRUE(eventually([&] { return player->isPlaying(); }));
}

TEST_F(SeekTest, SeeksNeedMedia) {
    checks("seekTo", "An operation that its state does not allow");
    EXPECT_EQ(INVALID_OPERATION, player->seekTo(0, Options::SEEK_PREVIOUS_SYNC));
    setSource();
    EXPECT_EQ(INVALID_OPERATION, player->seekTo(0, Options::SEEK_PREVIOUS_SYNC));
}

TEST_F(SeekTest, WhetherItSeeksIsKnown) {
    checks("canDoSeek", "Whether a seek is possible at that speed (0: paused)");
    EXPECT_FALSE(player->canDoSeek(0)) << "without media";
    ORV_OPEN();
    const bool can = player->canDoSeek(0);
    EXPECT_EQ(can, player->seekTo(kMiddleMs, Options::SEEK_PREVIOUS_SYNC) == NO_ERROR);
    ORV_NOT_OFFERED_IF(!can, "it does not seek");
}

TEST_F(SeekTest, BytesGrowWithThePlace) {
    checks("getCurrentBytePosition", "Where the frame of now lies in the media, in bytes");
    ORV_OPEN();
    int early = -1;
    const android::status_t status = player->getCurrentBytePosition(&early);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it knows no bytes");
    ASSERT_EQ(NO_ERROR, status);
    seek(kMiddleMs);
    if (IsSkipped() || HasFailure()) return;
    int late = -1;
    ASSERT_EQ(NO_ERROR, player->getCurrentBytePosition(&late));
    EXPECT_GE(early, 0);
    EXPECT_GT(late, early);
}

TEST_F(SeekTest, AByteLeadsToItsFrame) {
    checks("seekToPosition", "To the frame that the byte belongs to, exactly");
    ORV_OPEN();
    seek(kMiddleMs);
    if (IsSkipped() || HasFailure()) return;
    const int place = position();
    int byte = -1;
    const android::status_t status = player->getCurrentBytePosition(&byte);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it knows no bytes");
    ASSERT_EQ(NO_ERROR, player->seekTo(0, Options::SEEK_PREVIOUS_SYNC));
    ORV_NOT_OFFERED_IF(!player->seekToPosition(static_cast<unsigned>(byte)),
                       "it does not seek to bytes");
    EXPECT_NEAR(place, position(), kNearMs);
}

TEST_F(SeekTest, ABytePastTheMediaIsRefused) {
    checks("seekToPosition", "False outside of the media");
    EXPECT_FALSE(player->seekToPosition(0)) << "without media";
    ORV_OPEN();
    EXPECT_FALSE(player->seekToPosition(1ULL << 40));
    EXPECT_NEAR(0, position(), kNearMs);
}

}  // namespace
}  // namespace orvkit
