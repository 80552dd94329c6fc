// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>

#include <atomic>
#include <queue>

#include "os/Mutex.h"
#include "os/ScopedMutex.h"
#include "os/Semaphore.h"

namespace os {

// A FIFO without a limit, for any number of senders and exactly one receiver.
// Items still queued when it is destroyed are dropped, not freed.
template <typename T>
class MessageQueue {
public:
    MessageQueue() : mWakeUp(0), mSize(0) {}

    void send(const T& item) {
        ScopedMutex lock(mMutex);
        const bool wasEmpty = mQueue.empty();
        mQueue.push(item);
        mSize.fetch_add(1, std::memory_order_release);
        if (wasEmpty) mWakeUp.release();
    }

    // Blocks until there is an item.
    T recv() {
        // The semaphore is a wake-up hint, posted when the queue stops being
        // empty; a receiver that finds items never takes it, so it may wake
        // for nothing.
        while (mSize.load(std::memory_order_acquire) == 0) mWakeUp.acquire();
        ScopedMutex lock(mMutex);
        T item = mQueue.front();
        mQueue.pop();
        mSize.fetch_sub(1, std::memory_order_relaxed);
        return item;
    }

private:
    std::queue<T> mQueue;
    Mutex mMutex;
    Semaphore mWakeUp;
    // The queue's length, for the test of emptiness without the mutex.
    std::atomic<size_t> mSize;
};

}  // namespace os
