// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <random>

namespace stress {

// The choices of one thread: the same for the same seed and thread number.
class Random {
public:
    Random(uint32_t seed, uint32_t thread) {
        std::seed_seq sequence{seed, thread};
        mEngine.seed(sequence);
    }

    // 0 to count - 1. By remainder, as the library's distributions differ.
    uint32_t below(uint32_t count) { return static_cast<uint32_t>(mEngine()) % count; }
    bool oneIn(uint32_t count) { return below(count) == 0; }

private:
    std::mt19937 mEngine;
};

}  // namespace stress
