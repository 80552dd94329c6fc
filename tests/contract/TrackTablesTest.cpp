// SPDX-License-Identifier: Apache-2.0
// The tables of subtitle and video tracks on their way to the Java callbacks.
#include "TrackFixture.h"

namespace orvtest {
namespace {

using testing::ElementsAre;

class AllSubtitleTrackInfoTest : public TrackTableTest {
protected:
    AllSubtitleTrackInfoTest()
        : TrackTableTest("OrvMediaClient_getAllSubtitleTrackInfo", "getSubtitleTrackCount") {}
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method("setAllSubtitleTrackInfo", "(IIIILjava/lang/String;I)V");
    }
    Outcome getAll() { return call<jint>("native_getAllSubtitleTrackInfo", "()I"); }
    ExpectedLine asked(int index) const {
        return serviceInfo("OrvMediaService::getSubtitleTrackInfo(" + std::to_string(index) + ")");
    }
};

TEST_F(AllSubtitleTrackInfoTest, EveryEntryReachesJava) {
    setUpPlayer().put("getSubtitleTrackCount", 2);
    engine->subtitleTracks = {{0, subtitle(7, "eng;")}, {1, subtitle(20, "")}};
    EXPECT_THAT(getAll(),
                Returns("2")
                    .logs({enter(name), counted, line("subtitle count = 2\n"), asked(0), asked(1),
                           leave(name)})
                    .engine({countCall, "getSubtitleTrackInfo(0)", "getSubtitleTrackInfo(1)"})
                    .java({"setAllSubtitleTrackInfo(2, 0, 7, 8, \"eng;\", -7)",
                           "setAllSubtitleTrackInfo(2, 1, 20, 21, \"\", -20)"}));
}

TEST_F(AllSubtitleTrackInfoTest, UnreadableEntryIsSentEmptyAndTheRestGoesOn) {
    setUpPlayer().put("getSubtitleTrackCount", 4);
    engine->subtitleTracks = {{0, subtitle(1, "a")}, {1, subtitle(2, "b")}, {3, subtitle(4, "d")}};
    poisonStack();
    EXPECT_THAT(
        getAll(),
        Returns("4")
            .logs({enter(name), counted, line("subtitle count = 4\n"), asked(0), asked(1), asked(2),
                   failure("getSubtitleTrackInfo(2), service get failed\n"), asked(3), leave(name)})
            .engine({countCall, "getSubtitleTrackInfo(0)", "getSubtitleTrackInfo(1)",
                     "getSubtitleTrackInfo(2)", "getSubtitleTrackInfo(3)"})
            .java({"setAllSubtitleTrackInfo(4, 0, 1, 2, \"a\", -1)",
                   "setAllSubtitleTrackInfo(4, 1, 2, 3, \"b\", -2)",
                   "setAllSubtitleTrackInfo(4, 2, 0, 0, \"\", 0)",
                   "setAllSubtitleTrackInfo(4, 3, 4, 5, \"d\", -4)"}));
}

TEST_F(AllSubtitleTrackInfoTest, WhatTheEngineLeftInAnUnreadableEntryIsNotSent) {
    setUpPlayer().put("getSubtitleTrackCount", 2);
    engine->subtitleTracks = {{0, subtitle(7, "half")}, {1, subtitle(9, "whole")}};
    engine->answer("getSubtitleTrackInfo", {0, 1});  // both are written
    EXPECT_THAT(getAll().java, ElementsAre("setAllSubtitleTrackInfo(2, 0, 0, 0, \"\", 0)",
                                           "setAllSubtitleTrackInfo(2, 1, 9, 10, \"whole\", -9)"));
}

TEST_F(AllSubtitleTrackInfoTest, EngineGetsAFreshRecordForEveryEntry) {
    setUpPlayer().put("getSubtitleTrackCount", 2);
    engine->subtitleTracks = {{0, subtitle(7, "eng;")}};
    engine->answer("getSubtitleTrackInfo", {1});  // also without a record to hand out
    poisonStack();
    EXPECT_THAT(getAll().java, ElementsAre("setAllSubtitleTrackInfo(2, 0, 7, 8, \"eng;\", -7)",
                                           "setAllSubtitleTrackInfo(2, 1, 0, 0, \"\", 0)"));
    EXPECT_THAT(engine->receivedSubtitleTracks, ElementsAre(IsZero(), IsZero()));
}

TEST_F(AllSubtitleTrackInfoTest, NoTracks) {
    setUpPlayer().put("getSubtitleTrackCount", 0);
    EXPECT_THAT(getAll(), Returns("0")
                              .logs({enter(name), counted, line("subtitle count = 0\n"),
                                     line("subtitle count = 0, no need to fetch subtitle info\n")})
                              .engine({countCall}));
}

TEST_F(AllSubtitleTrackInfoTest, CountStartsFromZero) {
    setUpPlayer();  // the engine writes no count
    EXPECT_EQ(getAll().returned, "0");
}

TEST_F(AllSubtitleTrackInfoTest, MissingService) {
    EXPECT_THAT(getAll(), Returns("-1").logs({enter(name), failure("service not exist, error\n")}));
}

TEST_F(AllSubtitleTrackInfoTest, CountFailed) {
    setUpPlayer().answer("getSubtitleTrackCount", {0});
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted,
                                     failure("getSubtitleTrackCount(), service get failed\n")})
                              .engine({countCall}));
}

