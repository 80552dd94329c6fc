// SPDX-License-Identifier: Apache-2.0
#include "Progress.h"

#include <stdio.h>
#include <time.h>
#include <unistd.h>

#include <atomic>
#include <thread>

#include "Stacks.h"

namespace stress {

namespace {

std::atomic<uint64_t> sSteps{0};

[[noreturn]] void watch(unsigned stallSeconds) {
    uint64_t seen = steps();
    unsigned quiet = 0;
    for (;;) {
        const timespec second = {1, 0};
        clock_nanosleep(CLOCK_MONOTONIC, 0, &second, nullptr);  // nanosleep is replaced here
        const uint64_t now = steps();
        quiet = now == seen ? quiet + 1 : 0;
        seen = now;
        if (quiet < stallSeconds) continue;
        fprintf(stderr, "No thread made a step for %u s. Where they stand:\n", stallSeconds);
        printStacks();
        _exit(3);
    }
}

}  // namespace

void step() { sSteps.fetch_add(1, std::memory_order_relaxed); }

uint64_t steps() { return sSteps.load(std::memory_order_relaxed); }

void startWatchdog(unsigned stallSeconds) { std::thread(watch, stallSeconds).detach(); }

}  // namespace stress
