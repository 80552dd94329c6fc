// SPDX-License-Identifier: Apache-2.0
#include "PlayerTest.h"

#include <android/log.h>

#include <algorithm>
#include <chrono>
#include <thread>

namespace orvtest {

bool eventually(const std::function<bool()>& condition, int seconds) {
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(seconds);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > deadline) return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    return true;
}

bool remains(const std::function<bool()>& condition) {
    constexpr uint64_t kFrames = 12;
    const android::sp<FrameSink> frames = new FrameSink;
    const android::sp<android::TarnPlayer> other = new android::TarnPlayer(-1);
    other->setVideoSurfaceTexture(frames);
    EXPECT_EQ(android::NO_ERROR, other->setDataSource(mediaPath("silent.mp4").c_str(), nullptr));
    EXPECT_EQ(android::NO_ERROR, other->prepare());
    EXPECT_EQ(android::NO_ERROR, other->setLooping(1));
    EXPECT_EQ(android::NO_ERROR, other->start());
    bool holds = true;
    const auto isOver = [&] {
        holds = condition();
        return !holds || frames->frameCount() >= kFrames;
    };
    EXPECT_TRUE(eventually(isOver, 60)) << "the other player does not play";
    other->release();
    return holds;
}

std::vector<LogLine> complaints(const LogCapture& log) {
    std::vector<LogLine> lines = log.lines("TarnPlayer");
    const auto informs = [](const LogLine& line) { return line.priority < ANDROID_LOG_WARN; };
    lines.erase(std::remove_if(lines.begin(), lines.end(), informs), lines.end());
    return lines;
}

PlayerTest::PlayerTest() {
    player->setNotifyCallback(events);
    player->setVideoSurfaceTexture(sink);
}

PlayerTest::~PlayerTest() { player->release(); }

void PlayerTest::open(const std::string& name) {
    ASSERT_EQ(android::NO_ERROR, player->setDataSource(mediaPath(name).c_str(), nullptr));
    ASSERT_EQ(android::NO_ERROR, player->prepare());
}

void PlayerTest::playToEnd() {
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(events->waitFor(android::MEDIA_PLAYBACK_COMPLETE));
}

int PlayerTest::position() const {
    int msec = -1;
    EXPECT_EQ(android::NO_ERROR, player->getCurrentPosition(&msec));
    return msec;
}

int PlayerTest::duration() const {
    int msec = -1;
    EXPECT_EQ(android::NO_ERROR, player->getDuration(&msec));
    return msec;
}

int PlayerTest::speed() const {
    int speed = -1;
    EXPECT_TRUE(player->getSpeed(speed));
    return speed;
}

}  // namespace orvtest
