// SPDX-License-Identifier: Apache-2.0
// A player's service under other threads: lookups, releases, the dispatcher.
#include <jni/PlayerContext.h>
#include <jni/VideoSurface.h>

#include <chrono>
#include <functional>
#include <future>
#include <memory>

#include "DispatcherFixture.h"
#include "FakeJni/EnvSupport.h"
#include "MutexProbe.h"

namespace orvtest {
namespace {

using android::getMediaService;
using android::OrvMediaService;
using android::sp;
using testing::IsEmpty;

void joinAll(std::vector<std::thread>& threads) {
    for (std::thread& thread : threads) thread.join();
}

// While it lives, the action runs on its thread between the read of a Java long
// field and what is done with the value: there the field's lock counts.
class AfterFieldRead {
public:
    AfterFieldRead(JNIEnv* env, std::function<void()> action) : mEnv(env) {
        static const JNINativeInterface table = tableWithAction();
        sAction = std::move(action);
        env->functions = &table;
    }
    ~AfterFieldRead() { mEnv->functions = fakejni::envTable(); }
    AfterFieldRead(const AfterFieldRead&) = delete;
    AfterFieldRead& operator=(const AfterFieldRead&) = delete;

private:
    static JNINativeInterface tableWithAction() {
        JNINativeInterface table = *fakejni::envTable();
        table.GetLongField = [](JNIEnv* env, jobject object, jfieldID field) {
            const jlong value = fakejni::envTable()->GetLongField(env, object, field);
            sAction();
            return value;
        };
        return table;
    }

    static thread_local std::function<void()> sAction;
    JNIEnv* mEnv;
};
thread_local std::function<void()> AfterFieldRead::sAction;

class PlayerContextThreadsTest : public DispatcherFixture {
protected:
    Outcome release() { return call<void>("native_release", "()V"); }
    jlong context() { return player->get("mNativeContext").integer; }
    sp<OrvMediaService> service() { return getMediaService(vm.env(), vm.local(player)); }

    void replaceBy(const sp<OrvMediaService>& next) {
        android::setMediaService(vm.env(), vm.local(player), next);
    }

    // Runs one, and the other on another thread when one has read the field:
    // the other must wait for it.
    void expectToExclude(const std::function<void()>& one, const std::function<void()>& other) {
        std::unique_ptr<OtherThread> second;
        const AfterFieldRead startOther(vm.env(), [&] {
            second = std::make_unique<OtherThread>(
                other, [&](const std::function<void()>& run) { vm.onJavaThread(run); });
            EXPECT_TRUE(second->isStopped());
        });
        one();
        ASSERT_NE(second, nullptr);
        second->join();
    }

