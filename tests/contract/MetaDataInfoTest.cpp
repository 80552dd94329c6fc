// SPDX-License-Identifier: Apache-2.0
// The media's descriptive data on its way to the Java callback.
#include "JniFixture.h"
#include "RecordTexts.h"

namespace orvtest {
namespace {

using testing::ElementsAre;

class MetaDataInfoTest : public JniFixture {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        playerClass.method("setMetaDataInfo",
                           "(IIIILjava/lang/String;Ljava/lang/String;Ljava/lang/String;"
                           "Ljava/lang/String;ILjava/lang/String;Ljava/lang/String;"
                           "Ljava/lang/String;)V");
        record.mDuration = 1;
        record.mBitRate = 2;
        record.mYear = 3;
        record.mDiscNumber = 4;
        record.mTrackNumber = 5;
        record.mTrackTotal = 6;
        record.mChapterCount = 7;
        setText(record.mTitle, u"A");
        setText(record.mArtist, u"B");
        setText(record.mAlbum, u"C");
        setText(record.mGenre, u"");
        setText(record.mComposer, u"E");
        setText(record.mContainer, u"F");
        setText(record.mComment, u"G");
    }
    Outcome get() { return call<jboolean>("native_getMetaDataInfo", "()Z"); }

    MetaDataInfo record;
    const std::string name = "OrvMediaClient_getMetaDataInfo";
    const ExpectedLine asked = serviceInfo("OrvMediaService::getMetaDataInfo()");
};

TEST_F(MetaDataInfoTest, ReachesJavaWithoutTheFourthAndTheSixthNumber) {
    setUpPlayer().metaDataInfo = record;
    EXPECT_THAT(get(), Returns("true")
                           .logs({enter(name), asked, leave(name)})
                           .engine({"getMetaDataInfo()"})
                           .java({"setMetaDataInfo(1, 2, 3, 5, \"A\", \"B\", \"C\", \"\", 7, "
                                  "\"E\", \"F\", \"G\")"}));
}

TEST_F(MetaDataInfoTest, TextWithoutZeroIsExactly128Units) {
    for (OrvWideText* text : {&record.mTitle, &record.mArtist, &record.mAlbum, &record.mGenre,
                              &record.mComposer, &record.mContainer, &record.mComment}) {
        setText(*text, std::u16string(127, u'x') + u'y');
    }
    setUpPlayer().metaDataInfo = record;
    const std::string text = ", \"" + std::string(127, 'x') + "y\"";
    EXPECT_THAT(get().java, ElementsAre("setMetaDataInfo(1, 2, 3, 5" + text + text + text + text +
                                        ", 7" + text + text + text + ")"));
}

TEST_F(MetaDataInfoTest, EveryTextIsClearedInFullBeforeTheCall) {
    setUpPlayer().metaDataInfo = record;
    poisonStack();
    get();
    const MetaDataInfo& info = engine->receivedMetaDataInfos.at(0);
    EXPECT_TRUE(isClear(info.mTitle));
    EXPECT_TRUE(isClear(info.mArtist));
    EXPECT_TRUE(isClear(info.mAlbum));
    EXPECT_TRUE(isClear(info.mGenre));
    EXPECT_TRUE(isClear(info.mComposer));
    EXPECT_TRUE(isClear(info.mContainer));
    EXPECT_TRUE(isClear(info.mComment));
    EXPECT_EQ(info.mDuration, 0);
    EXPECT_EQ(info.mBitRate, 0);
    EXPECT_EQ(info.mYear, 0);
    EXPECT_EQ(info.mDiscNumber, 0);
    EXPECT_EQ(info.mTrackNumber, 0);
    EXPECT_EQ(info.mTrackTotal, 0);
    EXPECT_EQ(info.mChapterCount, 0);
}

TEST_F(MetaDataInfoTest, MissingServiceThrowsNothing) {
    EXPECT_THAT(get(),
                Returns("false").logs({enter(name), bridgeError("service not exist. Line:%d\n")}));
}

TEST_F(MetaDataInfoTest, EnginesRefusal) {
    setUpPlayer();
    EXPECT_THAT(get(),
                Returns("false")
                    .logs({enter(name), asked, bridgeError(name + "(): service get failed\n")})
                    .engine({"getMetaDataInfo()"}));
}

TEST_F(MetaDataInfoTest, MissingClass) {
    setUpPlayer().metaDataInfo = record;
    vm.hide(kPlayerClass);
    EXPECT_THAT(get(), Returns("false")
                           .logs({enter(name), asked,
                                  bridgeError(name + "(): find class(" + kPlayerClass +
                                              ") failed, please check\n")})
                           .engine({"getMetaDataInfo()"})
                           .throws("java/lang/NoClassDefFoundError", kPlayerClass));
}

TEST_F(MetaDataInfoTest, MissingMethodIsReportedUnderAnotherName) {
    setUpPlayer().metaDataInfo = record;
    playerClass.remove("setMetaDataInfo");
    EXPECT_THAT(get(),
                Returns("false")
                    .logs({enter(name), asked,
                           bridgeError(name + "(): get method id, setAudioTrackInfo, failed\n")})
                    .engine({"getMetaDataInfo()"})
                    .throws("java/lang/NoSuchMethodError", "setMetaDataInfo"));
}

}  // namespace
}  // namespace orvtest
