// SPDX-License-Identifier: Apache-2.0
// External subtitle files and timed texts.
#include "JniFixture.h"

namespace orvtest {
namespace {

class SubtitleSourceTest : public JniFixture {
protected:
    Outcome set(jstring url) {
        return call<void>("native_setSubtitleDataSource", "(Ljava/lang/String;)V", url);
    }
    const std::string name = "OrvMediaClient_setSubtitleDataSource";
    const ExpectedLine missing = bridgeError(name + "(): service not exist, error\n");
    const ExpectedLine null = bridgeError(name + "(): url=null, return directly, error!!!!\n");
    ExpectedLine url(const std::string& text) const {
        return bridgeInfo(name + "(): url=" + text + "\n");
    }
};

TEST_F(SubtitleSourceTest, ReachesTheEngineAndIsReleased) {
    setUpPlayer();
    for (int result : {1, 0}) {
        engine->answer("setSubtitleDataSource", {result});
        EXPECT_THAT(set(string("/m/a.srt")),
                    ReturnsNothing()
                        .logs({enter(name), url("/m/a.srt"),
                               serviceInfo("OrvMediaService::setSubtitleDataSource()"),
                               serviceInfo("OrvMediaService::setSubtitleDataSource(): "
                                           "url=/m/a.srt"),
                               leave(name)})
                        .engine({"setSubtitleDataSource(/m/a.srt)"}));
    }
}

TEST_F(SubtitleSourceTest, NullGoesOnToTheServiceWhichRefusesIt) {
    setUpPlayer();
    EXPECT_THAT(set(nullptr),
                ReturnsNothing().logs(
                    {enter(name), null, url("(null)"),
                     serviceInfo("OrvMediaService::setSubtitleDataSource()"),
                     serviceInfo("OrvMediaService::setSubtitleDataSource(): url=(null)"),
                     serviceError("OrvMediaService::setSubtitleDataSource(): url==null, return "
                                  "directly!!!!"),
                     leave(name)}));
}

TEST_F(SubtitleSourceTest, MissingServiceIsLoggedAndTheRestGoesOn) {
    EXPECT_THAT(set(string("/m/a.srt")),
                ReturnsNothing().logs({enter(name), missing, url("/m/a.srt"), leave(name)}));
    EXPECT_THAT(set(nullptr),
                ReturnsNothing().logs({enter(name), missing, null, url("(null)"), leave(name)}));
}

class TwoSubtitleSourcesTest : public JniFixture {
protected:
    Outcome set(jstring sub, jstring idx) {
        return call<void>("native_setSubtitleDataSourceEx",
                          "(Ljava/lang/String;Ljava/lang/String;)V", sub, idx);
    }
    const std::string name = "OrvMediaClient_setSubtitleDataSourceEx";
    const ExpectedLine missing = bridgeError(name + "(): service not exist, error\n");
    const ExpectedLine service = serviceInfo("OrvMediaService::setSubtitleDataSource(): occur");
    ExpectedLine null(const std::string& which) const {
        return bridgeError(name + "(): " + which + "=null, return directly, error!!!!\n");
    }
    ExpectedLine path(const std::string& which, const std::string& text) const {
        return bridgeInfo(name + "(): " + which + "=" + text + "\n");
    }
};

TEST_F(TwoSubtitleSourcesTest, BothReachTheEngineAndAreReleased) {
    setUpPlayer();
    for (int result : {1, 0}) {
        engine->answer("setSubtitleDataSourceEx", {result});
        EXPECT_THAT(set(string("/m/a.sub"), string("/m/a.idx")),
                    ReturnsNothing()
                        .logs({enter(name), path("pszUrlSub", "/m/a.sub"),
                               path("pszUrlIdx", "/m/a.idx"), service, leave(name)})
                        .engine({"setSubtitleDataSourceEx(/m/a.sub, /m/a.idx)"}));
    }
}

TEST_F(TwoSubtitleSourcesTest, NullsReachTheEngine) {
    setUpPlayer();
    EXPECT_THAT(set(nullptr, string("/m/a.idx")),
                ReturnsNothing()
                    .logs({enter(name), null("pszUrlSub"), path("pszUrlSub", "(null)"),
                           path("pszUrlIdx", "/m/a.idx"), service, leave(name)})
                    .engine({"setSubtitleDataSourceEx(null, /m/a.idx)"}));
    EXPECT_THAT(set(string("/m/a.sub"), nullptr),
                ReturnsNothing()
                    .logs({enter(name), path("pszUrlSub", "/m/a.sub"), null("pszUrlIdx"),
                           path("pszUrlIdx", "(null)"), service, leave(name)})
                    .engine({"setSubtitleDataSourceEx(/m/a.sub, null)"}));
}

TEST_F(TwoSubtitleSourcesTest, MissingServiceIsLoggedAndTheRestGoesOn) {
    EXPECT_THAT(
        set(nullptr, string("i")),
        ReturnsNothing().logs({enter(name), missing, null("pszUrlSub"), path("pszUrlSub", "(null)"),
                               path("pszUrlIdx", "i"), leave(name)}));
    EXPECT_THAT(
        set(string("s"), nullptr),
        ReturnsNothing().logs({enter(name), missing, path("pszUrlSub", "s"), null("pszUrlIdx"),
                               path("pszUrlIdx", "(null)"), leave(name)}));
}

class TimedTextSourceTest : public JniFixture {
protected:
    Outcome add(jstring url) {
        return call<jint>("native_addTimedTextSource", "(Ljava/lang/String;)I", url);
    }
    const std::string name = "OrvMediaClient_addTimedTextSource";
    const ExpectedLine trace = bridgeInfo(
        name +
        "(): Test proprietary_tv/open/frameworks/playback/MediaPlayer/jni/OrvMediaClient %d\n");
    const std::vector<ExpectedLine> service = {
        serviceInfo("OrvMediaService::addTimedTextSource path (/m/a.srt)"),
        serviceInfo("OrvMediaService::addTimedTextSource path Test "
                    "proprietary_tv/open/frameworks/playback/MediaPlayer/jni/media-service/"
                    "OrvMediaService 931\n")};

