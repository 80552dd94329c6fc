// SPDX-License-Identifier: Apache-2.0
// Reading: what the engine gets for every count that Java may return.
#include <limits.h>

#include <numeric>

#include "JavaInputStreamFixture.h"
#include "jni/JavaVm.h"

namespace orvtest {
namespace {

using fakejni::Value;
using testing::ElementsAre;

constexpr char kInvalid[] =
    "JavaInputStream::read(): input stream is not valid now, return directly!!!!";

class JavaInputStreamReadTest : public JavaInputStreamFixture {
protected:
    void SetUp() override {
        JavaInputStreamFixture::SetUp();
        std::vector<uint8_t> content(300);
        std::iota(content.begin(), content.end(), 1);
        player->set("mStreamReadBuffer", Value::of(vm.newBytes(content)));
        buffer.assign(400, '~');
    }

    // The Java side answers n to a read of len bytes.
    Outcome read(int n, int len) {
        answer("readStream", "(I)I", Value::ofInt(n));
        make();
        return onEngine([&] { status = stream->read(buffer.data(), len, readLen); });
    }
    // How many bytes at the buffer's start are Java's; the rest is untouched.
    size_t copied() const {
        size_t count = 0;
        while (count < buffer.size() && static_cast<uint8_t>(buffer[count]) == uint8_t(count + 1))
            ++count;
        for (size_t i = count; i < buffer.size(); ++i) EXPECT_EQ(buffer[i], '~') << i;
        return count;
    }

    std::vector<char> buffer;
    int status = 99;
    int readLen = 99;
};

TEST_F(JavaInputStreamReadTest, CopiesWhatJavaRead) {
    EXPECT_THAT(read(200, 256), ReturnsNothing().java({"readStream(256)"}));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 200);
    EXPECT_EQ(copied(), 200u);
    EXPECT_THAT(vm.callsOf("ReleaseByteArrayElements"), ElementsAre("0"));
    EXPECT_THAT(vmCalls(), ElementsAre("GetEnv", "AttachCurrentThread", "CallIntMethod",
                                       "GetObjectField", "GetByteArrayElements", "GetArrayLength",
                                       "ReleaseByteArrayElements", "DetachCurrentThread"));
}

TEST_F(JavaInputStreamReadTest, OneByteIsEnough) {
    read(1, 1);
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 1);
    EXPECT_EQ(copied(), 1u);
}

TEST_F(JavaInputStreamReadTest, ZeroIsTheEnd) {
    EXPECT_THAT(read(0, 100), ReturnsNothing()
                                  .logs({bridgeInfo("JavaInputStream::read(): just return "
                                                    "ORV_STREAM_ERROR_CODE_EOF!\n")})
                                  .java({"readStream(100)"}));
    EXPECT_EQ(status, -2);
    EXPECT_EQ(readLen, 0);
    EXPECT_EQ(copied(), 0u);
}

TEST_F(JavaInputStreamReadTest, NegativeIsAFailure) {
    EXPECT_THAT(read(-5, 100), ReturnsNothing()
                                   .logs({bridgeError("JavaInputStream::read(): just return "
                                                      "ORV_STREAM_ERROR_CODE_NOT_OK!\n")})
                                   .java({"readStream(100)"}));
    EXPECT_EQ(status, -1);
    EXPECT_EQ(readLen, 0);
}

TEST_F(JavaInputStreamReadTest, MoreThanAskedForIsCutButReported) {
    EXPECT_THAT(read(300, 200),
                ReturnsNothing()
                    .logs({bridgeError("JavaInputStream::read(): copy i4ReadResult>len Issue "
                                       "handle \n")})
                    .java({"readStream(200)"}));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 300);
    EXPECT_EQ(copied(), 200u);
}

TEST_F(JavaInputStreamReadTest, BytesAreCopiedBeforeTheCutIsLoggedAndTheArrayReleased) {
    size_t copiedThen = 0;
    size_t releasedThen = 99;
    log.whenLogged(bridgeError("JavaInputStream::read(): copy i4ReadResult>len Issue handle \n"),
                   [&] {
                       copiedThen = copied();
                       releasedThen = vm.callsOf("ReleaseByteArrayElements").size();
                   });
    read(300, 200);
    EXPECT_EQ(copiedThen, 200u);
    EXPECT_EQ(releasedThen, 0u);
    EXPECT_EQ(vm.callsOf("ReleaseByteArrayElements").size(), 1u);
}

