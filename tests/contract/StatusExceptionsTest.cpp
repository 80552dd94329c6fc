// SPDX-License-Identifier: Apache-2.0
#include "JniFixture.h"
#include "jni/StatusExceptions.h"

namespace orvtest {
namespace {

class StatusExceptionsTest : public JniFixture {
protected:
    Outcome map(android::status_t status, const char* exception, const char* message) {
        jobject thiz = vm.local(player);
        return observeAction([&] {
            android::process_media_player_call(vm.env(), thiz, status, exception, message);
        });
    }
};

ExpectedLine line(const std::string& reason) {
    return bridgeError("process_media_player_call(): " + reason + ", throw exception\n");
}

TEST_F(StatusExceptionsTest, InvalidOperationIsIllegalStateWhateverTheClass) {
    for (const char* exception : {kIo, kIllegalArgument, "java/lang/Exception"}) {
        EXPECT_THAT(map(-38, exception, "Prepare failed."),
                    ReturnsNothing().logs({line("INVALID_OPERATION")}).throws(kIllegalState));
    }
    EXPECT_THAT(map(-38, kIo, nullptr),
                ReturnsNothing().logs({line("INVALID_OPERATION")}).throws(kIllegalState));
}

TEST_F(StatusExceptionsTest, PermissionDeniedIsSecurityWhateverTheClass) {
    for (const char* exception : {kIo, kIllegalState}) {
        EXPECT_THAT(map(-1, exception, "pause failed."),
                    ReturnsNothing().logs({line("PERMISSION_DENIED")}).throws(kSecurity));
    }
    EXPECT_THAT(map(-1, kIo, nullptr),
                ReturnsNothing().logs({line("PERMISSION_DENIED")}).throws(kSecurity));
}

TEST_F(StatusExceptionsTest, OtherStatusIsAppendedToTheMessage) {
    EXPECT_THAT(
        map(-19, kIo, "Prepare failed."),
        ReturnsNothing().logs({line("else 2")}).throws(kIo, "Prepare failed.: status=0xFFFFFFED"));
}

TEST_F(StatusExceptionsTest, StatusIsUpperCaseHexadecimalWithoutPadding) {
    EXPECT_THAT(map(0xab, kRuntime, "x"),
                ReturnsNothing().logs({line("else 2")}).throws(kRuntime, "x: status=0xAB"));
    EXPECT_THAT(map(android::UNKNOWN_ERROR, kIo, ""),
                ReturnsNothing().logs({line("else 2")}).throws(kIo, ": status=0x80000000"));
}

TEST_F(StatusExceptionsTest, MessageOf230CharactersTakesTheStatus) {
    const std::string message(230, 'm');
    EXPECT_THAT(
        map(-19, kIo, message.c_str()),
        ReturnsNothing().logs({line("else 2")}).throws(kIo, message + ": status=0xFFFFFFED"));
}

TEST_F(StatusExceptionsTest, MessageOf231CharactersIsThrownAsItIs) {
    for (size_t length : {231u, 300u}) {
        const std::string message(length, 'm');
        EXPECT_THAT(map(-19, kIo, message.c_str()),
                    ReturnsNothing().logs({line("else 1")}).throws(kIo, message));
    }
}

TEST_F(StatusExceptionsTest, NullMessageIsIllegalStateWhateverTheClass) {
    EXPECT_THAT(map(-19, kIo, nullptr),
                ReturnsNothing().logs({line("else 3")}).throws(kIllegalState));
}

TEST_F(StatusExceptionsTest, NullClassOnlyLogs) {
    for (int status : {-38, -1, -19, 1}) {
        EXPECT_THAT(map(status, nullptr, "Prepare failed."),
                    ReturnsNothing().logs({line("exception==NULL")}));
    }
}

TEST_F(StatusExceptionsTest, SuccessIsSilent) {
    for (const char* exception : {kIo, static_cast<const char*>(nullptr)}) {
        EXPECT_THAT(map(0, exception, "Prepare failed."), ReturnsNothing());
        EXPECT_THAT(map(0, exception, nullptr), ReturnsNothing());
    }
}

}  // namespace
}  // namespace orvtest
