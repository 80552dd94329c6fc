// SPDX-License-Identifier: Apache-2.0
// Where filled DivX records reach the Java callbacks.
#include "JniFixture.h"
#include "RecordTexts.h"
#include "jni/DivxNavigation.h"

namespace orvtest {
namespace {

using testing::ElementsAre;

DivxTitleInfo title() {
    DivxTitleInfo info;
    info.mTitle = 1;
    info.mPlayListCount = -2;
    info.mChapterCount = 3;
    return info;
}

DivxChapInfo chapter() {
    DivxChapInfo info;
    info.mTitle = 1;
    info.mPlayList = 2;
    info.mChapter = 3;
    info.mStart = -4;
    return info;
}

// One kind of record: the getter whose lines are used, and its callback.
struct Delivery {
    std::string getter;
    std::string callback;
    std::string signature;
    bool (*deliver)(JNIEnv*, jobject);
    std::string javaCall;  // empty where the arguments do not fit the signature
};
void PrintTo(const Delivery& delivery, std::ostream* out) { *out << delivery.getter; }

std::vector<Delivery> deliveries() {
    return {
        {"getDivxTitleInfo", "setDivxTitleInfoPrm", "(III)V",
         [](JNIEnv* env, jobject thiz) {
             return android::deliverDivxTitleInfo(env, thiz, title());
         },
         "setDivxTitleInfoPrm(1, -2, 3)"},
        {"getDivxChapInfo", "setDivxChapInfoPrm", "(IIII)V",
         [](JNIEnv* env, jobject thiz) {
             return android::deliverDivxChapInfo(env, thiz, chapter());
         },
         "setDivxChapInfoPrm(1, 2, 3, -4)"},
        {"getDivxPlayListInfo", "setDivxPlayListInfoPrm", "(IIII)V",
         [](JNIEnv* env, jobject thiz) {
             return android::deliverDivxPlayListInfo(env, thiz, chapter());
         },
         "setDivxPlayListInfoPrm(1, 2, 3, -4)"},
        {"getDivxPositionInfo", "setDivxPositionInfoPrm", "(III)V",
         [](JNIEnv* env, jobject thiz) {
             return android::deliverDivxPositionInfo(env, thiz, title());
         },
         "setDivxPositionInfoPrm(1, -2, 3)"},
        {"getDivxDisplayInfo", "setDivxDisplayInfoPrm",
         "(IIIIILjava/lang/String;ILjava/lang/String;I)V",
         [](JNIEnv* env, jobject thiz) {
             DivxDisplayInfo info;
             return android::deliverDivxDisplayInfo(env, thiz, info);
         },
         ""},
        {"getDivxLastMemoryFilePosition", "setDivxLastMemoryFilePositionPrm",
         "(JIIIIIJJJJJJIIJJI)V",
         [](JNIEnv* env, jobject thiz) {
             return android::deliverDivxLastMemoryFilePosition(env, thiz,
                                                               DivxLastMemoryFilePosition());
         },
         ""},
    };
}

class DivxDeliveryTest : public JniFixture, public testing::WithParamInterface<Delivery> {
protected:
    Outcome deliver(bool expected) {
        return observeAction(
            [&] { EXPECT_EQ(GetParam().deliver(vm.env(), vm.local(player)), expected); });
    }
    std::string function() const { return "OrvMediaClient_" + GetParam().getter; }
};

TEST_P(DivxDeliveryTest, ReachesJava) {
    if (GetParam().javaCall.empty()) vm.tolerate("CallVoidMethod");
    playerClass.method(GetParam().callback, GetParam().signature);
    const Outcome outcome = deliver(true);
    ASSERT_EQ(outcome.java.size(), 1u);
    if (!GetParam().javaCall.empty()) {
        EXPECT_EQ(outcome.java[0], GetParam().javaCall);
    }
    EXPECT_THAT(outcome, ReturnsNothing().java(outcome.java));
}

TEST_P(DivxDeliveryTest, MissingClass) {
    vm.hide(kPlayerClass);
    EXPECT_THAT(deliver(false), ReturnsNothing()
                                    .logs({bridgeError(function() + "(): find class(" +
                                                       kPlayerClass + ") failed, please check\n")})
                                    .throws("java/lang/NoClassDefFoundError", kPlayerClass));
}

TEST_P(DivxDeliveryTest, MissingMethod) {
    EXPECT_THAT(deliver(false), ReturnsNothing()
                                    .logs({bridgeError(function() + "(): get method id, " +
                                                       GetParam().callback + ", failed\n")})
                                    .throws("java/lang/NoSuchMethodError", GetParam().callback));
}

INSTANTIATE_TEST_SUITE_P(Records, DivxDeliveryTest, testing::ValuesIn(deliveries()),
                         [](const auto& info) { return info.param.getter; });

class DivxDisplayTextTest : public JniFixture {};

TEST_F(DivxDisplayTextTest, TextWithoutZeroIsExactly128Units) {
    playerClass.method("setDivxDisplayInfoPrm", "(IIIIILjava/lang/String;ILjava/lang/String;I)V");
    vm.tolerate("CallVoidMethod");
    DivxDisplayInfo info;
    setText(info.mText1, std::u16string(128, u'x'));
    setText(info.mText2, u"short");
    // The lengths that the environment was asked for.
    static std::vector<jsize> lengths;
    lengths.clear();
    JNIEnv* env = vm.env();
    static const JNINativeInterface* original;
    original = env->functions;
    JNINativeInterface table = *original;
    table.NewString = [](JNIEnv* e, const jchar* units, jsize length) {
        lengths.push_back(length);
        return original->NewString(e, units, length);
    };
    env->functions = &table;
    android::deliverDivxDisplayInfo(env, vm.local(player), info);
    env->functions = original;
    EXPECT_THAT(lengths, ElementsAre(128, 5));
}

}  // namespace
}  // namespace orvtest
