// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

namespace stress {

// What became of the dispatcher's actions that Java did not get, as the log says,
// and what else is counted by its line.
struct LogCounts {
    uint64_t notValid;
    uint64_t noPoster;
    uint64_t cancelled;
    uint64_t listenerActions;  // made by a service's listener for an event
    uint64_t keptTexts;        // paths of timed texts and commands are not given back
};

// From now on the log is counted, and else dropped. It takes no lock: one would put
// an order on the threads that log.
void countLog();
// Since the start, on all threads.
LogCounts logCounts();

}  // namespace stress
