// SPDX-License-Identifier: Apache-2.0
#include <condition_variable>
#include <memory>
#include <mutex>

#include "JavaInputStreamFixture.h"
#include "jni/JavaVm.h"
#include "stream/JavaInputStream.h"

namespace orvtest {
namespace {

using fakejni::Value;
using testing::ElementsAre;
using testing::IsEmpty;

class JavaInputStreamTest : public JavaInputStreamFixture {};

TEST_F(JavaInputStreamTest, ConstructionHoldsClassAndObjectAndReadsTheType) {
    player->set("mDataSourceType", Value::ofInt(7));
    EXPECT_THAT(
        make(),
        ReturnsNothing()
            .logs({enter(kConstructor),
                   bridgeInfo(std::string(kConstructor) + "(): E_Orv_Stream_Source_Type is 7\n"),
                   leave(kConstructor)})
            .makesGlobals(2));
    EXPECT_THAT(vm.callsOf("NewGlobalRef"), ElementsAre("java/lang/Class", kPlayerClass));
    EXPECT_TRUE(stream->isValid());
    EXPECT_FALSE(stream->isThreadSelf());
    EXPECT_EQ(stream->getDataSourceType(), 7);
}

TEST_F(JavaInputStreamTest, MissingClassLogsThePostersTextAndCarriesOn) {
    vm.tolerate("called with a pending java/lang/Exception");
    vm.fail("GetObjectClass");
    EXPECT_THAT(
        make(),
        ReturnsNothing()
            .logs({enter(kConstructor),
                   bridgeError("MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, "
                               "jobject weak_thiz): Can't find "
                               "com/quintora/mmp/OrvMediaPlayer"),
                   bridgeInfo(std::string(kConstructor) + "(): E_Orv_Stream_Source_Type is 0\n"),
                   leave(kConstructor)})
            .throws("java/lang/Exception")
            .makesGlobals(1));
}

TEST_F(JavaInputStreamTest, DestructionGivesTheObjectBackBeforeTheClass) {
    make();
    EXPECT_THAT(observeAction([&] { stream.reset(); }),
                ReturnsNothing()
                    .logs({enter("JavaInputStream::~JavaInputStream"),
                           leave("JavaInputStream::~JavaInputStream")})
                    .makesGlobals(-2));
    EXPECT_THAT(vm.callsOf("DeleteGlobalRef"), ElementsAre(kPlayerClass, "java/lang/Class"));
    EXPECT_THAT(vm.callsOf("AttachCurrentThread"), IsEmpty());
}

// Another thread's reads end while the references go.
TEST_F(JavaInputStreamTest, IsInvalidBehindTheFirstLineOfItsDestruction) {
    make();
    JavaInputStream* const dying = stream.get();
    std::vector<bool> valid;
    const auto look = [&] { valid.push_back(dying->isValid()); };
    log.whenLogged(enter("JavaInputStream::~JavaInputStream"), [&] {
        look();
        vm.whenCalled("GetEnv", look);
    });
    stream.reset();
    vm.whenCalled("GetEnv", [] {});
    EXPECT_THAT(valid, ElementsAre(true, false));
}

TEST_F(JavaInputStreamTest, SetInvalidLogsAndClearsTheFlag) {
    make();
    EXPECT_THAT(onEngine([&] { stream->setInvalid(); }),
                ReturnsNothing().logs(
                    {enter("JavaInputStream::setInvalid"), leave("JavaInputStream::setInvalid")}));
    EXPECT_FALSE(stream->isValid());
}

TEST_F(JavaInputStreamTest, IsInvalidBetweenTheLinesOfSetInvalid) {
    make();
    std::vector<bool> valid;
    log.whenLogged(enter("JavaInputStream::setInvalid"), [&] {
        valid.push_back(stream->isValid());
        log.whenLogged(leave("JavaInputStream::setInvalid"),
                       [&] { valid.push_back(stream->isValid()); });
    });
    stream->setInvalid();
    EXPECT_THAT(valid, ElementsAre(true, false));
}

TEST_F(JavaInputStreamTest, ThreadSelfIsAPlainFlag) {
    make();
    EXPECT_THAT(onEngine([&] { stream->setThreadSelf(); }), ReturnsNothing());
    EXPECT_TRUE(stream->isThreadSelf());  // on another thread than it was set
}

TEST_F(JavaInputStreamTest, SeekPassesTypeAndOffsetToJava) {
    answer("seekStream", "(IJ)J", Value::ofLong(jlong(1) << 40));
    make();
    long long position = 0;
    EXPECT_THAT(
        onEngine([&] { position = stream->byteSeek(E_ORV_STREAM_SEEK_CUR, (1LL << 33) + 5); }),
        ReturnsNothing().java({"seekStream(1, 8589934597)"}));
    EXPECT_EQ(position, 1LL << 40);
    EXPECT_THAT(vmCalls(), ElementsAre("GetEnv", "AttachCurrentThread", "GetIntField",
                                       "CallLongMethod", "DetachCurrentThread"));
}

TEST_F(JavaInputStreamTest, SeekTypeIsPassedUnchanged) {
    make();
    EXPECT_THAT(
        onEngine([&] { stream->byteSeek(static_cast<E_Orv_Stream_Seek_Type>(9), -1); }).java,
        ElementsAre("seekStream(9, -1)"));
}

TEST_F(JavaInputStreamTest, SourceType3SeeksExtendedAndIsAskedAfresh) {
    answer("seekStreamEx", "(IJ)J", Value::ofLong(-9));
    make();
    player->set("mDataSourceType", Value::ofInt(3));
    long long position = 0;
    EXPECT_THAT(onEngine([&] { position = stream->byteSeek(E_ORV_STREAM_SEEK_SET, 12); }),
                ReturnsNothing().java({"seekStreamEx(0, 12)"}));
    EXPECT_EQ(position, -9);
    EXPECT_EQ(stream->getDataSourceType(), 0);
}

TEST_F(JavaInputStreamTest, TimeSeekPassesBothTimesInOrder) {
    answer("timeSeekStream", "(JJ)J", Value::ofLong(77));
    make();
    long long position = 0;
    EXPECT_THAT(onEngine([&] { position = stream->timeSeek(1LL << 35, -2); }),
                ReturnsNothing().java({"timeSeekStream(34359738368, -2)"}));
    EXPECT_EQ(position, 77);
    EXPECT_THAT(vm.callsOf("GetIntField"), ElementsAre("mDataSourceType"));
}

TEST_F(JavaInputStreamTest, InvalidStreamRefusesSeeksWithoutJava) {
    make();
    stream->setInvalid();
    g__JavaVM = nullptr;  // not looked at
    long long positions[2] = {};
    EXPECT_THAT(onEngine([&] { positions[0] = stream->byteSeek(E_ORV_STREAM_SEEK_SET, 1); }),
                ReturnsNothing().logs(
                    {bridgeInfo("byteSeek input stream is not valid now, return directly!!!!")}));
    EXPECT_THAT(onEngine([&] { positions[1] = stream->timeSeek(1, 2); }),
                ReturnsNothing().logs(
                    {bridgeInfo("timeSeek input stream is not valid now, return directly!!!!")}));
    EXPECT_THAT(positions, ElementsAre(-1, -1));
    g__JavaVM = vm.javaVm();
}

TEST_F(JavaInputStreamTest, CancelAndCloseCallTheirVoidMethodsThroughTheLongForm) {
    make();
    stream->setInvalid();  // does not matter to these two
    for (const std::string name : {"cancelRead", "closeStream"}) {
        EXPECT_THAT(
            onEngine([&] { name == "cancelRead" ? stream->cancelRead() : stream->closeStream(); }),
            ReturnsNothing()
                .logs({bridgeInfo("JavaInputStream::" + name + " Enter\n"),
                       bridgeInfo("JavaInputStream::" + name + " Leave\n")})
                .java({name + "()"}));
        EXPECT_EQ(vm.javaCalls()[0].form, "CallLongMethod");
    }
}

TEST_F(JavaInputStreamTest, CurrentPositionIsSilentAnd64BitsWide) {
    player->set("mStreamCurPos", Value::ofLong(5000000000));
    make();
    long long position = 0;
    EXPECT_THAT(onEngine([&] { position = stream->getCurrentPosition(); }), ReturnsNothing());
    EXPECT_EQ(position, 5000000000);
}

TEST_F(JavaInputStreamTest, FlagsAndSeekTypeComeFromJava) {
    answer("getSeekType", "()I", Value::ofInt(2));
    make();
    for (const bool expected : {true, false}) {
        player->set("mStreamSeekable", Value::ofBoolean(expected));
        bool seekable = !expected;
        EXPECT_THAT(onEngine([&] { seekable = stream->isSeekable(); }), ReturnsNothing());
        EXPECT_EQ(seekable, expected);
    }
    int type = 0;
    EXPECT_THAT(onEngine([&] { type = stream->getSeekType(); }),
                ReturnsNothing().java({"getSeekType()"}));
    EXPECT_EQ(type, 2);
}

TEST_F(JavaInputStreamTest, StallingSupportIsLogged) {
    for (const bool expected : {true, false}) {
        player->set("mStallingSupport", Value::ofBoolean(expected));
        make();
        bool stalling = !expected;
        EXPECT_THAT(onEngine([&] { stalling = stream->isStallingSupport(); }),
                    ReturnsNothing().logs(
                        {bridgeInfo("isStallingSupport: AttachCurrentThread i4AttachRet = 0\n"),
                         bridgeInfo("isStallingSupport: whether stream is StallingSupport: " +
                                    std::to_string(expected) + "\n")}));
        EXPECT_EQ(stalling, expected);
    }
}

struct Getter {
    const char* name;
    const char* field;
    const char* label;
    uint32_t (JavaInputStream::*get)();
};
void PrintTo(const Getter& getter, std::ostream* out) { *out << getter.name; }

class JavaInputStreamGetterTest : public JavaInputStreamFixture,
                                  public testing::WithParamInterface<Getter> {
protected:
    uint32_t get(const std::string& first, const std::string& second) {
        const Getter& getter = GetParam();
        const std::string name = getter.name;
        const auto value = [&](const std::string& number) {
            return bridgeInfo(name + " " + getter.label + " = " + number + "\n");
        };
        uint32_t result = 0;
        EXPECT_THAT(onEngine([&] { result = (stream.get()->*getter.get)(); }),
                    ReturnsNothing().logs(
                        {bridgeInfo(name + " Enter\n"),
                         bridgeInfo(name + " g__JavaVM[X] = " + pointerText(vm.javaVm()) + "\n"),
                         bridgeInfo(name + " i4AttachRet = 0\n"), value(first), value(second),
                         bridgeInfo(name + " Leave\n")}));
        return result;
    }
};

TEST_P(JavaInputStreamGetterTest, ReturnsTheLow32Bits) {
    make();
    player->set(GetParam().field, Value::ofLong(5000000000));
    EXPECT_EQ(get("5000000000", "5000000000"), 705032704u);
    player->set(GetParam().field, Value::ofLong(1234));
    EXPECT_EQ(get("1234", "1234"), 1234u);
}

TEST_P(JavaInputStreamGetterTest, ZeroIsUnknownForTheLengthOnly) {
    make();
    const bool isLength = GetParam().field == std::string("mStreamSize");
    EXPECT_EQ(get("0", isLength ? "9223372036854775807" : "0"), isLength ? 0xFFFFFFFFu : 0u);
}

INSTANTIATE_TEST_SUITE_P(Getters, JavaInputStreamGetterTest,
                         testing::Values(Getter{"getFileLength", "mStreamSize", "stream size",
                                                &JavaInputStream::getFileLength},
                                         Getter{"getDuration", "mStreamDuration", "stream Duration",
                                                &JavaInputStream::getDuration}),
                         [](const testing::TestParamInfo<Getter>& info) {
                             return std::string(info.param.name);
                         });

TEST_F(JavaInputStreamTest, WithoutVmEveryCheckedOperationReportsItself) {
    make();
    g__JavaVM = nullptr;
    const auto line = [](const std::string& name) {
        return bridgeError(name + " g__JavaVM==NULL\n");
    };
    long long result = 9;
    EXPECT_THAT(onEngine([&] { result = stream->byteSeek(E_ORV_STREAM_SEEK_SET, 1); }),
                ReturnsNothing().logs({line("byteSeek")}));
    EXPECT_EQ(result, -1);
    EXPECT_THAT(onEngine([&] { result = stream->timeSeek(1, 2); }),
                ReturnsNothing().logs({line("timeSeek")}));
    EXPECT_EQ(result, -1);
    EXPECT_THAT(onEngine([&] { stream->cancelRead(); }),
                ReturnsNothing().logs(
                    {bridgeInfo("JavaInputStream::cancelRead Enter\n"), line("cancelRead")}));
    EXPECT_THAT(onEngine([&] { stream->closeStream(); }),
                ReturnsNothing().logs(
                    {bridgeInfo("JavaInputStream::closeStream Enter\n"), line("closeStream")}));
    EXPECT_THAT(
        onEngine([&] { result = stream->getFileLength(); }),
        ReturnsNothing().logs({bridgeInfo("getFileLength Enter\n"), line("getFileLength")}));
    EXPECT_EQ(result, 0);
    EXPECT_THAT(onEngine([&] { result = stream->getCurrentPosition(); }),
                ReturnsNothing().logs({line("getCurrentPosition")}));
    EXPECT_EQ(result, 0);
    EXPECT_THAT(onEngine([&] { result = stream->getDuration(); }),
                ReturnsNothing().logs({bridgeInfo("getDuration Enter\n"), line("getDuration")}));
    EXPECT_EQ(result, 0);
    EXPECT_THAT(vm.callsOf("AttachCurrentThread"), IsEmpty());
    g__JavaVM = vm.javaVm();
}

TEST_F(JavaInputStreamTest, CancelReachesJavaWhileAReadIsThere) {
    std::mutex mutex;
    std::condition_variable changed;
    bool reading = false;
    bool cancelled = false;
    replace("readStream", "(I)I", [&](const fakejni::Invocation&) {
        std::unique_lock<std::mutex> lock(mutex);
        reading = true;
        changed.notify_all();
        changed.wait_for(lock, std::chrono::seconds(10), [&] { return cancelled; });
        return Value::ofInt(cancelled ? -5 : 0);
    });
    replace("cancelRead", "()V", [&](const fakejni::Invocation&) {
        std::lock_guard<std::mutex> lock(mutex);
        cancelled = true;
        changed.notify_all();
        return Value();
    });
    make();
    int status = 0;
    std::thread reader([&] {
        char buffer[4];
        int count;
        status = stream->read(buffer, 4, count);
    });
    {
        std::unique_lock<std::mutex> lock(mutex);
        EXPECT_TRUE(changed.wait_for(lock, std::chrono::seconds(10), [&] { return reading; }));
    }
    vm.onNativeThread([&] { stream->cancelRead(); });
    reader.join();
    EXPECT_EQ(status, -1);
}

}  // namespace
}  // namespace orvtest
