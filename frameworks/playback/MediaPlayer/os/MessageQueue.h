// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "os/CountedQueue.h"
#include "os/Mutex.h"
#include "os/ScopedMutex.h"
#include "os/Semaphore.h"

namespace os {

// A FIFO without a limit, for any number of senders and exactly one receiver.
// Items still queued when it is destroyed are dropped, not freed.
template <typename T>
class MessageQueue {
public:
    MessageQueue() : mWakeUp(0) {}

    void send(const T& item) {
        ScopedMutex lock(mMutex);
        const bool wasEmpty = mQueue.empty();
        mQueue.push(item);
        if (wasEmpty) mWakeUp.release();
    }

    // Blocks until there is an item.
    T recv() {
        // The semaphore is a wake-up hint, posted when the queue stops being
        // empty; a receiver that finds items never takes it, so it may wake
        // for nothing.
        while (mQueue.empty()) mWakeUp.acquire();
        ScopedMutex lock(mMutex);
        return mQueue.pop();
    }

private:
    CountedQueue<T> mQueue;
    Mutex mMutex;
    Semaphore mWakeUp;
};

}  // namespace os
