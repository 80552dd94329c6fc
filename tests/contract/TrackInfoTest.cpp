// SPDX-License-Identifier: Apache-2.0
// One video codec or subtitle track on its way to its Java callback.
#include "TrackFixture.h"

namespace orvtest {
namespace {

using testing::ElementsAre;

class VideoCodecInfoTest : public JniFixture {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method("setVideoCodecInfo", "(IIIIII)V");
    }
    Outcome get() { return call<jboolean>("native_getVideoCodecInfo", "()Z"); }

    const std::string name = "OrvMediaClient_getVideoCodecInfo";
    const ExpectedLine asked = serviceInfo("OrvMediaService::getVideoCodecInfo()");
};

TEST_F(VideoCodecInfoTest, ReachesJava) {
    setUpPlayer().currentVideoCodec = codec(10);
    EXPECT_THAT(get(), Returns("true")
                           .logs({enter(name), asked, leave(name)})
                           .engine({"getVideoCodecInfo()"})
                           .java({"setVideoCodecInfo(10, 11, 12, 13, 14, -15)"}));
}

TEST_F(VideoCodecInfoTest, IsZeroWhenTheEngineFillsNothing) {
    setUpPlayer().currentVideoCodec = codec(10);
    get();
    engine->currentVideoCodec.reset();
    engine->answer("getVideoCodecInfo", {1});
    poisonStack();
    EXPECT_THAT(get().java, ElementsAre("setVideoCodecInfo(0, 0, 0, 0, 0, 0)"));
}

TEST_F(VideoCodecInfoTest, MissingServiceThrowsNothing) {
    EXPECT_THAT(get(), Returns("false").logs({enter(name), missingServiceLine()}));
}

TEST_F(VideoCodecInfoTest, EnginesRefusalLooksLikeAMissingService) {
    setUpPlayer();
    EXPECT_THAT(get(), Returns("false")
                           .logs({enter(name), asked, missingServiceLine()})
                           .engine({"getVideoCodecInfo()"}));
}

TEST_F(VideoCodecInfoTest, MissingClass) {
    setUpPlayer().currentVideoCodec = codec(10);
    vm.hide(kPlayerClass);
    EXPECT_THAT(get(), Returns("false")
                           .logs({enter(name), asked, classError(name)})
                           .engine({"getVideoCodecInfo()"})
                           .throws(kNoClass, kPlayerClass));
}

TEST_F(VideoCodecInfoTest, MissingMethod) {
    setUpPlayer().currentVideoCodec = codec(10);
    playerClass.remove("setVideoCodecInfo");
    EXPECT_THAT(get(), Returns("false")
                           .logs({enter(name), asked, methodError(name, "setVideoCodecInfo")})
                           .engine({"getVideoCodecInfo()"})
                           .throws(kNoMethod, "setVideoCodecInfo"));
}

class SubtitleTrackInfoTest : public JniFixture {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method("setSubtitleTrackInfo", "(IILjava/lang/String;I)V");
    }
    Outcome get(jint index) { return call<jboolean>("native_getSubtitleTrackInfo", "(I)Z", index); }

    const std::string name = "OrvMediaClient_getSubtitleTrackInfo";
    const ExpectedLine asked = serviceInfo("OrvMediaService::getSubtitleTrackInfo(3)");
};

TEST_F(SubtitleTrackInfoTest, ReachesJava) {
    setUpPlayer().subtitleTracks[3] = subtitle(7,
                                               "fra;Fran\xc3\xa7"
                                               "ais");
    EXPECT_THAT(get(3), Returns("true")
                            .logs({enter(name), asked, leave(name)})
                            .engine({"getSubtitleTrackInfo(3)"})
                            .java({"setSubtitleTrackInfo(7, 8, \"fra;Fran\xc3\xa7"
                                   "ais\", -7)"}));
}

TEST_F(SubtitleTrackInfoTest, IsZeroWhenTheEngineFillsNothing) {
    setUpPlayer().subtitleTracks[3] = subtitle(7, "eng;");
    engine->answer("getSubtitleTrackInfo", {1});
    get(3);
    poisonStack();
    EXPECT_THAT(get(4).java, ElementsAre("setSubtitleTrackInfo(0, 0, \"\", 0)"));
    EXPECT_THAT(engine->receivedSubtitleTracks, ElementsAre(IsZero(), IsZero()));
}

TEST_F(SubtitleTrackInfoTest, IndexIsTheEnginesBusiness) {
    setUpPlayer();
    EXPECT_THAT(get(-1).engine, ElementsAre("getSubtitleTrackInfo(-1)"));
    EXPECT_THAT(get(0x10000).engine, ElementsAre("getSubtitleTrackInfo(65536)"));
}

TEST_F(SubtitleTrackInfoTest, MissingService) {
    EXPECT_THAT(get(3), Returns("false").logs(
                            {enter(name), bridgeError(name + "(): service not exist, error\n")}));
}

TEST_F(SubtitleTrackInfoTest, EnginesRefusal) {
    setUpPlayer();
    EXPECT_THAT(get(3),
                Returns("false")
                    .logs({enter(name), asked, bridgeError(name + "(): service get failed\n")})
                    .engine({"getSubtitleTrackInfo(3)"}));
}

TEST_F(SubtitleTrackInfoTest, MissingClass) {
    setUpPlayer().subtitleTracks[3] = subtitle(7, "");
    vm.hide(kPlayerClass);
    EXPECT_THAT(get(3), Returns("false")
                            .logs({enter(name), asked, classError(name)})
                            .engine({"getSubtitleTrackInfo(3)"})
                            .throws(kNoClass, kPlayerClass));
}

TEST_F(SubtitleTrackInfoTest, MissingMethod) {
    setUpPlayer().subtitleTracks[3] = subtitle(7, "");
    playerClass.remove("setSubtitleTrackInfo");
    EXPECT_THAT(get(3), Returns("false")
                            .logs({enter(name), asked, methodError(name, "setSubtitleTrackInfo")})
                            .engine({"getSubtitleTrackInfo(3)"})
                            .throws(kNoMethod, "setSubtitleTrackInfo"));
}

}  // namespace
}  // namespace orvtest
