// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <condition_variable>
#include <mutex>

namespace orvtarn {

// Counts the operations under way, so that the player can be taken apart when
// none is left.
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
    bool close() {
        std::lock_guard<std::mutex> lock(mMutex);
        const bool first = !mClosed;
        mClosed = true;
        return first;
    }

    // Blocks until everybody who was inside has left.
    void awaitEmpty() {
        std::unique_lock<std::mutex> lock(mMutex);
        mChanged.wait(lock, [this] { return mInside == 0; });
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
        std::lock_guard<std::mutex> lock(mMutex);
        if (mClosed) return false;
        mInside++;
        return true;
    }

    void leave() {
        std::lock_guard<std::mutex> lock(mMutex);
        if (--mInside == 0) mChanged.notify_all();
    }

    std::mutex mMutex;
    std::condition_variable mChanged;
    int mInside = 0;
    bool mClosed = false;
    bool mDone = false;
};

}  // namespace orvtarn