// A count beyond the end of Java's own array must not read what is behind it.
TEST_F(JavaInputStreamReadTest, CountBeyondJavasArrayReadsNothingBehindIt) {
    read(350, 400);
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 350);
    size_t foreign = 0;
    for (size_t i = 300; i < buffer.size(); ++i) foreign += buffer[i] != '~' && buffer[i] != 0;
    EXPECT_EQ(foreign, 0u);
}

TEST_F(JavaInputStreamReadTest, MissingArrayCopiesNothingAndReportsTheCount) {
    player->set("mStreamReadBuffer", Value::of(nullptr));
    EXPECT_THAT(read(50, 100),
                ReturnsNothing()
                    .logs({bridgeError("JavaInputStream::read(): pByte_readBuffer=null, please "
                                       "check!\n")})
                    .java({"readStream(100)"}));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 50);
    EXPECT_EQ(copied(), 0u);
}

TEST_F(JavaInputStreamReadTest, ElementsThatCannotBeHadCopyNothing) {
    vm.fail("GetByteArrayElements");
    EXPECT_THAT(
        read(50, 100).log,
        LinesAre({bridgeError("JavaInputStream::read(): pByte_readBuffer=null, please check!\n")}));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 50);
    EXPECT_EQ(copied(), 0u);
}

// The engine's length is passed on and limits what is copied, whatever it is.
class OddLengthTest : public JavaInputStreamReadTest, public testing::WithParamInterface<int> {};

TEST_P(OddLengthTest, IsPassedOnAndCopiesNothing) {
    const int len = GetParam();
    EXPECT_THAT(read(50, len),
                ReturnsNothing()
                    .logs({bridgeError("JavaInputStream::read(): copy i4ReadResult>len Issue "
                                       "handle \n")})
                    .java({"readStream(" + std::to_string(len) + ")"}));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 50);
    EXPECT_EQ(copied(), 0u);
    EXPECT_THAT(vm.callsOf("ReleaseByteArrayElements"), ElementsAre("0"));
}

INSTANTIATE_TEST_SUITE_P(Bytes, OddLengthTest, testing::Values(0, -1, INT_MIN),
                         [](const auto& info) {
                             return info.param == 0    ? "None"
                                    : info.param == -1 ? "Negative"
                                                       : "MostNegative";
                         });

TEST_F(JavaInputStreamReadTest, EmptyArrayCopiesNothingAndIsReleased) {
    player->set("mStreamReadBuffer", Value::of(vm.newBytes({})));
    EXPECT_THAT(read(50, 100), ReturnsNothing().java({"readStream(100)"}));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(readLen, 50);
    EXPECT_EQ(copied(), 0u);
    EXPECT_THAT(vm.callsOf("ReleaseByteArrayElements"), ElementsAre("0"));
}

TEST_F(JavaInputStreamReadTest, InvalidStreamIsAtItsEnd) {
    make();
    stream->setInvalid();
    EXPECT_THAT(onEngine([&] { status = stream->read(buffer.data(), 10, readLen); }),
                ReturnsNothing().logs({bridgeInfo(kInvalid)}));
    EXPECT_EQ(status, -2);
    EXPECT_EQ(readLen, 0);
}

TEST_F(JavaInputStreamReadTest, NullBufferIsAFailure) {
    make();
    EXPECT_THAT(onEngine([&] { status = stream->read(nullptr, 10, readLen); }),
                ReturnsNothing().logs({bridgeError("JavaInputStream::read(): buffer==NULL\n")}));
    EXPECT_EQ(status, -1);
    EXPECT_EQ(readLen, 0);
}

