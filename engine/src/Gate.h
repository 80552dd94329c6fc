// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <atomic>
#include <condition_variable>
#include <mutex>

namespace orvtarn {

// Counts the operations under way, so that the player can be taken apart when
// none is left. Coming and going take no lock while the gate is open.
class Gate {
public:
    // An operation's stay inside. False when the gate is closed.
    class Pass {
    public:
        explicit Pass(Gate& gate) : mGate(gate), mInside(gate.enter()) {}
        ~Pass() {
            if (mInside) mGate.leave();
        }
        Pass(const Pass&) = delete;
        Pass& operator=(const Pass&) = delete;
        explicit operator bool() const { return mInside; }

    private:
        Gate& mGate;
        const bool mInside;
    };

    // Lets nobody in from now on. True for the one who closed it.
    bool close() { return (mState.fetch_or(kClosed) & kClosed) == 0; }

    // Blocks until everybody who was inside has left. Of a closed gate.
    void awaitEmpty() {
        std::unique_lock<std::mutex> lock(mMutex);
        mChanged.wait(lock, [this] { return mState == kClosed; });
    }

    // What the gate was closed for has been done, or is awaited.
    void setDone() {
        std::lock_guard<std::mutex> lock(mMutex);
        mDone = true;
        mChanged.notify_all();
    }
    void awaitDone() {
        std::unique_lock<std::mutex> lock(mMutex);
        mChanged.wait(lock, [this] { return mDone; });
    }

private:
    bool enter() {
        uint32_t state = mState;
        while ((state & kClosed) == 0) {
            if (mState.compare_exchange_weak(state, state + kOneInside)) return true;
        }
        return false;
    }

    void leave() {
        uint32_t state = mState;
        while ((state & kClosed) == 0) {
            if (mState.compare_exchange_weak(state, state - kOneInside)) return;
        }
        // Under the lock, without which the gate may be gone before this returns.
        std::lock_guard<std::mutex> lock(mMutex);
        mState -= kOneInside;
        mChanged.notify_all();
    }

    // Whether it is closed, and above that how many are inside.
    static constexpr uint32_t kClosed = 1;
    static constexpr uint32_t kOneInside = 2;

    std::atomic<uint32_t> mState{0};
    std::mutex mMutex;
    std::condition_variable mChanged;
    bool mDone = false;
};

}  // namespace orvtarn
