// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

namespace stress {

// One more step of some thread: the watchdog sees that the program goes on.
void step();
uint64_t steps();

// Starts a thread that ends the program with status 3 when there is no step for that
// long, after it has printed where each thread stands.
void startWatchdog(unsigned stallSeconds);

}  // namespace stress
