// SPDX-License-Identifier: Apache-2.0
// The service's life, its own settings, and operations with a rule of their own.
#include <binder/Parcel.h>
#include <jni/media-service/OrvMediaServiceListener.h>
#include <string.h>

#include "ServiceFixture.h"

namespace orvtest {
namespace {

using android::KeyedVector;
using android::sp;
using android::String8;
using android::TarnPlayer;
using testing::ElementsAre;

class OrvMediaServiceTest : public ServiceFixture {};

TEST_F(OrvMediaServiceTest, LogsItsConstruction) {
    sp<android::OrvMediaService> other = new android::OrvMediaService;
    EXPECT_THAT(log.take(),
                LinesAre({info("OrvMediaService::OrvMediaService()").tagged("OrvMediaService")}));
    EXPECT_FALSE(other->isPlayerExists());
}

TEST_F(OrvMediaServiceTest, DestructionWithoutPlayerTouchesNoEngine) {
    service.clear();
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::~OrvMediaService()")}));
    EXPECT_TRUE(ScriptedEngine::all().empty());
}

TEST_F(OrvMediaServiceTest, AttachInstallsTheServicesOwnListener) {
    EXPECT_EQ(service->attachPlayer(new TarnPlayer(-1)), android::NO_ERROR);
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::attachPlayer(player)")}));
    EXPECT_TRUE(service->isPlayerExists());
    EXPECT_NE(ScriptedEngine::last()->listener(), nullptr);
    EXPECT_TRUE(ScriptedEngine::last()->calls().empty());
}

TEST_F(OrvMediaServiceTest, AttachReplacesAndDropsTheEarlierPlayer) {
    attachPlayer();
    const auto first = engine;
    const auto listener = first->listener();
    attachPlayer();
    EXPECT_FALSE(first->alive());
    EXPECT_TRUE(engine->alive());
    EXPECT_EQ(engine->listener(), listener);
    EXPECT_EQ(service->start(), android::NO_ERROR);
    EXPECT_THAT(engine->calls(), ElementsAre("start()"));
    EXPECT_TRUE(first->calls().empty());
}

TEST_F(OrvMediaServiceTest, DestructionTakesTheListenerBackAndDropsThePlayer) {
    attachPlayer();
    sp<TarnPlayer> kept = engine->player();
    service.clear();
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::~OrvMediaService()"),
                                      info("setNotifyCallback").tagged("OrvMediaService")}));
    EXPECT_EQ(engine->listener(), nullptr);
    EXPECT_EQ(kept->getStrongCount(), 1);
    kept.clear();
    EXPECT_EQ(ScriptedEngine::live(), 0);
}

TEST_F(OrvMediaServiceTest, ReleaseAndResetKeepThePlayer) {
    attachPlayer();
    service->reset();
    service->release();
    EXPECT_TRUE(service->isPlayerExists());
    EXPECT_THAT(engine->calls(), ElementsAre("reset()", "release()"));
}

TEST_F(OrvMediaServiceTest, DisconnectOnlyLogs) {
    attachPlayer();
    service->disconnect();
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::disconnect()")}));
    EXPECT_TRUE(service->isPlayerExists());
    EXPECT_TRUE(engine->calls().empty());
}

class SilentListener : public android::OrvMediaServiceListener {
public:
    void notify(int, int, int, const android::Parcel*) override {}
};

TEST_F(OrvMediaServiceTest, ListenerIsHeldUntilItIsReplacedOrTheServiceGoes) {
    sp<SilentListener> first = new SilentListener;
    sp<SilentListener> second = new SilentListener;
    EXPECT_EQ(service->setListener(first), android::NO_ERROR);
    EXPECT_EQ(first->getStrongCount(), 2);
    EXPECT_EQ(service->setListener(second), android::NO_ERROR);
    EXPECT_EQ(first->getStrongCount(), 1);
    EXPECT_EQ(service->setListener(nullptr), android::NO_ERROR);
    EXPECT_EQ(second->getStrongCount(), 1);
    service->setListener(first);
    EXPECT_THAT(log.take(),
                LinesAre(std::vector<ExpectedLine>(4, info("OrvMediaService::setListener()"))));
    service.clear();
    EXPECT_EQ(first->getStrongCount(), 1);
}

// Which urls are announced to the engine as stereoscopic stream files.
struct SsifCase {
    const char* url;
    bool ssif;
};
void PrintTo(const SsifCase& one, std::ostream* out) {
    *out << (one.url == nullptr ? "null" : one.url);
}

class SsifUrlTest : public ServiceFixture, public testing::WithParamInterface<SsifCase> {};

TEST_P(SsifUrlTest, ConfiguresTheEngineBeforeTheSource) {
    attachPlayer();
    const std::string url = GetParam().url;
    EXPECT_EQ(service->setDataSource(url.c_str(), nullptr), android::NO_ERROR);
    std::vector<std::string> expected = {"configPlayer(false)"};
    if (GetParam().ssif) expected.push_back("configPlayer(true)");
    expected.push_back("setDataSource(" + url + ", null)");
    EXPECT_EQ(engine->calls(), expected);
}

