// SPDX-License-Identifier: Apache-2.0
// Players that have nothing to do leave the processor alone.
#include <filesystem>
#include <fstream>
#include <map>
#include <string>

#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

constexpr char kWakeUps[] = "voluntary_ctxt_switches:";

// How often each thread of the process with that name has waited so far, by its
// number.
std::map<std::string, long> waitsOf(const std::string& name) {
    std::map<std::string, long> waits;
    for (const auto& task : std::filesystem::directory_iterator("/proc/self/task")) {
        std::string line;
        std::getline(std::ifstream(task.path() / "comm"), line);
        if (line != name) continue;
        std::ifstream status(task.path() / "status");
        while (std::getline(status, line)) {
            if (line.rfind(kWakeUps, 0) == 0)
                waits[task.path().filename()] = std::stol(line.substr(sizeof(kWakeUps)));
        }
    }
    return waits;
}

class IdleTest : public PlayerTest {
protected:
    // How many of the threads with that name have woken up while another player
    // played a second of media.
    static int wokenWhileAnotherPlays(const std::string& name) {
        playASecond();  // what was begun before is done by then
        const std::map<std::string, long> before = waitsOf(name);
        EXPECT_FALSE(before.empty());
        playASecond();
        int woken = 0;
        for (const auto& [thread, waits] : waitsOf(name)) {
            const auto earlier = before.find(thread);
            woken += earlier != before.end() && waits != earlier->second;
        }
        return woken;
    }

private:
    static void playASecond() {
        sp<TarnPlayer> other = new TarnPlayer(-1);
        ASSERT_EQ(NO_ERROR, other->setDataSource(mediaPath("long.mkv").c_str(), nullptr));
        ASSERT_EQ(NO_ERROR, other->prepare());
        ASSERT_EQ(NO_ERROR, other->start());
        EXPECT_TRUE(eventually([&] {
            int msec = 0;
            return other->getCurrentPosition(&msec) == NO_ERROR && msec > 1000;
        }));
        other->release();
    }
};

TEST_F(IdleTest, WithoutAPictureNobodyDraws) { EXPECT_EQ(0, wokenWhileAnotherPlays("orv-render")); }

TEST_F(IdleTest, WithoutASurfaceNobodyDraws) {
    open("short.mp4");
    player->setVideoSurfaceTexture(nullptr);
    ASSERT_EQ(NO_ERROR, player->seekTo(500, 0));
    EXPECT_EQ(0, wokenWhileAnotherPlays("orv-render"));
}

TEST_F(IdleTest, WithoutMediaNothingIsReported) {
    EXPECT_EQ(0, wokenWhileAnotherPlays("orv-events"));
}

}  // namespace
