// SPDX-License-Identifier: Apache-2.0
// Fails the first call into the virtual machine that can fail, then the
// second, and so on until a run has none left to fail. Whatever fails, nothing
// may crash or leak, and the next run must be good.
#include "JavaInputStreamFixture.h"

namespace orvtest {
namespace {

class FailureInjectionTest : public JavaInputStreamFixture {
protected:
    // How many calls could fail.
    int failEach(const std::function<void()>& body) {
        const Untraced repeated(*this);
        for (int n = 1;; ++n) {
            SCOPED_TRACE("failed call " + std::to_string(n));
            const int before = vm.failures();
            vm.failNth(n);
            body();
            vm.forgetFailures();
            vm.clearPending();
            if (vm.failures() == before) return n - 1;
        }
    }

    void setupThenRelease() {
        const fakejni::ObjectPtr object = newPlayer();
        jobject weak = vm.local(vm.newObject("java/lang/ref/WeakReference"));
        callOn<void>(object, "native_setup", "(Ljava/lang/Object;)V", weak);
        EXPECT_EQ(ScriptedEngine::live(), 1);
        vm.forgetFailures();
        callOn<void>(object, "native_release", "()V");
        EXPECT_EQ(object->get("mNativeContext").integer, 0);
        EXPECT_EQ(ScriptedEngine::live(), 0);
        EXPECT_EQ(vm.globalReferences(), 0u);
    }
};

TEST_F(FailureInjectionTest, Setup) {
    // The poster goes on behind its own exception, and setup behind it.
    vm.tolerate("called with a pending java/lang/Exception");
    EXPECT_GE(failEach([&] { setupThenRelease(); }), 3);
}

TEST_F(FailureInjectionTest, DataSourceWithHeaders) {
    setUpPlayer();
    int reached = 0;
    const int calls = failEach([&] {
        jstring path = string("/a.mp4");
        jobjectArray keys = strings({"a", "b"});
        jobjectArray values = strings({"1", "2"});
        const Outcome outcome = call<void>(
            "native_setDataSource", "(Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V",
            path, keys, values);
        reached += outcome.engine.size() == 2;
        EXPECT_EQ(outcome.engine.empty(), outcome.thrown.has_value());
        EXPECT_TRUE(outcome.unreleased.empty());
    });
    EXPECT_EQ(calls, 5);  // the path, two keys, two values
    EXPECT_EQ(reached, 1);
}

TEST_F(FailureInjectionTest, GettersWithoutService) {
    for (const char* name :
         {"native_getCurrentPosition", "native_getDuration", "native_getVideoWidth",
          "native_getCurrentBytePosition", "native_getCurrentAudioIndex"}) {
        EXPECT_GE(failEach([&] { EXPECT_EQ(call<jint>(name, "()I").returned, "0"); }), 2) << name;
    }
}

TEST_F(FailureInjectionTest, FailedGettersWithService) {
    setUpPlayer().answer("getCurrentPosition", {-1004});
    engine->put("getCurrentPosition", 5);
    EXPECT_GE(
        failEach([&] { EXPECT_EQ(call<jint>("native_getCurrentPosition", "()I").returned, "5"); }),
        2);
}

TEST_F(FailureInjectionTest, ClassBinding) {
    EXPECT_EQ(failEach([&] { initClass(); }), 18);
    initClass();
    setupThenRelease();
}

TEST_F(FailureInjectionTest, StreamReads) {
    player->set("mStreamReadBuffer", fakejni::Value::of(vm.newBytes({1, 2, 3})));
    answer("readStream", "(I)I", fakejni::Value::ofInt(3));
    make();
    // A thread that cannot attach has no environment, so those two are spared.
    for (const char* function : {"CallIntMethod", "GetByteArrayElements"}) {
        vm.fail(function);
        vm.onNativeThread([&] {
            char buffer[3];
            int count = 0;
            stream->read(buffer, 3, count);
        });
        EXPECT_EQ(vm.attachedThreads(), 0);
    }
}

TEST_F(FailureInjectionTest, ThousandsOfPlayersLeaveNothingBehind) {
    const Untraced repeated(*this);
    for (int i = 0; i < 2000; ++i) {
        setUp(player);
        call<void>("native_release", "()V");
        ScriptedEngine::forgetAll();
    }
    EXPECT_EQ(vm.globalReferences(), 0u);
}

}  // namespace
}  // namespace orvtest
