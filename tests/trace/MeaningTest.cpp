// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "Meaning.h"

namespace orvtrace {
namespace {

using Kind = Meaning::Kind;

Meaning meaning(const char* text, char priority = 'I', const char* tag = "OrvMediaClient-JNI") {
    LogLine line;
    line.priority = priority;
    line.tag = tag;
    line.text = text;
    return meaningOf(line);
}

void expectStep(const char* text, Kind kind, const char* name) {
    const Meaning found = meaning(text);
    EXPECT_EQ(found.kind, kind) << text;
    EXPECT_EQ(found.name, name) << text;
}

TEST(MeaningTest, StepsAreNamed) {
    expectStep("OrvMediaClient_start(): Enter", Kind::kEnter, "OrvMediaClient_start");
    expectStep("OrvMediaClient_start(): Leave", Kind::kLeave, "OrvMediaClient_start");
    expectStep("OrvMediaClient_isLooping(): occur", Kind::kOccur, "OrvMediaClient_isLooping");
    expectStep("OrvMediaClient_canDoSeek: occur", Kind::kOccur, "OrvMediaClient_canDoSeek");
    expectStep("OrvMediaClient_setTS()end", Kind::kLeave, "OrvMediaClient_setTS");
    expectStep("getEmbeddedPicture(): return NULL, leave", Kind::kLeave, "getEmbeddedPicture");
    expectStep("SyncToAsync::delMsgHandler(): leave", Kind::kLeave, "SyncToAsync::delMsgHandler");
    expectStep("JavaInputStream::cancelRead Enter", Kind::kEnter, "JavaInputStream::cancelRead");
    expectStep("MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz): Enter",
               Kind::kEnter, "MsgDispatcher::MsgDispatcher");
    expectStep(
        "OrvMediaClient_getAllSubtitleTrackInfo(): subtitle count = 0, no need to fetch "
        "subtitle info",
        Kind::kLeave, "OrvMediaClient_getAllSubtitleTrackInfo");
}

TEST(MeaningTest, UsersTextsAreNoSteps) {
    for (const char* text :
         {"OrvMediaClient_setSubtitleDataSource(): url=a Enter",
          "setSubtitleAttr(): config FLAG, occur", " Enter", "the end", "Leave"}) {
        EXPECT_EQ(meaning(text).kind, Kind::kOther) << text;
    }
}

TEST(MeaningTest, EventsNameTheirPlayer) {
    const Meaning seek = meaning(" MEDIA_SEEK_COMPLETE, this=0x7fAb, Received seek complete", 'I',
                                 "OrvMediaService");
    EXPECT_EQ(seek.event, "MEDIA_SEEK_COMPLETE");
    EXPECT_EQ(seek.player, 0x7fu);
    EXPECT_EQ(seek.mark, Mark::kEvent);
    const Meaning error = meaning("MEDIA_ERROR, this=0x12ab, error (1, 2)", 'E', "OrvMediaService");
    EXPECT_EQ(error.player, 0x12abu);
    EXPECT_EQ(error.mark, Mark::kError);
    EXPECT_FALSE(error.failure);
    EXPECT_EQ(meaning(" this=0x1, callback application", 'I', "OrvMediaService").kind,
              Kind::kEnter);
    EXPECT_EQ(meaning(" this=0x1, back from callback", 'I', "OrvMediaService").kind, Kind::kLeave);
}

TEST(MeaningTest, FailuresAreToldFromReports) {
    EXPECT_EQ(meaning("service not exist, throw exception. Line:3", 'E').mark, Mark::kException);
    EXPECT_TRUE(meaning("OrvMediaClient_reset(): jniThrowException").failure);
    EXPECT_TRUE(meaning("OrvMediaClient_setABRepeat(): service get failed").failure);
    EXPECT_FALSE(meaning("OrvMediaClient_getAllAudioTrackInfo(): mLanguage", 'E').failure);
    EXPECT_FALSE(meaning("OrvMediaService::getDuration(): 3000", 'E', "OrvMediaService").failure);
    EXPECT_FALSE(meaning("width_new :320", 'E').failure);
    EXPECT_EQ(meaning("anything", 'W', "TarnPlayer").mark, Mark::kWarning);
}

TEST(MeaningTest, TagsOfOthersAreNotOurs) {
    for (const char* tag : {"OrvMediaClient-JNI", "OrvMediaService", "ORV::SyncToAsync",
                            "Customer_media_Utils", "TarnPlayer"}) {
        EXPECT_TRUE(isOurs(tag));
    }
    for (const char* tag : {"", "OrvMediaClient", "OrvMediaServices", "SurfaceFlinger"}) {
        EXPECT_FALSE(isOurs(tag));
    }
}

}  // namespace
}  // namespace orvtrace
