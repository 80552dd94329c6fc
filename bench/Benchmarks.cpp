// SPDX-License-Identifier: Apache-2.0
// What the Java player costs, with the real library, engine and media. The loops
// are Java's: one call from here has it do a whole batch. Times are the wall
// clock's, for much happens on other threads; "CPU" is that of all threads.

#include <android/log.h>
#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "JavaMachine.h"
#include "JavaWorkload.h"
#include "stream/JavaInputStream.h"

namespace orvbench {
namespace {

// Makes the program fail, too.
bool gFailed = false;

void fail(benchmark::State& state, const std::string& why) {
    state.SkipWithError(why.c_str());
    gFailed = true;
}

// While it lives, the log is written as ever, to where nobody reads it.
class LogToNowhere {
public:
    LogToNowhere() : mStandardError(dup(STDERR_FILENO)) {
        const int nowhere = open("/dev/null", O_WRONLY | O_CLOEXEC);
        dup2(nowhere, STDERR_FILENO);
        close(nowhere);
        __android_log_set_minimum_priority(ANDROID_LOG_INFO);
    }
    ~LogToNowhere() {
        __android_log_set_minimum_priority(ANDROID_LOG_SILENT);
        dup2(mStandardError, STDERR_FILENO);
        close(mStandardError);
    }
    LogToNowhere(const LogToNowhere&) = delete;
    LogToNowhere& operator=(const LogToNowhere&) = delete;

private:
    const int mStandardError;
};

// Short calls are made in batches; long ones one by one, each after a rewind.
constexpr int kBatch = 1000;

void measureCalls(benchmark::State& state, JavaWorkload& workload) {
    while (!workload.failed() && state.KeepRunningBatch(kBatch)) workload.run(kBatch);
}

void measureCallsWithLog(benchmark::State& state, JavaWorkload& workload) {
    const LogToNowhere log;
    measureCalls(state, workload);
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

// What the engine does to read, on a thread that Java does not know yet.
void readAll(benchmark::State& state, JavaInputStream& stream) {
    std::vector<char> buffer(state.range(0));
    const int length = static_cast<int>(buffer.size());
    for (auto _ : state) {
        int count = 0;
        stream.read(buffer.data(), length, count);
        if (count != length || buffer.back() != 'm') return fail(state, "too few bytes came");
        buffer.back() = 0;
    }
    state.SetBytesProcessed(state.iterations() * length);
}

void benchmarkStream(benchmark::State& state) {
    JavaWorkload workload("stream");
    if (!workload.failed()) {
        JavaInputStream stream(javaEnv(), workload.player());
        readAll(state, stream);
        javaEnv();  // Reading has detached this thread.
    }
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
    {"call/current_position", "currentPosition", measureCalls, benchmark::kNanosecond},
    {"call/duration/log:silent", "duration", measureCalls, benchmark::kNanosecond},
    {"call/duration/log:info", "duration", measureCallsWithLog, benchmark::kNanosecond},
    {"call/audio_tracks", "audioTracks", measureCalls, benchmark::kNanosecond},
    {"call/pcm_description", "pcmDescription", measureCalls, benchmark::kNanosecond},
    {"player/create_and_release", "createAndRelease", measureEach, benchmark::kMillisecond},
    {"player/open", "open", measureEach, benchmark::kMillisecond},
    {"player/seek", "seek", measureEach, benchmark::kMillisecond},
    {"player/thumbnail", "thumbnail", measureEach, benchmark::kMillisecond},
};

void registerAll() {
    for (const Benchmark& each : kBenchmarks) {
        benchmark::RegisterBenchmark(each.name, benchmarkWorkload, each.factory, each.measure)
            ->Unit(each.unit)
            ->MeasureProcessCPUTime()
            ->UseRealTime();
    }
    benchmark::RegisterBenchmark("stream/read", benchmarkStream)
        ->Arg(4 << 10)
        ->Arg(64 << 10)
        ->MeasureProcessCPUTime()
        ->UseRealTime();
}

// The log's priority is this program's affair.
bool startJavaSilently() {
    unsetenv("ORV_LOG");
    __android_log_set_minimum_priority(ANDROID_LOG_SILENT);
    return startJava({"-Djava.class.path=" ORV_BENCH_CLASS_PATH,
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
    orvbench::registerAll();
    const size_t count = benchmark::RunSpecifiedBenchmarks();
    orvbench::endJava();
    return count > 0 && !orvbench::gFailed ? 0 : 1;
}
