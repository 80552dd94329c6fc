// SPDX-License-Identifier: Apache-2.0
// Players that have nothing to do leave the processor alone, and have no threads
// before they have media.
#include <algorithm>
#include <atomic>
#include <filesystem>
#include <fstream>
#include <map>
#include <string>
#include <thread>
#include <vector>

#include "CoreCalls.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

constexpr char kWakeUps[] = "voluntary_ctxt_switches:";

constexpr char kEvents[] = "orv-events";
constexpr char kRendering[] = "orv-render";
const char* const kThreads[] = {kEvents, kRendering, "orv-notify", "mpv/mpv core", "core"};

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

size_t threadsOfPlayers() {
    size_t count = 0;
    for (const char* name : kThreads) count += waitsOf(name).size();
    return count;
}

// A thread that was waited for is in the list for a moment longer.
bool noThreadsAreLeft() {
    return eventually([] { return threadsOfPlayers() == 0; });
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

    static std::vector<sp<TarnPlayer>> newPlayers(size_t count) {
        std::vector<sp<TarnPlayer>> players(count);
        for (auto& player : players) player = new TarnPlayer(-1);
        return players;
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

TEST_F(IdleTest, WithoutAPictureNobodyDraws) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(0, wokenWhileAnotherPlays(kRendering));
}

TEST_F(IdleTest, WithoutASurfaceNobodyDraws) {
    open("short.mp4");
    player->setVideoSurfaceTexture(nullptr);
    ASSERT_EQ(NO_ERROR, player->seekTo(500, 0));
    EXPECT_EQ(0, wokenWhileAnotherPlays(kRendering));
}

TEST_F(IdleTest, WithoutMediaNothingIsReported) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(0, wokenWhileAnotherPlays(kEvents));
}

TEST_F(IdleTest, PlayersWithoutMediaHaveNoThreads) {
    ASSERT_TRUE(noThreadsAreLeft());
    const auto players = newPlayers(50);
    for (const auto& each : players) {
        each->setVideoSurfaceTexture(sink);
        EXPECT_EQ(NO_ERROR, each->setLooping(1));
        EXPECT_EQ(NO_ERROR, each->setVolume(0.5, 0.25));
        EXPECT_EQ(NO_ERROR, each->setPlayerRole(E_ORV_PLAYER_ROLE_SUB));
        EXPECT_EQ(NO_ERROR, each->reset());
        int msec = 0;
        EXPECT_EQ(INVALID_OPERATION, each->getCurrentPosition(&msec));
        EXPECT_EQ(INVALID_OPERATION, each->prepare());
        EXPECT_EQ(INVALID_OPERATION, each->setSpeed(2000));
        EXPECT_FALSE(each->step(1));
    }
    EXPECT_EQ(0u, threadsOfPlayers());
}

TEST_F(IdleTest, VolumeAndRoleWaitForMedia) {
    ASSERT_TRUE(noThreadsAreLeft());
    EXPECT_EQ(NO_ERROR, player->setVolume(0.125, 0.125));
    EXPECT_EQ(NO_ERROR, player->setPlayerRole(E_ORV_PLAYER_ROLE_SUB));
    EXPECT_EQ(0u, threadsOfPlayers());
    open("short.mp4");
    EXPECT_NEAR(50, newestVolume(), 0.01);
    EXPECT_TRUE(newestMute());
    EXPECT_EQ(NO_ERROR, player->setPlayerRole(E_ORV_PLAYER_ROLE_MAIN));
    EXPECT_FALSE(newestMute());
}

TEST_F(IdleTest, MediaBringThreadsAndReleaseEndsThem) {
    ASSERT_TRUE(noThreadsAreLeft());
    open("short.mp4");
    EXPECT_EQ(1u, waitsOf(kEvents).size());
    EXPECT_EQ(1u, waitsOf(kRendering).size());
    EXPECT_EQ(1u, waitsOf("orv-notify").size());
    ASSERT_EQ(NO_ERROR, player->release());
    EXPECT_TRUE(noThreadsAreLeft());
}

TEST_F(IdleTest, SoundAloneNeedsNoThreadThatDraws) {
    ASSERT_TRUE(noThreadsAreLeft());
    open("tone.mp3");
    playToEnd();
    EXPECT_EQ(0u, waitsOf(kRendering).size());
    EXPECT_EQ(1u, waitsOf(kEvents).size());
}

// What was set on a player without media holds for its first ones.
TEST_F(IdleTest, LoopingThatWasSetBeforeTheFirstMediaHolds) {
    ASSERT_EQ(NO_ERROR, player->setLooping(1));
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > duration() / 2; }));
    EXPECT_TRUE(eventually([&] { return position() < duration() / 2; }));
    EXPECT_TRUE(player->isPlaying());
}

// One of several threads' data sources is taken, whoever has mpv made.
TEST_F(IdleTest, OnlyOneOfManyDataSourcesIsTaken) {
    for (int round = 0; round < 30; round++) {
        sp<TarnPlayer> other = new TarnPlayer(-1);
        std::vector<status_t> results(4);
        std::vector<std::thread> threads;
        for (status_t& result : results) {
            threads.emplace_back(
                [&] { result = other->setDataSource(mediaPath("short.mp4").c_str(), nullptr); });
        }
        for (std::thread& thread : threads) thread.join();
        EXPECT_EQ(1, std::count(results.begin(), results.end(), NO_ERROR));
        EXPECT_EQ(3, std::count(results.begin(), results.end(), INVALID_OPERATION));
        EXPECT_TRUE(eventually([] { return waitsOf(kEvents).size() == 1; }));
        if (round % 10 == 0) {
            EXPECT_EQ(NO_ERROR, other->prepare());
        }
        ASSERT_EQ(NO_ERROR, other->release());
    }
    EXPECT_TRUE(noThreadsAreLeft());
}

// A release finds mpv not yet there, being made, or there.
TEST_F(IdleTest, ReleaseWhileMpvIsBeingMadeLeavesNothing) {
    for (int round = 0; round < 60; round++) {
        sp<TarnPlayer> other = new TarnPlayer(-1);
        std::atomic<int> ready{0};
        const auto together = [&ready] {
            for (ready++; ready < 3;) std::this_thread::yield();
        };
        std::thread setting([&] {
            together();
            const status_t status = other->setDataSource(mediaPath("short.mp4").c_str(), nullptr);
            EXPECT_TRUE(status == NO_ERROR || status == INVALID_OPERATION) << status;
        });
        std::thread resetting([&] {
            together();
            other->reset();
            other->setVolume(0.5f, 0.25f);
        });
        together();
        for (int i = 0; i < round * 20; i++) std::this_thread::yield();
        EXPECT_EQ(NO_ERROR, other->release());
        setting.join();
        resetting.join();
        EXPECT_EQ(INVALID_OPERATION, other->setVolume(1, 1));
    }
    EXPECT_TRUE(noThreadsAreLeft());
}

}  // namespace
