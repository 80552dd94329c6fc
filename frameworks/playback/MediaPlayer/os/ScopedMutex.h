// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "os/Lock.h"

namespace os {

// Holds a lock for as long as it lives.
class ORV_EXPORT ScopedMutex {
public:
    explicit ScopedMutex(Lock& lock) : mLock(lock) { mLock.lock(); }
    ~ScopedMutex() { mLock.unlock(); }
    ScopedMutex(const ScopedMutex&) = delete;
    ScopedMutex& operator=(const ScopedMutex&) = delete;

private:
    Lock& mLock;
};

}  // namespace os
