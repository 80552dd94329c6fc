// SPDX-License-Identifier: Apache-2.0
// The stream's two mutexes: which operation holds which while Java is asked.
#include <errno.h>

#include <optional>

#include "JavaInputStreamFixture.h"
#include "MutexProbe.h"
#include "PrivateMember.h"
#include "jni/JavaVm.h"
#include "os/ScopedMutex.h"

namespace orvtest {

ORV_OPEN_MEMBER(CallMutex, JavaInputStream, mCallMutex);
ORV_OPEN_MEMBER(StreamMutex, JavaInputStream, mStreamMutex);

namespace {

using fakejni::Value;
using testing::Each;
using testing::SizeIs;

// What another thread gets of the call mutex and of the stream mutex.
using Tried = std::pair<int, int>;

class JavaInputStreamLocksTest : public JavaInputStreamFixture {
protected:
    void SetUp() override {
        JavaInputStreamFixture::SetUp();
        make();
    }

    os::Mutex& callMutex() { return (*stream).*memberOf(CallMutex{}); }
    os::Mutex& streamMutex() { return (*stream).*memberOf(StreamMutex{}); }

    void look() {
        tried.emplace_back(tryFromAnotherThread(callMutex()), tryFromAnotherThread(streamMutex()));
    }
    void lookIn(const std::string& name, const std::string& signature, Value result) {
        replace(name, signature, [=](const fakejni::Invocation&) {
            look();
            return result;
        });
    }

    std::vector<Tried> tried;
};

TEST_F(JavaInputStreamLocksTest, SizePositionAndDurationAreSerialised) {
    vm.whenCalled("GetLongField", [this] { look(); });
    vm.onNativeThread([&] {
        stream->getFileLength();
        stream->getCurrentPosition();
        stream->getDuration();
    });
    vm.whenCalled("GetLongField", [] {});
    EXPECT_THAT(tried, SizeIs(3));
    EXPECT_THAT(tried, Each(Tried(EBUSY, 0)));
    EXPECT_EQ(tryFromAnotherThread(callMutex()), 0);
}

// Nothing of them is done, and no line comes, before the call mutex is theirs.
TEST_F(JavaInputStreamLocksTest, SizePositionAndDurationBeginWithTheCallMutex) {
    log.clear();
    g__JavaVM = nullptr;
    const std::pair<const char*, std::function<void()>> operations[] = {
        {"getFileLength", [&] { stream->getFileLength(); }},
        {"getCurrentPosition", [&] { stream->getCurrentPosition(); }},
        {"getDuration", [&] { stream->getDuration(); }}};
    for (const auto& [name, operation] : operations) {
        SCOPED_TRACE(name);
        std::optional<OtherThread> waiting;
        {
            const os::ScopedMutex held(callMutex());
            waiting.emplace(operation);
            EXPECT_TRUE(waiting->isStopped());
            EXPECT_THAT(log.take(), testing::IsEmpty());
        }
        waiting->join();
        EXPECT_THAT(log.take(), testing::Not(testing::IsEmpty()));
    }
    g__JavaVM = vm.javaVm();
}

TEST_F(JavaInputStreamLocksTest, ReadsAndSeeksHoldNoMutex) {
    lookIn("readStream", "(I)I", Value::ofInt(0));
    lookIn("seekStream", "(IJ)J", Value::ofLong(0));
    lookIn("timeSeekStream", "(JJ)J", Value::ofLong(0));
    lookIn("cancelRead", "()V", Value());
    lookIn("closeStream", "()V", Value());
    vm.onNativeThread([&] {
        char byte;
        int count;
        stream->read(&byte, 1, count);
        stream->byteSeek(E_ORV_STREAM_SEEK_SET, 0);
        stream->timeSeek(0, 0);
        stream->cancelRead();
        stream->closeStream();
    });
    EXPECT_THAT(tried, SizeIs(5));
    EXPECT_THAT(tried, Each(Tried(0, 0)));
}

TEST_F(JavaInputStreamLocksTest, LockAndUnlockAreTheEnginesOwn) {
    stream->lock();
    stream->lock();
    EXPECT_EQ(tryFromAnotherThread(streamMutex()), EBUSY);
    EXPECT_EQ(tryFromAnotherThread(callMutex()), 0);
    stream->unlock();
    EXPECT_EQ(tryFromAnotherThread(streamMutex()), EBUSY);
    stream->unlock();
    EXPECT_EQ(tryFromAnotherThread(streamMutex()), 0);
}

}  // namespace
}  // namespace orvtest