INSTANTIATE_TEST_SUITE_P(Urls, SsifUrlTest,
                         testing::Values(SsifCase{"/m/a.ssif", true}, SsifCase{"/m/a.SSIF", true},
                                         SsifCase{"/m/a.sSiF", true}, SsifCase{"/.ssif", true},
                                         SsifCase{"m/a.ssif", false},
                                         SsifCase{"http://x/a.ssif", false},
                                         SsifCase{".ssif", false}, SsifCase{"/ssif", false},
                                         SsifCase{"/m/assif", false}, SsifCase{"/m/a.ssif2", false},
                                         SsifCase{"/", false}, SsifCase{"", false}));

TEST_F(OrvMediaServiceTest, HeadersReachTheEngine) {
    attachPlayer();
    KeyedVector<String8, String8> headers;
    headers.add(String8("Cookie"), String8("a=b"));
    headers.add(String8("User-Agent"), String8("tv"));
    service->setDataSource("http://x/", &headers);
    EXPECT_THAT(engine->calls(),
                ElementsAre("configPlayer(false)",
                            "setDataSource(http://x/, {Cookie: a=b, User-Agent: tv})"));
}

TEST_F(OrvMediaServiceTest, NullUrlIsRefusedBeforeThePlayerIsLookedAt) {
    const auto expected =
        LinesAre({error("OrvMediaService::setDataSource(url, headers): url=null")});
    EXPECT_EQ(service->setDataSource(nullptr, nullptr), android::NO_INIT);
    EXPECT_THAT(log.take(), expected);
    attachPlayer();
    EXPECT_EQ(service->setDataSource(nullptr, nullptr), android::NO_INIT);
    EXPECT_THAT(log.take(), expected);
    EXPECT_TRUE(engine->calls().empty());
}

TEST_F(OrvMediaServiceTest, NullSubtitleUrlIsLoggedAndRefusedBeforeThePlayerIsLookedAt) {
    for (int round = 0; round < 2; round++) {
        EXPECT_FALSE(service->setSubtitleDataSource(nullptr));
        EXPECT_THAT(log.take(),
                    LinesAre({info("OrvMediaService::setSubtitleDataSource()"),
                              info("OrvMediaService::setSubtitleDataSource(): url=(null)"),
                              error("OrvMediaService::setSubtitleDataSource(): url==null, "
                                    "return directly!!!!")}));
        if (round == 0) attachPlayer();
    }
    EXPECT_TRUE(engine->calls().empty());
}

TEST_F(OrvMediaServiceTest, NullAttributeIsRefusedBeforeThePlayerIsLookedAt) {
    for (int round = 0; round < 2; round++) {
        EXPECT_FALSE(service->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_FONT_INFO, nullptr));
        EXPECT_THAT(log.take(),
                    LinesAre({info("OrvMediaService::setSubtitleAttr()"),
                              error("OrvMediaService::setSubtitleAttr(): parameter error")}));
        if (round == 0) attachPlayer();
    }
    EXPECT_TRUE(engine->calls().empty());
}

TEST_F(OrvMediaServiceTest, DurationIsStoredWhateverTheEngineAnswers) {
    attachPlayer();
    engine->answer("getDuration", {0, -38});
    engine->put("getDuration", 90000);
    for (int expected : {0, -38}) {
        int msec = -1;
        EXPECT_EQ(service->getDuration(&msec), expected);
        EXPECT_EQ(msec, 90000);
        EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::getDuration()"),
                                          error("OrvMediaService::getDuration(): 90000")}));
    }
}

TEST_F(OrvMediaServiceTest, DurationIsZeroWhenTheEngineWritesNone) {
    attachPlayer();
    engine->answer("getDuration", {-38});
    int msec = -1;
    EXPECT_EQ(service->getDuration(&msec), -38);
    EXPECT_EQ(msec, 0);
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::getDuration()"),
                                      error("OrvMediaService::getDuration(): 0")}));
}

TEST_F(OrvMediaServiceTest, DurationWithoutPlayerLeavesTheValue) {
    int msec = -1;
    EXPECT_EQ(service->getDuration(&msec), android::NO_INIT);
    EXPECT_EQ(msec, -1);
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::getDuration()"),
                                      error("OrvMediaService::getDuration(): NO_INIT")}));
}

TEST_F(OrvMediaServiceTest, LoopingIsKeptWithoutPlayerAndAnsweredWithOne) {
    EXPECT_EQ(service->setLooping(1), android::NO_ERROR);
    EXPECT_FALSE(service->isLooping());
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::setLooping(1)"),
                                      info("OrvMediaService::isLooping()"),
                                      info("OrvMediaService::isLooping(): no active player")}));
    attachPlayer();
    EXPECT_TRUE(service->isLooping());
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::isLooping()")}));
    EXPECT_TRUE(engine->calls().empty());
}

