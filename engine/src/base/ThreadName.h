// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <pthread.h>

namespace orvtarn {

// As debuggers and ps show it; at most 15 characters.
inline void nameThisThread(const char* name) { pthread_setname_np(pthread_self(), name); }

}  // namespace orvtarn