TEST_F(JavaInputStreamReadTest, MissingVmIsAFailure) {
    make();
    g__JavaVM = nullptr;
    EXPECT_THAT(onEngine([&] { status = stream->read(buffer.data(), 10, readLen); }),
                ReturnsNothing().logs({bridgeError("JavaInputStream::read(): g__JavaVM==NULL\n")}));
    EXPECT_EQ(status, -1);
    EXPECT_EQ(readLen, 0);
    g__JavaVM = vm.javaVm();
}

// The checks come in this order: validity, buffer, machine.
TEST_F(JavaInputStreamReadTest, ValidityIsCheckedFirst) {
    make();
    stream->setInvalid();
    g__JavaVM = nullptr;
    EXPECT_THAT(onEngine([&] { status = stream->read(nullptr, 10, readLen); }),
                ReturnsNothing().logs({bridgeInfo(kInvalid)}));
    EXPECT_EQ(status, -2);
    g__JavaVM = vm.javaVm();
}

TEST_F(JavaInputStreamReadTest, BufferIsCheckedBeforeTheMachine) {
    make();
    g__JavaVM = nullptr;
    EXPECT_THAT(onEngine([&] { status = stream->read(nullptr, 10, readLen); }),
                ReturnsNothing().logs({bridgeError("JavaInputStream::read(): buffer==NULL\n")}));
    EXPECT_EQ(status, -1);
    g__JavaVM = vm.javaVm();
}

// What Java returned is judged before the flag: such a read detaches.
TEST_F(JavaInputStreamReadTest, InvalidatedDuringAReadOfNothingDetaches) {
    int count = 0;
    replace("readStream", "(I)I", [&](const fakejni::Invocation&) {
        stream->setInvalid();
        return Value::ofInt(count);
    });
    const auto readInvalidated = [&](int javaCount) {
        count = javaCount;
        make();
        std::vector<LogLine> lines =
            onEngine([&] { status = stream->read(buffer.data(), 10, readLen); }).log;
        EXPECT_EQ(vm.attachedThreads(), 0);
        return lines.empty() ? std::string() : lines.back().text;
    };
    EXPECT_EQ(readInvalidated(0),
              "JavaInputStream::read(): just return ORV_STREAM_ERROR_CODE_EOF!\n");
    EXPECT_EQ(status, -2);
    EXPECT_EQ(readInvalidated(-5),
              "JavaInputStream::read(): just return ORV_STREAM_ERROR_CODE_NOT_OK!\n");
    EXPECT_EQ(status, -1);
}

// A stream that is invalidated while Java reads ends without detaching.
TEST_F(JavaInputStreamReadTest, InvalidatedDuringTheReadStaysAttached) {
    replace("readStream", "(I)I", [&](const fakejni::Invocation&) {
        stream->setInvalid();
        return Value::ofInt(10);
    });
    make();
    bool attached = false;
    vm.onNativeThread([&] {
        status = stream->read(buffer.data(), 10, readLen);
        attached = vm.isAttached();
        vm.detach();
    });
    EXPECT_TRUE(attached);
    EXPECT_EQ(status, -2);
    EXPECT_EQ(readLen, 0);
    EXPECT_EQ(copied(), 0u);
    EXPECT_EQ(log.lines().back().text, kInvalid);
}

TEST_F(JavaInputStreamReadTest, ExceptionOfTheJavaSideEndsTheRead) {
    replace("readStream", "(I)I", [&](const fakejni::Invocation& call) {
        call.vm.raise(kIo, "unplugged");
        return Value::ofInt(10);
    });
    make();
    onEngine([&] { status = stream->read(buffer.data(), 10, readLen); });
    EXPECT_EQ(status, -2);
    EXPECT_EQ(readLen, 0);
}

TEST_F(JavaInputStreamReadTest, ManyReadsLeaveNothingBehind) {
    answer("readStream", "(I)I", Value::ofInt(100));
    make();
    vm.onNativeThread([&] {
        for (int i = 0; i < 2000; ++i) stream->read(buffer.data(), 100, readLen);
    });
    EXPECT_EQ(vm.attachedThreads(), 0);
    EXPECT_THAT(vm.unreleased(), testing::IsEmpty());
}

}  // namespace
}  // namespace orvtest
