// SPDX-License-Identifier: Apache-2.0
// The television's extras where they have rules of their own: how values are
// cut, what a failed position throws, and the decoder command.
#include "JniFixture.h"
#include "ServiceFailure.h"

namespace orvtest {
namespace {

class ExtensionCommandRulesTest : public JniFixture {
protected:
    Outcome send(jstring text) {
        return call<jint>("native_QTVDECSendCliCommand", "(Ljava/lang/String;I)I", text, 5);
    }
    std::vector<std::string> seek(jlong position) {
        return call<void>("native_seekToPosition", "(J)V", position).engine;
    }
};

constexpr char kSend[] = "OrvMediaClient_QTVDEC_SendCliCommand";

TEST_F(ExtensionCommandRulesTest, BytePositionIsCutTo32BitsAndWidenedBySign) {
    setUpPlayer();
    EXPECT_THAT(seek(jlong(1) << 32 | 16), testing::ElementsAre("seekToPosition(16)"));
    EXPECT_THAT(seek(jlong(1) << 31), testing::ElementsAre("seekToPosition(18446744071562067968)"));
    EXPECT_THAT(seek(0x7fffffff), testing::ElementsAre("seekToPosition(2147483647)"));
}

TEST_F(ExtensionCommandRulesTest, TransportStreamValueIsCutTo16Bits) {
    setUpPlayer();
    EXPECT_THAT(call<jboolean>("native_setTS", "(I)Z", -1).engine,
                testing::ElementsAre("setTS(65535)"));
}

TEST_F(ExtensionCommandRulesTest, FailedBytePositionGoesThroughTheStatusMapping) {
    setUpPlayer().put("getCurrentBytePosition", 77);
    struct Case {
        int status;
        const char* reason;
        fakejni::Thrown thrown;
    };
    const Case cases[] = {
        {-38, "INVALID_OPERATION", {kIllegalState, {}}},
        {-1, "PERMISSION_DENIED", {kSecurity, {}}},
        {-19, "else 2", {kIo, "getCurrentBytePosition failed.: status=0xFFFFFFED"}},
    };
    for (const Case& one : cases) {
        engine->answer("getCurrentBytePosition", {one.status});
        const Outcome outcome = call<jint>("native_getCurrentBytePosition", "()I");
        EXPECT_EQ(outcome.returned, "77");
        EXPECT_THAT(outcome.thrown, testing::Optional(one.thrown));
        EXPECT_THAT(outcome.log,
                    LinesAre({bridgeError(std::string("process_media_player_call(): ") +
                                          one.reason + ", throw exception\n")}));
    }
}

// A command whose engine writes nothing returns its own zero.
TEST_F(ExtensionCommandRulesTest, ValuesStartAtZero) {
    setUpPlayer();
    for (const char* index : {"getCurrentAudioIndex", "getCurrentSubtitleIndex"}) {
        engine->answer(index, {1});
        EXPECT_EQ(call<jint>(std::string("native_") + index, "()I").returned, "0") << index;
    }
    EXPECT_EQ(call<jint>("native_getPlayMode", "()I").returned, "0");
}

TEST_F(ExtensionCommandRulesTest, ServiceOutlivesAReleaseDuringTheCall) {
    setUpPlayer().answer("setSpeed", {7});
    engine->whenCalled("setSpeed", [&] {
        vm.onJavaThread([&] {
            fakejni::callNative<void>(vm, playerClass, vm.local(player), "native_release", "()V");
        });
        EXPECT_EQ(ScriptedEngine::live(), 1);
    });
    EXPECT_EQ(call<jint>("native_setPlayMode", "(I)I", 2000).returned, "7");
    EXPECT_EQ(ScriptedEngine::live(), 0);
}

TEST_F(ExtensionCommandRulesTest, DecoderCommandIsAcceptedAndItsCharactersStay) {
    setUpPlayer();
    EXPECT_THAT(
        send(string("status")),
        Returns("0")
            .logs({enter(kSend), serviceInfo("OrvMediaService::mString(status)"), leave(kSend)})
            .leavesUnreleased({"GetStringUTFChars"}));
    EXPECT_EQ(lastCliArgument(), 5);
    leftUnreleased = {"GetStringUTFChars"};
}

TEST_F(ExtensionCommandRulesTest, RefusedDecoderCommandIsMinusOne) {
    setUpPlayer();
    const ServiceFailure failure(-19);
    EXPECT_THAT(
        send(string("status")),
        Returns("-1")
            .logs({enter(kSend), serviceInfo("OrvMediaService::mString(status)"),
                   bridgeInfo(std::string(kSend) + "(): service get failed\n"), leave(kSend)})
            .leavesUnreleased({"GetStringUTFChars"}));
    leftUnreleased = {"GetStringUTFChars"};
}

TEST_F(ExtensionCommandRulesTest, DecoderCommandWithoutCharactersReturnsZero) {
    setUpPlayer();
    const ExpectedLine noText = bridgeInfo(
        "OrvMediaClient_QTVDEC_SendCliCommand(): url=null, return directly, error!!!!\n");
    EXPECT_THAT(send(nullptr), Returns("0").logs({enter(kSend), noText}));
    jstring text = string("status");
    vm.fail("GetStringUTFChars");
    EXPECT_THAT(
        send(text),
        Returns("0").logs({enter(kSend), noText}).throws(kOutOfMemory, "GetStringUTFChars"));
}

TEST_F(ExtensionCommandRulesTest, DecoderCommandWithoutServiceNeverThrows) {
    EXPECT_THAT(send(string("status")),
                Returns("-1").logs({enter(kSend), bridgeError("service not exist. Line:3718\n")}));
}

}  // namespace
}  // namespace orvtest