TEST_F(OrvMediaServiceTest, LoopingIsForwardedAndKeptEvenWhenTheEngineRefuses) {
    attachPlayer();
    EXPECT_FALSE(service->isLooping());
    engine->answer("setLooping", {-38, 0});
    EXPECT_EQ(service->setLooping(-2), -38);
    EXPECT_TRUE(service->isLooping());
    EXPECT_EQ(service->setLooping(0), android::NO_ERROR);
    EXPECT_FALSE(service->isLooping());
    EXPECT_THAT(engine->calls(), ElementsAre("setLooping(-2)", "setLooping(0)"));
}

TEST_F(OrvMediaServiceTest, AudioSessionIdIsKeptUnlessItIsNegative) {
    EXPECT_EQ(service->getAudioSessionId(), 0);
    EXPECT_EQ(service->setAudioSessionId(42), android::NO_ERROR);
    EXPECT_EQ(service->setAudioSessionId(-1), android::BAD_VALUE);
    attachPlayer();
    EXPECT_EQ(service->getAudioSessionId(), 42);
    EXPECT_EQ(service->setAudioSessionId(0), android::NO_ERROR);
    EXPECT_EQ(service->getAudioSessionId(), 0);
    EXPECT_TRUE(engine->calls().empty());
}

TEST_F(OrvMediaServiceTest, AudioSessionLines) {
    service->setAudioSessionId(-1);
    service->getAudioSessionId();
    EXPECT_THAT(log.take(),
                LinesAre({info("OrvMediaService::setAudioSessionId(-1), not implement"),
                          info("OrvMediaService::getAudioSessionId(), not implement")}));
}

TEST_F(OrvMediaServiceTest, ParameterIsTheEnginesReply) {
    attachPlayer();
    engine->reply("getParameter", {77});
    android::Parcel reply;
    EXPECT_EQ(service->getParameter(1400, &reply), android::NO_ERROR);
    reply.setDataPosition(0);
    EXPECT_EQ(reply.readInt32(), 77);
}

TEST_F(OrvMediaServiceTest, TimedTextIsForwardedUnconditionally) {
    attachPlayer();
    engine->answer("addTimedTextSource", {0, 1});
    EXPECT_FALSE(service->addTimedTextSource("/m/a.srt"));
    EXPECT_TRUE(service->addTimedTextSource("/m/a.srt"));
    const std::vector<ExpectedLine> lines = {
        info("OrvMediaService::addTimedTextSource path (/m/a.srt)"),
        info("OrvMediaService::addTimedTextSource path Test "
             "proprietary_tv/open/frameworks/playback/MediaPlayer/jni/media-service/"
             "OrvMediaService 931\n")};
    EXPECT_THAT(log.take(), LinesAre({lines[0], lines[1], lines[0], lines[1]}));
    EXPECT_THAT(engine->calls(),
                ElementsAre("addTimedTextSource(/m/a.srt)", "addTimedTextSource(/m/a.srt)"));
}

TEST_F(OrvMediaServiceTest, ABRepeatIsForwardedUnconditionally) {
    attachPlayer();
    engine->answer("setABRepeat", {7, -3});
    EXPECT_EQ(service->setABRepeat(1), 7);
    EXPECT_EQ(service->setABRepeat(2), -3);
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::setABRepeat type (1)"),
                                      info("OrvMediaService::setABRepeat type (2)")}));
    EXPECT_THAT(engine->calls(), ElementsAre("setABRepeat(1)", "setABRepeat(2)"));
}

TEST_F(OrvMediaServiceTest, AlbumArtIsTheEnginesBlock) {
    attachPlayer();
    engine->albumArt = std::vector<uint8_t>{0xff, 0xd8};
    MediaAlbumArt* art = service->extractAlbumArt();
    ASSERT_NE(art, nullptr);
    EXPECT_EQ(art->size(), 2u);
    EXPECT_EQ(art->data()[1], 0xd8);
    free(art);
}

TEST_F(OrvMediaServiceTest, RecordsPassThroughUntouched) {
    attachPlayer();
    engine->videoCodecs[3].mFrameRate = 25000;
    VideoCodecInfo info;
    info.mFlags = 9;
    EXPECT_TRUE(service->getVideoCodecInfo(3, info));
    EXPECT_EQ(info.mFrameRate, 25000);

    AudioTrackInfo audio;
    memset(static_cast<void*>(&audio), 0x5a, sizeof(audio));
    EXPECT_FALSE(service->getAudioTrackInfo(false, 0, audio));
    EXPECT_EQ(memcmp(&engine->receivedAudioTracks.at(0), &audio, sizeof(audio)), 0);
}

}  // namespace
}  // namespace orvtest
