// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

namespace stress {

// Yields and short sleeps at the points where threads meet: before and after each
// mutex is taken and given back, each semaphore is posted or awaited, and each
// reference to a counted object is taken or dropped. The fake Java machine takes a
// mutex in each of its functions, so these are points, too.
//
// Which points pause follows from the seed, the thread's number and how many points
// that thread came past; what the other threads do meanwhile does not.

// From now on; seed 0 for none.
void setPerturbation(uint32_t seed);
// The calling thread's number for its choices; those that have none share one.
void setPerturbationThread(uint32_t number);
// How many pauses there were so far, on all threads.
uint64_t perturbations();

}  // namespace stress
