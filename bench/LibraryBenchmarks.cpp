// SPDX-License-Identifier: Apache-2.0
#include "LibraryBenchmarks.h"

#include <android/log.h>
#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <log/log.h>
#include <orvtarn/TarnPlayer.h>
#include <stdio.h>
#include <string.h>
#include <sys/mman.h>
#include <unistd.h>

#include <string>
#include <thread>
#include <vector>

#include "ByHand.h"
#include "Failure.h"
#include "JavaMachine.h"
#include "JavaWorkload.h"
#include "LogToNowhere.h"
#include "dispatch/MsgDispatcher.h"
#include "dispatch/SyncToAsync.h"
#include "jni/media-service/OrvMediaService.h"
#include "os/MemoryPool.h"

using android::OrvMediaService;
using android::sp;

namespace orvbench {
namespace {

// The engine's own position, without and with a service in front.
void benchmarkPosition(benchmark::State& state, bool withService) {
    const sp<android::TarnPlayer> engine = new android::TarnPlayer(-1);
    const sp<OrvMediaService> service = new OrvMediaService;
    service->attachPlayer(engine);
    int msec = 0;
    if (service->setDataSource(ORV_BENCH_MEDIA "/feature.mkv", nullptr) != 0 ||
        service->prepare() != 0) {
        return fail(state, "the film cannot be opened");
    }
    for (auto _ : state) {
        benchmark::DoNotOptimize(withService ? service->getCurrentPosition(&msec)
                                             : engine->getCurrentPosition(&msec));
    }
    service->disconnect();
}

void benchmarkVirtualCall(benchmark::State& state) {
    Virtual* some = &someVirtual();
    int msec = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(some);
        benchmark::DoNotOptimize(some->position(&msec));
    }
}

// A player to post to, the references that a poster has, and no listener.
class Receiver {
public:
    Receiver() : mWorkload("stream") {
        if (mWorkload.failed()) return;
        JNIEnv* env = javaEnv();
        jclass type = env->FindClass("java/lang/ref/WeakReference");
        jmethodID make = env->GetMethodID(type, "<init>", "(Ljava/lang/Object;)V");
        jobject weak = env->NewObject(type, make, mWorkload.player());
        mWeak = env->NewGlobalRef(weak);
        mClass = static_cast<jclass>(env->NewGlobalRef(env->GetObjectClass(mWorkload.player())));
    }
    ~Receiver() {
        JNIEnv* env = javaEnv();
        env->DeleteGlobalRef(mWeak);
        env->DeleteGlobalRef(mClass);
        mWorkload.close();
    }
    Receiver(const Receiver&) = delete;
    Receiver& operator=(const Receiver&) = delete;

    const JavaWorkload& workload() const { return mWorkload; }
    jobject weak() const { return mWeak; }
    jclass type() const { return mClass; }

private:
    JavaWorkload mWorkload;
    jobject mWeak = nullptr;
    jclass mClass = nullptr;
};

// No event that the player knows: nothing but the way to it is measured.
constexpr int kUnknownEvent = 9999;

void benchmarkEvent(benchmark::State& state) {
    const Receiver receiver;
    if (receiver.workload().failed()) return fail(state, receiver.workload().failure());
    const sp<ORV::MsgDispatcher> dispatcher =
        new ORV::MsgDispatcher(javaEnv(), receiver.workload().player(), receiver.weak());
    for (auto _ : state) dispatcher->notify(kUnknownEvent, 0, 0, nullptr);
    javaEnv();  // Posting has detached this thread.
}

void benchmarkEventByHand(benchmark::State& state) {
    const Receiver receiver;
    if (receiver.workload().failed()) return fail(state, receiver.workload().failure());
    JavaVM* java = javaMachine();
    for (auto _ : state) postByHand(java, receiver.type(), receiver.weak(), kUnknownEvent);
    javaEnv();
}

// Events that come at once for a player that is gone: until the last is freed.
void benchmarkPendingEvents(benchmark::State& state) {
    ORV::SyncToAsync* dispatcher = ORV::SyncToAsync::getInstance();
    const sp<OrvMediaService> service = new OrvMediaService;
    for (auto _ : state) {
        for (int64_t i = 0; i < state.range(0); i++) {
            auto* action = new ORV::SyncToAsyncAction;
            action->payload = new NotifyMessage{kUnknownEvent, 0, 0, nullptr};
            action->service = service;
            dispatcher->addAction(action);
        }
        dispatcher->abortAllActions(service, false);
        while (service->getStrongCount() > 1) std::this_thread::yield();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void benchmarkPool(benchmark::State& state) {
    const int size = static_cast<int>(state.range(0));
    mem_init();
    for (auto _ : state) mem_free(mem_alloc(size));
    mem_uninit();
}

void benchmarkMapping(benchmark::State& state) {
    const size_t size = state.range(0) + MEMORY_HEADER_SIZE;
    for (auto _ : state) {
        void* memory =
            mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        *static_cast<void* volatile*>(memory) = memory;
        munmap(memory, size);
    }
}

void benchmarkMemcpy(benchmark::State& state) {
    const std::vector<char> from(state.range(0), 'm');
    std::vector<char> to(state.range(0));
    for (auto _ : state) {
        memcpy(to.data(), from.data(), from.size());
        benchmark::ClobberMemory();
    }
}

// As long as most that the library writes.
void benchmarkLogLine(benchmark::State& state) {
    const LogToNowhere log;
    for (auto _ : state) {
        __android_log_print(ANDROID_LOG_INFO, "ORV::Benchmark", "%s: Enter, i4AttachRet = %d\n",
                            "MsgDispatcher::notify()", 0);
    }
}

void benchmarkLineByHand(benchmark::State& state) {
    const int nowhere = open("/dev/null", O_WRONLY | O_CLOEXEC);
    char line[256];
    for (auto _ : state) {
        const int length =
            snprintf(line, sizeof line, "I ORV::Benchmark: %s: Enter, i4AttachRet = %d\n",
                     "MsgDispatcher::notify()", 0);
        if (write(nowhere, line, length) != length) return fail(state, "nothing was written");
    }
    close(nowhere);
}

constexpr int kPage = 4 << 10;
constexpr int kSixteenPages = 64 << 10;

}  // namespace

void registerLibraryBenchmarks() {
    using benchmark::RegisterBenchmark;
    RegisterBenchmark("service/position", benchmarkPosition, true);
    RegisterBenchmark("engine/position", benchmarkPosition, false);
    RegisterBenchmark("by_hand/virtual_call", benchmarkVirtualCall);
    RegisterBenchmark("event/post", benchmarkEvent)->UseRealTime();
    RegisterBenchmark("by_hand/event", benchmarkEventByHand)->UseRealTime();
    RegisterBenchmark("event/pending", benchmarkPendingEvents)
        ->RangeMultiplier(10)
        ->Range(1, 100000)
        ->MeasureProcessCPUTime()
        ->UseRealTime();
    RegisterBenchmark("pool/allocate_and_free", benchmarkPool)->Arg(kPage)->Arg(kSixteenPages);
    RegisterBenchmark("by_hand/map_and_unmap", benchmarkMapping)->Arg(kPage)->Arg(kSixteenPages);
    RegisterBenchmark("by_hand/memcpy", benchmarkMemcpy)->Arg(kPage)->Arg(kSixteenPages);
    RegisterBenchmark("log/line", benchmarkLogLine)->UseRealTime();
    RegisterBenchmark("by_hand/line", benchmarkLineByHand)->UseRealTime();
}

}  // namespace orvbench
