// SPDX-License-Identifier: Apache-2.0
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>

#include "PlaybackCommandTable.h"

namespace orvtest {
namespace {

constexpr char kHeaders[] = "OrvMediaClient_setDataSourceAndHeaders";
constexpr char kPlain[] = "OrvMediaClient_setDataSource";

int lowestFreeDescriptor() {
    const int fd = open("/dev/null", O_RDONLY | O_CLOEXEC);
    close(fd);
    return fd;
}

class DataSourceCommandsTest : public JniFixture {
protected:
    Outcome setDataSource(jstring path) {
        return call<void>("native_setDataSource", "(Ljava/lang/String;)V", path);
    }
    Outcome setDataSource(jstring path, jobjectArray keys, jobjectArray values) {
        return call<void>("native_setDataSource",
                          "(Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V", path, keys,
                          values);
    }
    Outcome setDataSource(jobject descriptor, jlong offset, jlong length) {
        return call<void>("native_setDataSource", "(Ljava/io/FileDescriptor;JJ)V", descriptor,
                          offset, length);
    }
};

TEST_F(DataSourceCommandsTest, DataSourceWithoutHeadersIsTheHeadersVariantInside) {
    setUpPlayer();
    EXPECT_THAT(setDataSource(string("http://h/a")),
                ReturnsNothing()
                    .logs({enter(kPlain), enter(kHeaders), service("setDataSource(http://h/a)"),
                           leave(kHeaders), leave(kPlain)})
                    .engine({"configPlayer(false)", "setDataSource(http://h/a, null)"}));
}

TEST_F(DataSourceCommandsTest, NullPathIsAnIllegalArgument) {
    setUpPlayer();
    EXPECT_THAT(setDataSource(nullptr),
                ReturnsNothing()
                    .logs({enter(kPlain), enter(kHeaders),
                           bridgeError("path==null, thow exception. Line:%d \n"), leave(kPlain)})
                    .throws(kIllegalArgument));
}

TEST_F(DataSourceCommandsTest, MissingServiceComesBeforeTheNullPath) {
    EXPECT_THAT(
        setDataSource(nullptr),
        ReturnsNothing()
            .logs({enter(kPlain), enter(kHeaders),
                   bridgeError("service not exist, throw exception. Line:%d \n"), leave(kPlain)})
            .throws(kIllegalState));
}

TEST_F(DataSourceCommandsTest, PathWithoutCharactersEndsTheCall) {
    setUpPlayer();
    jstring path = string("/a.mp4");
    vm.fail("GetStringUTFChars");
    EXPECT_THAT(
        setDataSource(path, nullptr, nullptr),
        ReturnsNothing()
            .logs({enter(kHeaders), bridgeError("OrvMediaClient_setDataSourceAndHeaders(): out of "
                                                "memory!!!n\n")})
            .throws(kOutOfMemory, "GetStringUTFChars"));
}

TEST_F(DataSourceCommandsTest, PathReachesTheEngineInModifiedUtf8) {
    setUpPlayer();
    const std::string path = "/\xC3\xA9\xED\xA0\xBD\xED\xB8\x80.mp4";
    EXPECT_THAT(setDataSource(string(path), nullptr, nullptr).engine.back(),
                "setDataSource(" + path + ", null)");
}

TEST_F(DataSourceCommandsTest, HeadersReachTheEngineAsAMap) {
    setUpPlayer();
    EXPECT_THAT(setDataSource(string("/a"), strings({"B", "A", "B"}), strings({"1", "2", "3"})),
                ReturnsNothing()
                    .logs({enter(kHeaders), service("setDataSource(/a)"), leave(kHeaders)})
                    .engine({"configPlayer(false)", "setDataSource(/a, {A: 2, B: 3})"}));
}

TEST_F(DataSourceCommandsTest, PathIsGivenBackBeforeTheHeadersAreRead) {
    setUpPlayer();
    setDataSource(string("/a"), strings({"A"}), strings({"1"}));
    const std::vector<std::string> calls = vmCalls();
    const auto released = std::find(calls.begin(), calls.end(), "ReleaseStringUTFChars");
    EXPECT_EQ(std::count(calls.begin(), released, "GetStringUTFChars"), 1);
    EXPECT_EQ(std::count(calls.begin(), released, "GetArrayLength"), 0);
    EXPECT_GT(std::count(released, calls.end(), "GetArrayLength"), 0);
}

TEST_F(DataSourceCommandsTest, EmptyHeadersAreANullMap) {
    setUpPlayer();
    EXPECT_THAT(setDataSource(string("/a"), strings({}), strings({})),
                ReturnsNothing()
                    .logs({enter(kHeaders), service("setDataSource(/a)"), leave(kHeaders)})
                    .engine({"configPlayer(false)", "setDataSource(/a, null)"}));
}

TEST_F(DataSourceCommandsTest, UnequalHeadersAreAnIllegalArgument) {
    setUpPlayer();
    const Expected refused =
        ReturnsNothing()
            .logs({enter(kHeaders), error("keys and values arrays have different length")
                                        .tagged("Customer_media_Utils")})
            .throws(kIllegalArgument);
    EXPECT_THAT(setDataSource(string("/a"), strings({"a", "b"}), strings({"1", "2", "3"})),
                refused);
    EXPECT_THAT(setDataSource(string("/a"), strings({"a"}), nullptr), refused);
    EXPECT_THAT(setDataSource(string("/a"), nullptr, strings({"1"})), refused);
}

TEST_F(DataSourceCommandsTest, DescriptorIsNeitherDuplicatedNorClosed) {
    setUpPlayer();
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    const int lowest = lowestFreeDescriptor();
    jobject descriptor = vm.local(newFileDescriptor(vm, ends[0]));
    const Untraced number(*this);  // which the system chooses
    EXPECT_THAT(setDataSource(descriptor, 0, 9).engine,
                testing::ElementsAre("setDataSource(" + std::to_string(ends[0]) + ", 0, 9)"));
    call<void>("native_release", "()V");
    EXPECT_EQ(lowestFreeDescriptor(), lowest);
    EXPECT_NE(fcntl(ends[0], F_GETFD), -1);
    for (int end : ends) close(end);
}

TEST_F(DataSourceCommandsTest, NullDescriptorIsAnIllegalArgument) {
    setUpPlayer();
    EXPECT_THAT(setDataSource(jobject(), 0, 9),
                ReturnsNothing()
                    .logs({enter("OrvMediaClient_setDataSourceFD"), bridgeError(kMissingLine)})
                    .throws(kIllegalArgument));
}

TEST_F(DataSourceCommandsTest, MissingServiceComesBeforeTheNullDescriptor) {
    const Outcome missing = setDataSource(jobject(), 0, 9);
    EXPECT_THAT(missing,
                ReturnsNothing()
                    .logs({enter("OrvMediaClient_setDataSourceFD"), bridgeError(kMissingLine)})
                    .throws(kIllegalState));
    setUpPlayer();
    const Outcome null = setDataSource(jobject(), 0, 9);
    EXPECT_NE(lineNumbers(missing.log), lineNumbers(null.log));
}

}  // namespace
}  // namespace orvtest