    // One string is never given back for each path that was read.
    void TearDown() override {
        leftUnreleased = {vm.unreleased()};
        JniFixture::TearDown();
    }
};

TEST_F(TimedTextSourceTest, ReachesTheEngineAndIsNotReleased) {
    setUpPlayer();
    EXPECT_THAT(add(string("/m/a.srt")),
                Returns("0")
                    .logs({enter(name), trace, service[0], service[1], leave(name)})
                    .engine({"addTimedTextSource(/m/a.srt)"})
                    .leavesUnreleased({"GetStringUTFChars"}));
}

TEST_F(TimedTextSourceTest, EnginesRefusalIsOnlyLogged) {
    setUpPlayer().answer("addTimedTextSource", {0});
    EXPECT_THAT(add(string("/m/a.srt")),
                Returns("0")
                    .logs({enter(name), trace, service[0], service[1],
                           bridgeInfo(name + "(): service get failed\n"), leave(name)})
                    .engine({"addTimedTextSource(/m/a.srt)"})
                    .leavesUnreleased({"GetStringUTFChars"}));
}

TEST_F(TimedTextSourceTest, MissingServiceIsLoggedAsInfo) {
    EXPECT_THAT(add(string("/m/a.srt")),
                Returns("-1").logs(
                    {enter(name), trace, bridgeInfo(name + "(): service not exist, error\n")}));
}

TEST_F(TimedTextSourceTest, NullIsRefused) {
    setUpPlayer();
    EXPECT_THAT(
        add(nullptr),
        Returns("-1").logs(
            {enter(name), trace, bridgeInfo(name + "(): url=null, return directly, error!!!!\n")}));
}

}  // namespace
}  // namespace orvtest
