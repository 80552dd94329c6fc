// SPDX-License-Identifier: Apache-2.0
// What the Java player costs, with the real library, engine and media. The loops
// are Java's: one call from here has it do a whole batch. Times are the wall
// clock's, for much happens on other threads; "CPU" is that of all threads.

#include <android/log.h>
#include <benchmark/benchmark.h>
#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>

#include <string>
#include <vector>

#include "ByHand.h"
#include "Failure.h"
#include "JavaMachine.h"
#include "JavaWorkload.h"
#include "LibraryBenchmarks.h"
#include "LogToNowhere.h"
#include "stream/JavaInputStream.h"

namespace orvbench {
namespace {

// Short calls are made in batches, long ones one by one, some of them each after a rewind.
constexpr int kBatch = 1000;

void measureCalls(benchmark::State& state, JavaWorkload& workload) {
    while (!workload.failed() && state.KeepRunningBatch(kBatch)) workload.run(kBatch);
}

void measureCallsWithLog(benchmark::State& state, JavaWorkload& workload) {
    const LogToNowhere log;
    measureCalls(state, workload);
}

void measureLongCalls(benchmark::State& state, JavaWorkload& workload) {
    while (!workload.failed() && state.KeepRunningBatch(1)) workload.run(1);
}

void measureEach(benchmark::State& state, JavaWorkload& workload) {
    while (!workload.failed() && state.KeepRunningBatch(1)) {
        state.PauseTiming();
        workload.rewind();
        state.ResumeTiming();
        workload.run(1);
    }
}

using Measure = void (*)(benchmark::State& state, JavaWorkload& workload);

void benchmarkWorkload(benchmark::State& state, const char* factory, Measure measure) {
    JavaWorkload workload(factory);
    // What happens the first time alone, such as reading the file's details.
    workload.rewind();
    workload.run(1);
    measure(state, workload);
    workload.close();
    if (workload.failed()) fail(state, workload.failure());
}

// Each read is on a thread that Java does not know, or no more.
template <typename Read>
void readAll(benchmark::State& state, Read read) {
    std::vector<char> buffer(state.range(0));
    const int length = static_cast<int>(buffer.size());
    for (auto _ : state) {
        const int count = read(buffer.data(), length);
        if (count != length || buffer.back() != 'm') return fail(state, "too few bytes came");
        buffer.back() = 0;
    }
    state.SetBytesProcessed(state.iterations() * length);
}

// What the engine does to read.
void readByLibrary(benchmark::State& state, jobject player) {
    JavaInputStream stream(javaEnv(), player);
    readAll(state, [&](char* buffer, int length) {
        int count = 0;
        stream.read(buffer, length, count);
        return count;
    });
    javaEnv();  // Reading has detached this thread, and the stream needs it.
}

void readWithoutLibrary(benchmark::State& state, jobject player) {
    JavaVM* java = javaMachine();
    readAll(state,
            [&](char* buffer, int length) { return readByHand(java, player, buffer, length); });
}

using ReadAllOf = void (*)(benchmark::State& state, jobject player);

void benchmarkStream(benchmark::State& state, ReadAllOf readAllOf) {
    JavaWorkload workload("stream");
    if (!workload.failed()) readAllOf(state, workload.player());
    workload.close();
    if (workload.failed()) fail(state, workload.failure());
}

struct Benchmark {
    const char* name;
    const char* factory;
    Measure measure;
    benchmark::TimeUnit unit;
};

constexpr Benchmark kBenchmarks[] = {
    {"by_hand/empty_native", "emptyNative", measureCalls, benchmark::kNanosecond},
    {"by_hand/empty_jna", "emptyJna", measureCalls, benchmark::kNanosecond},
    {"by_hand/empty_foreign", "emptyForeign", measureCalls, benchmark::kNanosecond},
    {"call/current_position", "currentPosition", measureCalls, benchmark::kNanosecond},
    {"call/duration/log:silent", "duration", measureCalls, benchmark::kNanosecond},
    {"call/duration/log:info", "duration", measureCallsWithLog, benchmark::kNanosecond},
    {"call/audio_tracks", "audioTracks", measureCalls, benchmark::kNanosecond},
    {"call/tracks:1", "oneTrack", measureLongCalls, benchmark::kNanosecond},
    {"call/tracks:8", "eightTracks", measureLongCalls, benchmark::kNanosecond},
    {"call/tracks:64", "sixtyFourTracks", measureLongCalls, benchmark::kNanosecond},
    {"call/pcm_description", "pcmDescription", measureCalls, benchmark::kNanosecond},
    {"player/create_and_release", "createAndRelease", measureEach, benchmark::kMillisecond},
    {"player/open", "open", measureEach, benchmark::kMillisecond},
    {"player/seek", "seek", measureEach, benchmark::kMillisecond},
    {"player/thumbnail", "thumbnail", measureEach, benchmark::kMillisecond},
};

void registerStream(const char* name, ReadAllOf readAllOf) {
    benchmark::RegisterBenchmark(name, benchmarkStream, readAllOf)
        ->Arg(4 << 10)
        ->Arg(64 << 10)
        ->MeasureProcessCPUTime()
        ->UseRealTime();
}

void registerAll() {
    for (const Benchmark& each : kBenchmarks) {
        benchmark::RegisterBenchmark(each.name, benchmarkWorkload, each.factory, each.measure)
            ->Unit(each.unit)
            ->MeasureProcessCPUTime()
            ->UseRealTime();
    }
    registerStream("stream/read", readByLibrary);
    registerStream("by_hand/read", readWithoutLibrary);
    registerLibraryBenchmarks();
}

// The log's priority is this program's affair.
bool startJavaSilently() {
    unsetenv("ORV_LOG");
    __android_log_set_minimum_priority(ANDROID_LOG_SILENT);
    const auto nothing = reinterpret_cast<uintptr_t>(orv_bench_nothing);
    return startJava({"-Djava.class.path=" ORV_BENCH_CLASS_PATH,
                      "-Dorv.bench.nothing=" + std::to_string(nothing),
                      "--enable-native-access=ALL-UNNAMED",
                      "-Djava.library.path=" ORV_BENCH_LIBRARY_PATH,
                      "-Dorv.bench.media=" ORV_BENCH_MEDIA, "-XX:+UseSerialGC"}) == JNI_OK;
}

}  // namespace
}  // namespace orvbench

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
    if (!orvbench::startJavaSilently()) {
        fprintf(stderr, "orv_bench: the Java virtual machine does not start\n");
        return 1;
    }
    if (!orvbench::prepareByHand(orvbench::javaEnv())) {
        fprintf(stderr, "orv_bench: %s\n", orvbench::takeException().c_str());
        return 1;
    }
    orvbench::registerAll();
    const size_t count = benchmark::RunSpecifiedBenchmarks();
    orvbench::endJava();
    return count > 0 && !orvbench::anyFailed() ? 0 : 1;
}
