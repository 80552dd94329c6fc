// SPDX-License-Identifier: Apache-2.0
// What DivX navigation gives to the service, and what it makes of an answer.
#include <string.h>

#include <algorithm>
#include <numeric>

#include "DivxService.h"
#include "JniFixture.h"
#include "RecordTexts.h"

namespace orvtest {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

class DivxServiceTest : public JniFixture {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        setUpPlayer();
        service.title = {1, -2, 3};
        service.chapter = {4, 5, -6, 7};
    }
    Expected goodCall(const std::string& result, const std::string& name) const {
        return Returns(result).logs(
            {enter("OrvMediaClient_" + name), leave("OrvMediaClient_" + name)});
    }

    DivxService service;
};

TEST_F(DivxServiceTest, TitleInfoReachesJava) {
    playerClass.method("setDivxTitleInfoPrm", "(III)V");
    EXPECT_THAT(call<jboolean>("native_getDivxTitleInfo", "(I)Z", jint{7}),
                goodCall("true", "getDivxTitleInfo").java({"setDivxTitleInfoPrm(1, -2, 3)"}));
    EXPECT_THAT(service.calls, ElementsAre("getDivxTitleInfo(7)"));
}

TEST_F(DivxServiceTest, ChapInfoReachesJava) {
    playerClass.method("setDivxChapInfoPrm", "(IIII)V");
    EXPECT_THAT(call<jboolean>("native_getDivxChapInfo", "(III)Z", jint{7}, jint{8}, jint{9}),
                goodCall("true", "getDivxChapInfo").java({"setDivxChapInfoPrm(4, 5, -6, 7)"}));
    EXPECT_THAT(service.calls, ElementsAre("getDivxChapInfo(7, 8, 9)"));
}

TEST_F(DivxServiceTest, PlayListInfoReachesJava) {
    playerClass.method("setDivxPlayListInfoPrm", "(IIII)V");
    EXPECT_THAT(call<jboolean>("native_getDivxPlayListInfo", "(II)Z", jint{7}, jint{8}),
                Returns("true")
                    .logs({enter("OrvMediaClient_getDivxChapInfo"),
                           leave("OrvMediaClient_getDivxPlayListInfo")})
                    .java({"setDivxPlayListInfoPrm(4, 5, -6, 7)"}));
    EXPECT_THAT(service.calls, ElementsAre("getDivxPlayListInfo(7, 8)"));
}

TEST_F(DivxServiceTest, PositionInfoReachesJava) {
    playerClass.method("setDivxPositionInfoPrm", "(III)V");
    EXPECT_THAT(call<jboolean>("native_getDivxPositionInfo", "()Z"),
                goodCall("true", "getDivxPositionInfo").java({"setDivxPositionInfoPrm(1, -2, 3)"}));
    EXPECT_THAT(service.calls, ElementsAre("getDivxPositionInfo()"));
}

// The arguments of the last two callbacks do not fit their signatures.
TEST_F(DivxServiceTest, DisplayInfoReachesJava) {
    playerClass.method("setDivxDisplayInfoPrm", "(IIIIILjava/lang/String;ILjava/lang/String;I)V");
    vm.tolerate("CallVoidMethod");
    std::iota(service.display.mValues, service.display.mValues + 5, 11);
    const Outcome outcome = call<jboolean>("native_getDivxDisplayInfo", "(IIIII)Z", jint{1},
                                           jint{2}, jint{3}, jint{4}, jint{5});
    EXPECT_THAT(outcome.java,
                ElementsAre(StartsWith("setDivxDisplayInfoPrm(11, 12, 13, 14, 15, ")));
    EXPECT_THAT(outcome, goodCall("true", "getDivxDisplayInfo").java(outcome.java));
    EXPECT_THAT(service.calls, ElementsAre("getDivxDisplayInfo(1, 2, 3, 4, 5)"));
}

