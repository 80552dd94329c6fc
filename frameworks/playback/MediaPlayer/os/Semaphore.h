// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <semaphore.h>

#include "os/Export.h"

namespace os {

// A counting semaphore of this process. Results are 0, or -1 with errno.
class ORV_EXPORT Semaphore {
public:
    explicit Semaphore(int value);
    ~Semaphore();
    Semaphore(const Semaphore&) = delete;
    Semaphore& operator=(const Semaphore&) = delete;

    int acquire();
    // Waits until ms milliseconds after the start of the current second: up
    // to a second less than it says.
    int acquire(int ms);
    // Polls every 50 ms until it holds the semaphore; never gives up. 0.
    int tryAcquire();
    int release();

private:
    sem_t mSemaphore;
};

}  // namespace os
