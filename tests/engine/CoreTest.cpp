// SPDX-License-Identifier: Apache-2.0
// Whether a player gets its playback core, whatever the process is like.
#include <locale.h>
#include <stdlib.h>

#include "CoreCalls.h"
#include "LogCapture.h"
#include "PlayerTest.h"
#include "core/AudioOutputs.h"

using namespace android;
using namespace orvtest;

namespace {

class CoreTest : public PlayerTest {
protected:
    ~CoreTest() override { setlocale(LC_ALL, "C"); }
};

// As a JVM or a toolkit leaves it behind, at any time.
TEST_F(CoreTest, ADecimalCommaDoesNotMatter) {
    setenv("LOCPATH", mediaPath("locale").c_str(), 1);
    const bool set = setlocale(LC_ALL, "de_DE.UTF-8") != nullptr;
    unsetenv("LOCPATH");
    if (!set && sizeof(void*) == 4) GTEST_SKIP() << "no locale of the other machine's making";
    ASSERT_TRUE(set);
    ASSERT_STREQ(",", localeconv()->decimal_point);
    sp<TarnPlayer> other = new TarnPlayer(-1);
    ASSERT_EQ(NO_ERROR, other->setDataSource(mediaPath("feature.mkv").c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, other->prepare());
    EXPECT_EQ(NO_ERROR, other->seekTo(2500, 3));
    int msec = 0;
    EXPECT_EQ(NO_ERROR, other->getCurrentPosition(&msec));
    EXPECT_NEAR(2500, msec, 34);
}

TEST_F(CoreTest, RenderingAsksTheCoreNothing) {
    open("feature.mkv");
    ASSERT_EQ(NO_ERROR, player->seekTo(4000, 0));
    ASSERT_TRUE(sink->waitFor(0, [](const Picture& p) { return p.timestampUs == 4000000; }));
    ASSERT_TRUE(player->step(1));
    ASSERT_EQ(NO_ERROR, player->start());
    ASSERT_TRUE(eventually([&] { return position() > 4500; }));
    EXPECT_EQ(0, questionsWhileRendering());
}

status_t setMedia(TarnPlayer& player) {
    return player.setDataSource(mediaPath("feature.mkv").c_str(), nullptr);
}

bool playsMedia(TarnPlayer& player) {
    return setMedia(player) == NO_ERROR && player.prepare() == NO_ERROR;
}

TEST_F(CoreTest, ThisMachinesCoreTakesEveryOption) {
    LogCapture log;
    sp<TarnPlayer> other = new TarnPlayer(-1);
    EXPECT_EQ(NO_ERROR, setMedia(*other));
    EXPECT_THAT(log.lines("TarnPlayer"), testing::IsEmpty());
    EXPECT_EQ(NO_ERROR, other->prepare());
}

TEST_F(CoreTest, AnOptionThatIsOnlyWishedForCostsALine) {
    LogCapture log;
    UnknownOption unknown("ytdl");
    sp<TarnPlayer> other = new TarnPlayer(-1);
    EXPECT_EQ(NO_ERROR, setMedia(*other));
    EXPECT_THAT(log.lines("TarnPlayer"),
                LinesAre({warning("create: mpv refuses ytdl=no: option not found")}));
    EXPECT_EQ(NO_ERROR, other->prepare());
}

TEST_F(CoreTest, WithoutAnOptionThatIsNeededAPlayerIsAsReleased) {
    LogCapture log;
    UnknownOption unknown("keep-open");
    sp<TarnPlayer> other = new TarnPlayer(-1);
    EXPECT_EQ(INVALID_OPERATION, setMedia(*other));
    EXPECT_THAT(log.lines("TarnPlayer"),
                LinesAre({error("create: mpv refuses keep-open=yes, which is needed: option not "
                                "found")}));
    EXPECT_FALSE(playsMedia(*other));
    EXPECT_EQ(NO_ERROR, other->release());
}

// mpv goes on to the next where nobody listens, and knows no driver of that name
// where it was built without.
TEST_F(CoreTest, PipewireIsTriedWhereItsSocketIs) {
    std::string folder = mediaPath("pipewire-XXXXXX");
    ASSERT_NE(nullptr, mkdtemp(folder.data()));
    setenv("XDG_RUNTIME_DIR", folder.c_str(), 1);
    EXPECT_EQ(0u, orvtarn::audioOutputs().find("pulse,"));
    outputOf("touch '" + folder + "/pipewire-0'");
    EXPECT_EQ(0u, orvtarn::audioOutputs().find("pipewire,pulse,"));
    sp<TarnPlayer> other = new TarnPlayer(-1);
    EXPECT_TRUE(playsMedia(*other));
    setenv("PIPEWIRE_REMOTE", "/nowhere/at/all", 1);
    EXPECT_EQ(0u, orvtarn::audioOutputs().find("pulse,"));
    unsetenv("PIPEWIRE_REMOTE");
    unsetenv("XDG_RUNTIME_DIR");
    outputOf("rm -r '" + folder + "'");
}

TEST_F(CoreTest, SilenceForWantOfADeviceIsReportedOnce) {
    if (orvtarn::audioOutputs().find("alsa") != std::string::npos) {
        GTEST_SKIP() << "this machine has sound cards";
    }
    setenv("PULSE_SERVER", "unix:/nowhere/at/all", 1);
    setenv("PIPEWIRE_REMOTE", "/nowhere/at/all", 1);
    const auto silence = warning("playback: no sound device answers; media plays without sound");
    LogCapture log;
    sp<TarnPlayer> other = new TarnPlayer(-1);
    ASSERT_EQ(NO_ERROR, other->setDataSource(mediaPath("silent.mkv").c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, other->prepare());
    EXPECT_THAT(log.lines("TarnPlayer"), testing::IsEmpty()) << "there is no sound to miss";
    for (int round = 0; round < 2; round++) {
        ASSERT_EQ(NO_ERROR, other->reset());
        ASSERT_TRUE(playsMedia(*other));
        EXPECT_THAT(log.lines("TarnPlayer"), LinesAre({silence}));
    }
    unsetenv("PULSE_SERVER");
    unsetenv("PIPEWIRE_REMOTE");
}

TEST_F(CoreTest, WithoutACoreAPlayerIsAsReleased) {
    LogCapture log;
    NoNewCore failure;
    sp<TarnPlayer> other = new TarnPlayer(-1);
    EXPECT_EQ(INVALID_OPERATION, setMedia(*other));
    EXPECT_THAT(log.lines("TarnPlayer"), LinesAre({error("create: no playback core")}));
    EXPECT_EQ(INVALID_OPERATION, other->reset());
    EXPECT_EQ(INVALID_OPERATION, setMedia(*other)) << "it is not tried again";
    EXPECT_EQ(NO_ERROR, other->release());
}

}  // namespace
