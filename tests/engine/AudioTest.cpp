// SPDX-License-Identifier: Apache-2.0
// Loudness of the two sides, measured in the samples that would be heard.
#include <gtest/gtest.h>
#include <math.h>
#include <string.h>

#include <algorithm>
#include <chrono>
#include <string>

#include "TestMedia.h"
#include "core/MpvHandle.h"
#include "playback/Audio.h"

using namespace orvtarn;
using namespace orvtest;

namespace {

struct Loudness {
    double left = 0;
    double right = 0;
};

// The loudest samples of two channels of 16 bits.
Loudness loudnessOf(const std::vector<uint8_t>& bytes) {
    Loudness loudness;
    for (size_t at = 0; at + 4 <= bytes.size(); at += 4) {
        int16_t pair[2];
        memcpy(pair, &bytes[at], sizeof(pair));
        loudness.left = std::max(loudness.left, fabs(pair[0]));
        loudness.right = std::max(loudness.right, fabs(pair[1]));
    }
    return loudness;
}

class AudioTest : public testing::Test {
protected:
    AudioTest() {
        EXPECT_TRUE(mpv.create());
        mpv.set("ao", "pcm");
        mpv.set("ao-pcm-file", file);
        mpv.set("ao-pcm-waveheader", false);
        mpv.set("audio-format", "s16");
        mpv.set("audio-channels", "stereo");
        mpv.set("demuxer", "rawaudio");
        mpv.set("demuxer-rawaudio-format", "s16le");
        mpv.set("demuxer-rawaudio-channels", "stereo");
        mpv.set("keep-open", "no");
        mpv.set("gapless-audio", "no");  // each file whole in its own output
    }
    ~AudioTest() override { mpv.destroy(); }

    Loudness play(float left, float right) {
        EXPECT_EQ(0, audio.setVolume(left, right));
        const std::string tone = mediaPath("tone-s16le.pcm");
        const size_t length = bytesOf(tone).size();
        // A busy machine may not drain the output in the time that it is given.
        for (int i = 0; i < 10; i++) {
            std::vector<uint8_t> heard = record(tone);
            if (heard.size() < length) continue;
            heard.resize(length);  // what fills up the last buffer is undefined
            return loudnessOf(heard);
        }
        ADD_FAILURE() << "the output is never whole";
        return {};
    }

    std::vector<uint8_t> record(const std::string& tone) {
        mpv.set("pause", false);
        mpv.command({"loadfile", tone.c_str()});
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(20);
        while (mpv_wait_event(mpv.get(), 1)->event_id != MPV_EVENT_END_FILE) {
            if (std::chrono::steady_clock::now() < deadline) continue;
            ADD_FAILURE() << "the file does not end";
            break;
        }
        return bytesOf(file);
    }

    // Tests run side by side.
    const std::string file = mediaPath(
        std::string(testing::UnitTest::GetInstance()->current_test_info()->name()) + ".pcm");
    MpvHandle mpv;
    VideoOutput video{[] {}, [](uint64_t, int64_t) { return int64_t{0}; },
                      [](bool, const std::function<void()>& change) { change(); }};
    Audio audio{mpv, video};
};

TEST_F(AudioTest, GainsAreLinearAndOfEachSide) {
    const Loudness full = play(1, 1);
    EXPECT_NEAR(full.left, full.right, full.left * 0.01);
    const Loudness half = play(0.5f, 0.5f);
    EXPECT_NEAR(0.5, half.left / full.left, 0.02);
    EXPECT_NEAR(0.5, half.right / full.right, 0.02);
    const Loudness sides = play(0.25f, 0.75f);
    EXPECT_NEAR(0.25, sides.left / full.left, 0.02);
    EXPECT_NEAR(0.75, sides.right / full.right, 0.02);
    const Loudness again = play(1, 1);
    EXPECT_NEAR(1, again.left / full.left, 0.02) << "the balance is gone again";
}

TEST_F(AudioTest, NothingIsSilent) {
    const Loudness silent = play(0, 0);
    EXPECT_EQ(0, silent.left);
    EXPECT_EQ(0, silent.right);
}

TEST_F(AudioTest, OneSideAloneIsHeard) {
    const Loudness right = play(0, 1);
    EXPECT_EQ(0, right.left);
    EXPECT_GT(right.right, 100);
}

TEST_F(AudioTest, TheSubRoleIsSilent) {
    audio.setRole(E_ORV_PLAYER_ROLE_SUB);
    EXPECT_EQ(0, play(1, 1).left);
    audio.setRole(E_ORV_PLAYER_ROLE_MAIN);
    EXPECT_GT(play(1, 1).left, 100);
}

}  // namespace
