// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>
#include <functional>
#include <future>

namespace orvtest {

// An operation on a thread of its own, begun at once; the destructor waits for its end.
class OtherThread {
public:
    explicit OtherThread(std::function<void()> operation);

    // Waits until the operation sleeps, which is seen from its thread's state in the
    // kernel, or has ended without. For operations that nothing but the caller wakes.
    bool isAsleep();
    void join() { mEnd.get(); }

private:
    bool hasEnded() const;

    std::atomic<int> mThread{0};  // the kernel's number
    std::future<void> mEnd;
};

}  // namespace orvtest
