// SPDX-License-Identifier: Apache-2.0
// Pictures on a surface of the desktop's; a television's has other operations.
#include <stdlib.h>

#include "FrameSink.h"
#include "KitTest.h"

using android::NO_ERROR;
using orvtest::FrameSink;

namespace orvkit {
namespace {

class SurfaceTest : public KitTest {
protected:
    void openOn(const android::sp<FrameSink>& surface) {
        const android::status_t status = player->setVideoSurfaceTexture(surface);
        ORV_NOT_OFFERED_IF(status == android::INVALID_OPERATION, "it has no surface");
        ASSERT_EQ(NO_ERROR, status);
        ORV_OPEN();
    }

    android::sp<FrameSink> sink = new FrameSink;
};

TEST_F(SurfaceTest, ReadyMeansThatTheFirstFrameIsThere) {
    checks("prepare", "Ready means that the first frame is on the surface");
    openOn(sink);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_GE(sink->frameCount(), 1u);
    EXPECT_NEAR(0, sink->newest().timestampUs, kNearMs * 1000);
}

TEST_F(SurfaceTest, PlayingMovesThePicture) {
    checks("setVideoSurfaceTexture", "Any time; null for none");
    openOn(sink);
    if (IsSkipped() || HasFailure()) return;
    const orvtest::Picture first = sink->newest();
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(sink->waitFor(sink->frameCount() + 2));
    EXPECT_GT(sink->newest().differences(first), 0);
    ASSERT_EQ(NO_ERROR, player->setVideoSurfaceTexture(nullptr));
    playBeyond(position() + kNearMs);
}

TEST_F(SurfaceTest, ANewSurfaceGetsThePictureOfNow) {
    checks("setVideoSurfaceTexture", "the new one gets the picture of now, paused or not");
    openOn(sink);
    if (IsSkipped() || HasFailure()) return;
    const android::sp<FrameSink> other = new FrameSink;
    ASSERT_EQ(NO_ERROR, player->setVideoSurfaceTexture(other));
    EXPECT_TRUE(other->waitFor(0));
    const uint64_t before = sink->frameCount();
    ASSERT_EQ(NO_ERROR, player->start());
    EXPECT_TRUE(other->waitFor(3));
    EXPECT_EQ(before, sink->frameCount()) << "the earlier one gets frames";
}

TEST_F(SurfaceTest, ASeekShowsItsFrame) {
    checks("seekTo", "Blocks until the new position is shown");
    openOn(sink);
    if (IsSkipped() || HasFailure()) return;
    ORV_NOT_OFFERED_IF(!player->canDoSeek(0), "it does not seek");
    ASSERT_EQ(NO_ERROR, player->seekTo(kMiddleMs, 3));
    const int64_t place = position();
    EXPECT_TRUE(eventually([&] {
        return std::abs(sink->newest().timestampUs / 1000 - place) < kNearMs;
    })) << place
        << " and " << sink->newest().timestampUs << " us";
}

TEST_F(SurfaceTest, AReleaseLetsTheSurfaceGo) {
    checks("release", "For good");
    openOn(sink);
    if (IsSkipped() || HasFailure()) return;
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_EQ(NO_ERROR, player->release());
    const uint64_t frames = sink->frameCount();
    EXPECT_TRUE(remains([&] { return sink->frameCount() == frames; }));
    EXPECT_EQ(1, sink->getStrongCount());
}

TEST_F(SurfaceTest, ThereIsNoPictureInTheBackground) {
    checks("setPlayerRole", "E_ORV_PLAYER_ROLE_BACKGROUND: sound only");
    openOn(sink);
    if (IsSkipped() || HasFailure()) return;
    const android::status_t status = player->setPlayerRole(E_ORV_PLAYER_ROLE_BACKGROUND);
    ORV_NOT_OFFERED_IF(status == android::INVALID_OPERATION, "its players have no roles");
    const uint64_t frames = sink->frameCount();
    playBeyond(kNearMs);
    EXPECT_EQ(frames, sink->frameCount());
}

}  // namespace
}  // namespace orvkit
