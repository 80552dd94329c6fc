// SPDX-License-Identifier: Apache-2.0
#pragma once

// The order in which this library's static objects are made when it loads,
// across source files: the service lock first, then the dispatcher's mutex.
// They go in reverse at exit. No other object here needs code at load time.
#define ORV_INIT_ORDER(priority) __attribute__((init_priority(priority)))

#define ORV_INIT_SERVICE_LOCK 1001
#define ORV_INIT_DISPATCHER_MUTEX 1002
