// SPDX-License-Identifier: Apache-2.0
// The table of audio tracks on its way to its Java callback.
#include "TrackFixture.h"

namespace orvtest {
namespace {

using testing::ElementsAre;

AudioTrackInfo audio(int first) {
    AudioTrackInfo info;
    info.mCodec = first;
    info.mChannels = first + 1;
    info.mSampleRate = first + 2;
    info.mBitRate = first + 3;
    info.mBitsPerSample = first + 4;
    info.mTrackId = first + 5;
    setText(info.mTitle, u"A");
    setText(info.mCodecName, u"B");
    setText(info.mChannelLayout, u"C");
    setText(info.mProfile, u"D");
    info.mFlags = first + 6;
    setText(info.mComment, u"E");
    setText(info.mEncoder, u"F");
    setText(info.mHandler, u"G");
    setText(info.mLanguage, "deu");
    return info;
}

class AllAudioTrackInfoTest : public TrackTableTest {
protected:
    AllAudioTrackInfoTest()
        : TrackTableTest("OrvMediaClient_getAllAudioTrackInfo", "getAudioTrackCount") {}
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method("setAllAudioTrackInfo",
                           "(IIIIIIIILjava/lang/String;Ljava/lang/String;Ljava/lang/String;"
                           "Ljava/lang/String;ILjava/lang/String;Ljava/lang/String;"
                           "Ljava/lang/String;Ljava/lang/String;)V");
    }
    Outcome getAll(bool flag = true) {
        return call<jint>("native_getAllAudioTrackInfo", "(Z)I", static_cast<jboolean>(flag));
    }

    const ExpectedLine asked = serviceInfo("OrvMediaService::getAudioTrackInfo(1)");
    const ExpectedLine language = failure("mLanguage deu\n");
};

TEST_F(AllAudioTrackInfoTest, EveryEntryReachesJava) {
    setUpPlayer().put("getAudioTrackCount", 2);
    engine->audioTracks = {{0, audio(10)}, {1, audio(20)}};
    EXPECT_THAT(
        getAll(),
        Returns("1")
            .logs({enter(name), counted, line("count = 2\n"), asked, language, asked, language,
                   leave(name)})
            .engine({countCall, "getAudioTrackInfo(true, 0)", "getAudioTrackInfo(true, 1)"})
            .java({"setAllAudioTrackInfo(2, 0, 10, 11, 12, 13, 14, 15, \"A\", \"B\", \"C\", "
                   "\"D\", 16, \"E\", \"F\", \"G\", \"deu\")",
                   "setAllAudioTrackInfo(2, 1, 20, 21, 22, 23, 24, 25, \"A\", \"B\", \"C\", "
                   "\"D\", 26, \"E\", \"F\", \"G\", \"deu\")"}));
}

TEST_F(AllAudioTrackInfoTest, FlagIsPassedThrough) {
    setUpPlayer().put("getAudioTrackCount", 1);
    EXPECT_THAT(getAll(false).engine, ElementsAre(countCall, "getAudioTrackInfo(false, 0)"));
}

TEST_F(AllAudioTrackInfoTest, UnreadableEntryEndsTheTable) {
    setUpPlayer().put("getAudioTrackCount", 3);
    engine->audioTracks = {{0, audio(10)}, {2, audio(30)}};
    EXPECT_THAT(
        getAll(),
        Returns("0")
            .logs({enter(name), counted, line("count = 3\n"), asked, language, asked,
                   failure("service get failed\n")})
            .engine({countCall, "getAudioTrackInfo(true, 0)", "getAudioTrackInfo(true, 1)"})
            .java({"setAllAudioTrackInfo(3, 0, 10, 11, 12, 13, 14, 15, \"A\", \"B\", \"C\", "
                   "\"D\", 16, \"E\", \"F\", \"G\", \"deu\")"}));
}

TEST_F(AllAudioTrackInfoTest, EveryTextIsClearedInFullBeforeEachCall) {
    setUpPlayer().put("getAudioTrackCount", 2);
    AudioTrackInfo full = audio(10);
    setText(full.mHandler, std::u16string(128, u'h'));
    engine->audioTracks = {{0, full}, {1, full}};
    poisonStack();
    getAll();
    ASSERT_EQ(engine->receivedAudioTracks.size(), 2u);
    for (const AudioTrackInfo& info : engine->receivedAudioTracks) {
        EXPECT_TRUE(isClear(info.mTitle));
        EXPECT_TRUE(isClear(info.mCodecName));
        EXPECT_TRUE(isClear(info.mChannelLayout));
        EXPECT_TRUE(isClear(info.mProfile));
        EXPECT_TRUE(isClear(info.mComment));
        EXPECT_TRUE(isClear(info.mEncoder));
        EXPECT_TRUE(isClear(info.mHandler));
        EXPECT_TRUE(isClear(info.mLanguage));
        EXPECT_EQ(info.mCodec, 0);
        EXPECT_EQ(info.mTrackId, 0);
        EXPECT_EQ(info.mFlags, 0);
    }
}

TEST_F(AllAudioTrackInfoTest, TextWithoutZeroIsExactly128Units) {
    setUpPlayer().put("getAudioTrackCount", 1);
    AudioTrackInfo info = audio(10);
    for (OrvWideText* text : {&info.mTitle, &info.mCodecName, &info.mChannelLayout, &info.mProfile,
                              &info.mComment, &info.mEncoder, &info.mHandler}) {
        setText(*text, std::u16string(127, u'x') + u'y');
    }
    engine->audioTracks = {{0, info}};
    const std::string text = "\"" + std::string(127, 'x') + "y\"";
    EXPECT_THAT(getAll().java,
                ElementsAre("setAllAudioTrackInfo(1, 0, 10, 11, 12, 13, 14, 15, " + text + ", " +
                            text + ", " + text + ", " + text + ", 16, " + text + ", " + text +
                            ", " + text + ", \"deu\")"));
}

TEST_F(AllAudioTrackInfoTest, NoTracks) {
    setUpPlayer();
    EXPECT_THAT(getAll(), Returns("0")
                              .logs({enter(name), counted, line("count = 0\n"),
                                     line("count = 0, no need to fetch subtitle info\n")})
                              .engine({countCall}));
}

TEST_F(AllAudioTrackInfoTest, MissingServiceThrowsNothing) {
    EXPECT_THAT(getAll(), Returns("0").logs({enter(name), missingServiceLine()}));
}

TEST_F(AllAudioTrackInfoTest, CountFailed) {
    setUpPlayer().answer("getAudioTrackCount", {0});
    EXPECT_THAT(getAll(), Returns("-1")
                              .logs({enter(name), counted,
                                     failure("getAudioTrackCount(), service get failed\n")})
                              .engine({countCall}));
}

TEST_F(AllAudioTrackInfoTest, MissingClass) {
    setUpPlayer().put("getAudioTrackCount", 1);
    vm.hide(kPlayerClass);
    EXPECT_THAT(getAll(), Returns("0")
                              .logs({enter(name), counted, line("count = 1\n"), classError(name)})
                              .engine({countCall})
                              .throws(kNoClass, kPlayerClass));
}

TEST_F(AllAudioTrackInfoTest, MissingMethod) {
    setUpPlayer().put("getAudioTrackCount", 1);
    playerClass.remove("setAllAudioTrackInfo");
    EXPECT_THAT(getAll(), Returns("0")
                              .logs({enter(name), counted, line("count = 1\n"),
                                     methodError(name, "setAudioTrackInfo")})
                              .engine({countCall})
                              .throws(kNoMethod, "setAllAudioTrackInfo"));
}

}  // namespace
}  // namespace orvtest
