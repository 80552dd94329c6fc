// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include "Round.h"

namespace stress {

struct Options {
    RoundSize size = {8, 4, 200};
    uint32_t rounds = 4;
    uint32_t seconds = 0;  // rounds until then, instead
    uint32_t seed = 1;     // of the first round; each has the next
    uint32_t perturb = 0;  // 0: not
    uint32_t stall = 60;   // seconds without a step after which the program ends
    bool deadlock = false;
};

// Of the program's arguments and ORV_PERTURB. Ends the program for wrong ones.
Options parseOptions(int argc, char** argv);

}  // namespace stress
