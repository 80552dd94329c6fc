// SPDX-License-Identifier: Apache-2.0
// Playlists: the first entry is the media.
#include <orvtarn/PlayerTypes.h>

#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class PlaylistTest : public PlayerTest {
protected:
    void expectNothingGoesOn() {
        const uint64_t frames = sink->frameCount();
        // One may be on its way still.
        EXPECT_TRUE(remains([&] { return sink->frameCount() <= frames + 1; }));
    }
};

TEST_F(PlaylistTest, PlaysTheFirstEntryToItsEnd) {
    open("first-of-two.m3u");
    EXPECT_NEAR(2000, duration(), 50);
    playToEnd();
    EXPECT_EQ(duration(), position());
    EXPECT_EQ(0, events->count(MEDIA_ERROR));
    player->reset();
    expectNothingGoesOn();
    open("short.mp4");
    EXPECT_NEAR(3000, duration(), 50);
}

TEST_F(PlaylistTest, AFirstEntryThatIsMissingIsAnError) {
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("first-missing.m3u").c_str(), nullptr));
    EXPECT_EQ(ORV_ERROR_IO, player->prepare());
    expectNothingGoesOn();
    player->reset();
    open("short.mp4");
    EXPECT_NEAR(3000, duration(), 50);
}

TEST_F(PlaylistTest, WithoutEntriesIsAnError) {
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("nothing.m3u").c_str(), nullptr));
    EXPECT_EQ(ORV_ERROR_MALFORMED, player->prepare());
    player->reset();
    open("short.mp4");
}

}  // namespace
