// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <string>
#include <vector>

namespace stress {

struct RoundSize {
    uint32_t threads;  // the last quarter reads streams, the others run Java
    uint32_t players;  // at a time; half of them draw on surfaces
    uint32_t calls;    // of each thread
};

// Runs that many random calls, each thread's as its seed and number have them, then
// releases every player. What went wrong, empty for nothing.
std::vector<std::string> runRound(uint32_t seed, const RoundSize& size);

}  // namespace stress
