// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <pthread.h>

#include "os/Lock.h"

namespace os {

// A recursive mutex: its owner may lock it again.
class ORV_EXPORT Mutex : public Lock {
public:
    Mutex();
    ~Mutex() override;
    Mutex(const Mutex&) = delete;
    Mutex& operator=(const Mutex&) = delete;

    int lock() override;
    int unlock() override;

private:
    pthread_mutex_t mMutex;
    pthread_mutexattr_t mAttributes;
};

}  // namespace os
