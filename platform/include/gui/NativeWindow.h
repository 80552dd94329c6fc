// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <utils/RefBase.h>

#include <condition_variable>
#include <deque>
#include <mutex>
#include <string>

namespace android {

// A window of the desktop behind a surface, for a producer that draws on it by
// itself instead of filling buffers. The desktop's alone. It has one user at a time,
// and the window stays until the user has let go of it. Any thread.
class NativeWindow : public virtual RefBase {
public:
    // Who draws. Called on any thread, must not wait.
    class User {
    public:
        // The window is about to go, or its picture is to be drawn anew.
        virtual void onWindowChanged() = 0;

    protected:
        ~User() = default;
    };

    // How pictures come to the window.
    struct Drawing {
        bool byGpu = false;       // else by software, into the surface's buffers
        std::string description;  // the graphics processor's name, or why it is not used
    };

    struct Frame {
        uint64_t number = 0;  // from 1 on; 0 for none
        int64_t timeUs = 0;   // media time
    };

    // id: the X window on the display of the environment. acceptsSoftwareGl: also a
    // graphics processor that is only software is good enough.
    NativeWindow(unsigned long id, bool acceptsSoftwareGl)
        : mId(id), mAcceptsSoftwareGl(acceptsSoftwareGl) {}

    unsigned long id() const { return mId; }
    bool acceptsSoftwareGl() const { return mAcceptsSoftwareGl; }

    // For the user.

    // False when the window goes or has another user.
    bool connect(User* user);
    // Nothing of the user's touches the window any more.
    void disconnect(User* user);
    bool isClosing();
    // Whether a redraw was asked for since the last call.
    bool takeRedraw();
    // Whether the picture stays as it is: frames pass by undrawn.
    bool isHeld();
    void reportDrawing(const Drawing& drawing);
    // A frame is drawn, be it anew.
    virtual void reportFrame(int64_t timeUs) {
        std::lock_guard<std::mutex> lock(mLock);
        mCount++;
        mTimesUs.push_back(timeUs);
        if (mTimesUs.size() > kKnownFrames) mTimesUs.pop_front();
        mChanged.notify_all();
    }

    // For the owner.

    // Its content was lost, or it has another size.
    void redraw();
    // While held, the window keeps its picture; afterwards the newest one is drawn.
    void hold(bool held);
    // Before the window goes. Waits until the user has let go of it.
    void close();
    Drawing drawing();
    // How many frames were drawn since the window was made.
    uint64_t frameCount();
    // The frame after that number, or the oldest one that is still known; none when
    // the time is over or the window closes. Waits for it.
    Frame awaitFrame(uint64_t seen, int timeoutMs);

private:
    static constexpr size_t kKnownFrames = 64;

    const unsigned long mId;
    const bool mAcceptsSoftwareGl;
    std::mutex mLock;
    std::condition_variable mChanged;
    User* mUser = nullptr;
    bool mClosing = false;
    bool mRedraw = false;
    bool mHeld = false;
    Drawing mDrawing;
    uint64_t mCount = 0;
    std::deque<int64_t> mTimesUs;  // of the newest frames
};

}  // namespace android
