// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <os/Mutex.h>

namespace orvtest {

// 0 when another thread could take the mutex at this moment, else EBUSY.
int tryFromAnotherThread(os::Mutex& mutex);

// Whether a thread waits for the mutex, which another one has.
bool isAwaited(os::Mutex& mutex);

}  // namespace orvtest