TEST_F(DivxServiceTest, LastMemoryFilePositionReachesJava) {
    playerClass.method("setDivxLastMemoryFilePositionPrm", "(JIIIIIJJJJJJIIJJI)V");
    vm.tolerate("CallVoidMethod");
    // All words alike, so that those of the numbers behind the first long are
    // the same wherever the calling convention takes them from.
    uint32_t words[17];
    std::fill_n(words, 17, 7u);
    static_assert(sizeof(words) == sizeof(service.position));
    memcpy(&service.position, words, sizeof(words));
    const Outcome outcome = call<jboolean>("native_getDivxLastMemoryFilePosition", "()Z");
    EXPECT_THAT(outcome.java, ElementsAre(HasSubstr(", 7, 7, 7, 7, 7, ")));
    EXPECT_THAT(outcome, goodCall("true", "getDivxLastMemoryFilePosition").java(outcome.java));
    EXPECT_THAT(service.calls, ElementsAre("getDivxLastMemoryFilePosition()"));
}

TEST_F(DivxServiceTest, MissingCallbackIsFalseWithoutLeave) {
    const std::string name = "OrvMediaClient_getDivxTitleInfo";
    EXPECT_THAT(call<jboolean>("native_getDivxTitleInfo", "(I)Z", jint{7}),
                Returns("false")
                    .logs({enter(name),
                           bridgeError(name + "(): get method id, setDivxTitleInfoPrm, failed\n")})
                    .throws("java/lang/NoSuchMethodError", "setDivxTitleInfoPrm"));
}

TEST_F(DivxServiceTest, DisplayInfoIsClearedInFullBeforeTheCall) {
    playerClass.method("setDivxDisplayInfoPrm", "(IIIIILjava/lang/String;ILjava/lang/String;I)V");
    vm.tolerate("CallVoidMethod");
    poisonStack();
    call<jboolean>("native_getDivxDisplayInfo", "(IIIII)Z", jint{1}, jint{2}, jint{3}, jint{4},
                   jint{5});
    EXPECT_TRUE(isClear(service.receivedDisplay.mText1));
    EXPECT_TRUE(isClear(service.receivedDisplay.mText2));
    EXPECT_THAT(service.receivedDisplay.mValues, testing::Each(0));
    EXPECT_EQ(service.receivedDisplay.mValue7, 0);
}

TEST_F(DivxServiceTest, NumbersAreWhatTheServiceWrote) {
    service.number = 42;
    EXPECT_THAT(call<jint>("native_getDivxTitleNum", "()I"), goodCall("42", "getDivxTitleNum"));
    EXPECT_THAT(call<jint>("native_getDivxLastMemoryFileID", "()I"),
                goodCall("42", "getDivxLastMemoryFileID"));
    EXPECT_THAT(service.calls, ElementsAre("getDivxTitleNum()", "getDivxLastMemoryFileID()"));
}

TEST_F(DivxServiceTest, SettersPassTheirArgumentsInOrder) {
    call<jint>("native_setDivxTitleInfo", "(III)I", jint{1}, jint{2}, jint{3});
    call<jint>("native_setDivxChapInfo", "(IIII)I", jint{1}, jint{2}, jint{3}, jint{4});
    call<jint>("native_setDivxPlayListInfo", "(IIII)I", jint{1}, jint{2}, jint{3}, jint{4});
    call<jint>("native_setDivxBtnInfo", "(II)I", jint{1}, jint{2});
    call<jint>("native_setDivxFilePosition", "(II)I", jint{1}, jint{2});
    EXPECT_THAT(service.calls,
                ElementsAre("setDivxTitleInfo(1, 2, 3)", "setDivxChapInfo(1, 2, 3, 4)",
                            "setDivxPlayListInfo(1, 2, 3, 4)", "setDivxBtnInfo(1, 2)",
                            "setDivxFilePosition(1, 2)"));
}

}  // namespace
}  // namespace orvtest
