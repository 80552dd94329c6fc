// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>

#include <atomic>
#include <memory>
#include <queue>

namespace os {

// A FIFO whose emptiness can be tested without a lock; push and pop need the
// owner's. It is as large as the std::queue<T> that it holds, so that the fields
// after it keep the offsets that they have after a plain one.
template <typename T>
class CountedQueue {
public:
    // Any thread. False also makes what the sender wrote before its push visible.
    bool empty() const { return mSize.load(std::memory_order_acquire) == 0; }

    void push(const T& item) {
        mItems->push(item);
        mSize.fetch_add(1, std::memory_order_release);
    }

    // The oldest item; there must be one.
    T pop() {
        T item = mItems->front();
        mItems->pop();
        mSize.fetch_sub(1, std::memory_order_relaxed);
        return item;
    }

private:
    using Items = std::unique_ptr<std::queue<T>>;

    Items mItems = std::make_unique<std::queue<T>>();
    std::atomic<size_t> mSize{0};
    [[maybe_unused]] char
        mReserved[sizeof(std::queue<T>) - sizeof(Items) - sizeof(std::atomic<size_t>)];
};

}  // namespace os