TEST_F(AllSubtitleTrackInfoTest, MissingClass) {
    setUpPlayer().put("getSubtitleTrackCount", 1);
    vm.hide(kPlayerClass);
    EXPECT_THAT(getAll(),
                Returns("-1")
                    .logs({enter(name), counted, line("subtitle count = 1\n"), classError(name)})
                    .engine({countCall})
                    .throws(kNoClass, kPlayerClass));
}

TEST_F(AllSubtitleTrackInfoTest, MissingMethod) {
    setUpPlayer().put("getSubtitleTrackCount", 1);
    playerClass.remove("setAllSubtitleTrackInfo");
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted, line("subtitle count = 1\n"),
                                     methodError(name, "getAllSubtitleTrackInfo")})
                              .engine({countCall})
                              .throws(kNoMethod, "setAllSubtitleTrackInfo"));
}

class AllVideoTrackInfoTest : public TrackTableTest {
protected:
    AllVideoTrackInfoTest()
        : TrackTableTest("OrvMediaClient_getAllVideoTrackInfo", "getVideoTrackCount") {}
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method("setAllVideoCodecInfo", "(IIIIIIII)V");
    }
    Outcome getAll() { return call<jint>("native_getAllVideoTrackInfo", "()I"); }

    const ExpectedLine asked = serviceInfo("OrvMediaService::getVideoCodecInfo()");
};

TEST_F(AllVideoTrackInfoTest, EveryEntryReachesJava) {
    setUpPlayer().put("getVideoTrackCount", 2);
    engine->videoCodecs = {{0, codec(10)}, {1, codec(20)}};
    EXPECT_THAT(getAll(),
                Returns("0")
                    .logs({enter(name), counted, line(" count = 2\n"), asked, asked, leave(name)})
                    .engine({countCall, "getVideoCodecInfo(0)", "getVideoCodecInfo(1)"})
                    .java({"setAllVideoCodecInfo(2, 0, 10, 11, 12, 13, 14, -15)",
                           "setAllVideoCodecInfo(2, 1, 20, 21, 22, 23, 24, -25)"}));
}

TEST_F(AllVideoTrackInfoTest, UnreadableEntryEndsTheTable) {
    setUpPlayer().put("getVideoTrackCount", 3);
    engine->videoCodecs = {{0, codec(10)}, {2, codec(30)}};
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted, line(" count = 3\n"), asked, asked,
                                     failure("service get failed\n")})
                              .engine({countCall, "getVideoCodecInfo(0)", "getVideoCodecInfo(1)"})
                              .java({"setAllVideoCodecInfo(3, 0, 10, 11, 12, 13, 14, -15)"}));
}

TEST_F(AllVideoTrackInfoTest, EngineGetsAFreshRecordForEveryEntry) {
    setUpPlayer().put("getVideoTrackCount", 2);
    engine->videoCodecs = {{0, codec(10)}};
    engine->answer("getVideoCodecInfo", {1});  // also without a record to hand out
    EXPECT_THAT(getAll().java, ElementsAre("setAllVideoCodecInfo(2, 0, 10, 11, 12, 13, 14, -15)",
                                           "setAllVideoCodecInfo(2, 1, 0, 0, 0, 0, 0, 0)"));
}

TEST_F(AllVideoTrackInfoTest, NoTracks) {
    setUpPlayer();
    EXPECT_THAT(getAll(), Returns("0")
                              .logs({enter(name), counted, line(" count = 0\n"),
                                     line(" count = 0, no need to fetch subtitle info\n")})
                              .engine({countCall}));
}

TEST_F(AllVideoTrackInfoTest, MissingServiceThrowsNothing) {
    EXPECT_THAT(getAll(), Returns("0").logs({enter(name), missingServiceLine()}));
}

TEST_F(AllVideoTrackInfoTest, CountFailed) {
    setUpPlayer().answer("getVideoTrackCount", {0});
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted,
                                     failure("getVideoTrackCount(), service get failed\n")})
                              .engine({countCall}));
}

TEST_F(AllVideoTrackInfoTest, MissingClassIsReportedUnderAnotherName) {
    setUpPlayer().put("getVideoTrackCount", 1);
    vm.hide(kPlayerClass);
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted, line(" count = 1\n"),
                                     classError("OrvMediaClient_getVideoCodecInfo")})
                              .engine({countCall})
                              .throws(kNoClass, kPlayerClass));
}

TEST_F(AllVideoTrackInfoTest, MissingMethod) {
    setUpPlayer().put("getVideoTrackCount", 1);
    playerClass.remove("setAllVideoCodecInfo");
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted, line(" count = 1\n"),
                                     methodError(name, "setVideoCodecInfo")})
                              .engine({countCall})
                              .throws(kNoMethod, "setAllVideoCodecInfo"));
}

}  // namespace
}  // namespace orvtest
