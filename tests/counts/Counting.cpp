// SPDX-License-Identifier: Apache-2.0
#include "Counting.h"

#include <stdio.h>
#include <unistd.h>

// tools/counts/callgrind.py has instructions collected while a thread is in this
// function. The empty statement keeps the call from becoming a jump out of it.
extern "C" __attribute__((noinline)) void orv_counted(const std::function<void()>& body) {
    body();
    asm volatile("");
}

namespace orvcounts {

void repeat(int times, const Round& round) {
    round([](const std::function<void()>& body) { body(); });
    for (int i = 0; i < times; ++i) round(orv_counted);
}

void require(bool holds, const char* what) {
    if (holds) return;
    fprintf(stderr, "orv_counts: %s\n", what);
    _exit(1);
}

}  // namespace orvcounts
