// SPDX-License-Identifier: Apache-2.0
// A core that refuses: the operation says so, the player stays as it was, and does the
// same operation when it is asked again.
#include <binder/Parcel.h>
#include <media/MediaTrack.h>
#include <orvtarn/Parameters.h>
#include <orvtarn/PlayerTypes.h>
#include <utils/String16.h>

#include <filesystem>

#include "CoreCalls.h"
#include "LogCapture.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class RefusalTest : public PlayerTest {
protected:
    status_t seekTo(int msec) {
        return player->seekTo(msec, MediaTrack::ReadOptions::SEEK_CLOSEST);
    }
    status_t setInt32(int key, int32_t value) {
        Parcel request;
        request.writeInt32(value);
        request.setDataPosition(0);
        return player->setParameter(key, request);
    }
    int subtitleTrack() {
        int index = -2;
        EXPECT_NE(0, player->getCurrentSubtitleIndex(&index));
        return index;
    }
    status_t setEncoding(const char* name) {
        Parcel request;
        request.writeString16(String16(name));
        request.setDataPosition(0);
        return player->setParameter(ORV_PARAMETER_SUBTITLE_ENCODING, request);
    }
};

TEST_F(RefusalTest, ALoadIsAnErrorOfThatMedia) {
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("short.mp4").c_str(), nullptr));
    {
        LogCapture log;
        RefusedCommand refused("loadfile");
        EXPECT_EQ(UNKNOWN_ERROR, player->prepare());
        EXPECT_THAT(log.lines("TarnPlayer"),
                    LinesAre({error("prepare: error running command (status -2147483648)")}));
    }
    int msec = 0;
    EXPECT_EQ(UNKNOWN_ERROR, player->getCurrentPosition(&msec));
    EXPECT_EQ(INVALID_OPERATION, player->start());
    ASSERT_EQ(NO_ERROR, player->reset());
    open("short.mp4");
}

TEST_F(RefusalTest, ASeekLeavesThePosition) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, seekTo(500));
    ASSERT_TRUE(events->waitFor(MEDIA_SEEK_COMPLETE));
    {
        RefusedCommand refused("seek");
        EXPECT_EQ(INVALID_OPERATION, seekTo(1500));
        EXPECT_FALSE(player->seekToPosition(1000));
        EXPECT_EQ(500, position());
        EXPECT_FALSE(player->step(-1));
    }
    EXPECT_EQ(500, position());
    EXPECT_EQ(NO_ERROR, seekTo(1500));
    EXPECT_EQ(1500, position());
    ASSERT_TRUE(events->waitFor(MEDIA_SEEK_COMPLETE, 2));
    EXPECT_EQ(2, events->count(MEDIA_SEEK_COMPLETE)) << "of those that were done";
}

// The seek that goes with it is not waited for later.
TEST_F(RefusalTest, AStartAfterTheEndLeavesSeeksPossible) {
    open("silent.mp4");
    playToEnd();
    {
        RefusedCommand refused("seek");
        EXPECT_EQ(NO_ERROR, player->start());
    }
    EXPECT_EQ(NO_ERROR, seekTo(1000));
    EXPECT_TRUE(events->waitFor(MEDIA_PLAYBACK_COMPLETE, 2));
}

TEST_F(RefusalTest, AStepLeavesThePosition) {
    open("short.mp4");
    ASSERT_EQ(NO_ERROR, seekTo(500));
    {
        RefusedCommand refused("frame-step");
        EXPECT_FALSE(player->step(1));
        EXPECT_EQ(500, position());
    }
    EXPECT_TRUE(player->step(1));
    EXPECT_EQ(533, position());
}

TEST_F(RefusalTest, ASpeedStaysTheOneBefore) {
    open("short.mp4");
    for (const char* property : {"framedrop", "speed"}) {
        SCOPED_TRACE(property);
        RefusedProperty refused(property);
        EXPECT_EQ(UNKNOWN_ERROR, player->setSpeed(2000));
        EXPECT_EQ(1000, speed());
    }
    EXPECT_EQ(NO_ERROR, player->setSpeed(2000));
    EXPECT_EQ(2000, speed());
}

TEST_F(RefusalTest, ADirectionStaysTheOneBefore) {
    open("short.mp4");
    // At the very start backward play needs no other direction.
    ASSERT_EQ(NO_ERROR, player->seekTo(1500, 3));
    {
        RefusedProperty refused("play-direction");
        EXPECT_EQ(INVALID_OPERATION, player->setSpeed(-1000));
    }
    EXPECT_EQ(1000, speed());
    EXPECT_EQ(NO_ERROR, player->setSpeed(-1000));
    EXPECT_EQ(-1000, speed());
}

TEST_F(RefusalTest, AVolumeIsAnError) {
    open("short.mp4");
    for (const char* property : {"volume", "af"}) {
        SCOPED_TRACE(property);
        RefusedProperty refused(property);
        EXPECT_EQ(UNKNOWN_ERROR, player->setVolume(0.5f, 0.25f));
    }
    EXPECT_EQ(NO_ERROR, player->setVolume(0.5f, 0.25f));
}

TEST_F(RefusalTest, ATrackStaysTheOneBefore) {
    open("tracks.mkv");
    {
        RefusedProperty refused("sid");
        EXPECT_FALSE(player->onSubtitleTrack(0));
    }
    EXPECT_EQ(-1, subtitleTrack());
    EXPECT_TRUE(player->onSubtitleTrack(0));
    {
        RefusedProperty refused("sid");
        EXPECT_FALSE(player->offSubtitleTrack());
    }
    EXPECT_EQ(0, subtitleTrack());
}

TEST_F(RefusalTest, ASectionIsRefused) {
    open("short.mp4");
    {
        RefusedProperty refused("ab-loop-a");
        EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    }
    EXPECT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_A));
    ASSERT_EQ(NO_ERROR, seekTo(1000));
    {
        RefusedProperty refused("ab-loop-b");
        EXPECT_EQ(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B));
    }
    EXPECT_NE(0, player->setABRepeat(E_ORV_AB_REPEAT_SET_B));
}

TEST_F(RefusalTest, AParameterIsAnError) {
    for (const auto& [property, key, value] :
         {std::tuple("network-timeout", ORV_PARAMETER_NETWORK_TIMEOUT, 5000),
          std::tuple("keepaspect", ORV_PARAMETER_KEEP_ASPECT, 0)}) {
        SCOPED_TRACE(property);
        RefusedProperty refused(property);
        EXPECT_EQ(UNKNOWN_ERROR, setInt32(key, value));
    }
    {
        RefusedProperty refused("sub-codepage");
        EXPECT_EQ(UNKNOWN_ERROR, setEncoding("utf-8"));
    }
    EXPECT_EQ(NO_ERROR, setInt32(ORV_PARAMETER_KEEP_ASPECT, 0));
    EXPECT_EQ(NO_ERROR, setEncoding("utf-8"));
}

TEST_F(RefusalTest, ASubtitleFileIsLeftOut) {
    LogCapture log;
    RefusedCommand refused("sub-add");
    const std::string file = std::filesystem::canonical(mediaPath("lines.srt"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("silent.mp4").c_str(), nullptr));
    EXPECT_TRUE(player->setSubtitleDataSource(file.c_str()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    int count = -1;
    EXPECT_TRUE(player->getSubtitleTrackCount(count));
    EXPECT_EQ(0, count);
    EXPECT_THAT(complaints(log), LinesAre({error(("prepare: no subtitles from " + file).c_str())}));
}

}  // namespace