    // Threads that each look the service up so often and hand it to use.
    template <typename Use>
    std::vector<std::thread> lookUp(int threadCount, int times, Use use) {
        std::vector<std::thread> threads;
        for (int i = 0; i < threadCount; ++i) {
            threads.emplace_back([=] {
                vm.onJavaThread([&] {
                    const AfterFieldRead switchThreads(vm.env(), std::this_thread::yield);
                    jobject thiz = vm.local(player);
                    for (int n = 0; n < times; ++n) {
                        const sp<OrvMediaService> found = getMediaService(vm.env(), thiz);
                        if (found != nullptr) use(*found);
                    }
                });
            });
        }
        return threads;
    }
};

TEST_F(PlayerContextThreadsTest, ServiceOutlivesAReleaseOnAnotherThread) {
    setUpPlayer();
    sp<OrvMediaService> held = service();
    vm.onJavaThread([&] {
        fakejni::callNative<void>(vm, playerClass, vm.local(player), "native_release", "()V");
    });
    EXPECT_EQ(held->getStrongCount(), 1);
    EXPECT_TRUE(held->isPlayerExists());
}

// A release on another thread, at the method's last line: the service must stay
// until the method has returned.
TEST_F(PlayerContextThreadsTest, ServiceOutlivesAReleaseInsideACallThatOnlyLooksItUp) {
    const auto expectToOutliveARelease = [&](const std::string& function, const auto& body) {
        setUpPlayer();
        bool released = false;
        log.whenLogged(leave(function), [&] {
            vm.onJavaThread([&] {
                fakejni::callNative<void>(vm, playerClass, vm.local(player), "native_release",
                                          "()V");
            });
            released = true;
            EXPECT_EQ(ScriptedEngine::live(), 1) << function;
        });
        body();
        EXPECT_TRUE(released) << function;
        EXPECT_EQ(ScriptedEngine::live(), 0) << function;
        EXPECT_EQ(context(), 0) << function;
    };
    expectToOutliveARelease("OrvMediaClient_getParameter", [&] {
        call<void>("native_getParameter", "(ILandroid/os/Parcel;)V", 1, jobject{nullptr});
    });
    expectToOutliveARelease("decVideoSurfaceRef",
                            [&] { android::decVideoSurfaceRef(vm.env(), vm.local(player)); });
}

// The other thread must get its answer before the engine gives its own: nobody
// holds the field's lock meanwhile.
TEST_F(PlayerContextThreadsTest, ReleaseDetachesTheFieldBeforeTheEngineIsAsked) {
    jlong seen = -1;
    std::future<bool> findsNothing;
    const auto lookFromAnotherThread = [&] {
        bool nothing = false;
        vm.onJavaThread([&] { nothing = service() == nullptr; });
        return nothing;
    };
    setUpPlayer().whenCalled("release", [&] {
        seen = context();
        findsNothing = std::async(std::launch::async, lookFromAnotherThread);
        EXPECT_EQ(findsNothing.wait_for(std::chrono::seconds(10)), std::future_status::ready);
    });
    release();
    EXPECT_EQ(seen, 0);
    ASSERT_TRUE(findsNothing.valid());
    EXPECT_TRUE(findsNothing.get());
}

TEST_F(PlayerContextThreadsTest, ReleaseDropsThePendingEvents) {
    setUpPlayer();
    {
        const Hold held = hold();
        dispatcher->addAction(action(service(), 1));
        dispatcher->addAction(action(service(), 2));
        release();
    }
    const ExpectedLine dropped = dispatcherInfo("SyncToAsync::Run(): action is not valid");
    waitFor(dropped, 2);
    EXPECT_THAT(dispatcherLines(), LinesAre({dropped, dropped}));
    EXPECT_THAT(posted(), IsEmpty());
    EXPECT_THAT(pauses(), IsEmpty());
}

TEST_F(PlayerContextThreadsTest, ReplacementWaitsForALookupsReference) {
    const sp<OrvMediaService> first = new OrvMediaService;
    replaceBy(first);
    sp<OrvMediaService> found;
    expectToExclude([&] { found = service(); }, [&] { replaceBy(nullptr); });
    EXPECT_EQ(found, first);
    EXPECT_EQ(first->getStrongCount(), 2);  // both are this test's
}

TEST_F(PlayerContextThreadsTest, LookupWaitsForAReplacement) {
    replaceBy(new OrvMediaService);
    const sp<OrvMediaService> second = new OrvMediaService;
    sp<OrvMediaService> found;
    expectToExclude([&] { replaceBy(second); }, [&] { found = service(); });
    EXPECT_EQ(found, second);
}

TEST_F(PlayerContextThreadsTest, LookupsAndAReleaseMayRace) {
    setUpPlayer();
    std::vector<std::thread> threads =
        lookUp(4, 50, [](OrvMediaService& found) { found.isPlaying(); });
    vm.onJavaThread([&] {
        fakejni::callNative<void>(vm, playerClass, vm.local(player), "native_release", "()V");
    });
    joinAll(threads);
    EXPECT_EQ(context(), 0);
    EXPECT_EQ(ScriptedEngine::live(), 0);
}

// Each replacement destroys the service before, unless a lookup got hold of it.
TEST_F(PlayerContextThreadsTest, LookupsAndReplacementsMayRace) {
    std::vector<std::thread> threads =
        lookUp(3, 5000, [](OrvMediaService& found) { EXPECT_FALSE(found.isPlayerExists()); });
    for (int i = 0; i < 1000; ++i) replaceBy(new OrvMediaService);
    replaceBy(nullptr);
    joinAll(threads);
    EXPECT_EQ(context(), 0);
}

}  // namespace
}  // namespace orvtest
