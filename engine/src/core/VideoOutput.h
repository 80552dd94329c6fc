// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <mpv/client.h>
#include <stdint.h>
#include <utils/StrongPointer.h>

#include <atomic>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <optional>
#include <thread>

#include "core/DrawTarget.h"

namespace orvtarn {

// Has mpv's video frames drawn on the surface when it is time, on a thread of its
// own, the only one that renders, which begins with the first picture or window. Never
// holds up playback: a surface without a free buffer misses a frame, and gets the newest
// one when it has.
class VideoOutput {
public:
    using Producer = DrawTarget::Producer;

    struct Counters {
        uint64_t delivered;  // frames handed to the surface
        uint64_t missed;     // frames that found no free buffer
    };

    // onFrame: after each picture that was drawn or had no surface to go to.
    // frameTime: has the media time of the frame of that number sought, which is due at that
    // moment of mpv's clock; both in microseconds. The frame is held until
    // setFrameTime. When the next frame is here first, it gets the returned time,
    // and without one it is dropped. Both are called on the rendering thread, which
    // must not ask mpv.
    using FrameTime = std::function<std::optional<int64_t>(uint64_t frame, int64_t due)>;
    // exchange: see DrawTarget.
    VideoOutput(std::function<void()> onFrame, FrameTime frameTime, DrawTarget::Exchange exchange)
        : mOnFrame(std::move(onFrame)),
          mFrameTime(std::move(frameTime)),
          mExchange(std::move(exchange)),
          mTarget([this] { onUpdate(); },
                  [this](bool onWindow, const std::function<void()>& change) {
                      mHasPicture = false;
                      mExchange(onWindow, change);
                  }) {}
    ~VideoOutput() { destroy(); }

    // Once; the surface may be there before.
    bool create(mpv_handle* mpv);
    // Before mpv goes, and quicker when no media is open.
    void destroy();

    // Whether the surface is to be set after create: it is then found out at once
    // whether its window can be drawn on.
    static bool hasWindow(const Producer& producer);
    // Null for none. No frame goes to an earlier surface afterwards; the new
    // one gets the picture at once, paused or not. Waits for the rendering thread.
    void setProducer(const Producer& producer);
    // Any thread.
    void setFrameTime(uint64_t frame, int64_t microseconds);
    // Whether frames go to the surface at all.
    void setVisible(bool visible);
    void setVideoSize(int width, int height) { mVideoSize = FrameSize{width, height}; }
    // The media is closed: nothing is drawn again before the next frame.
    void forgetPicture() { mHasPicture = false; }

    Counters counters() const { return {mDelivered, mMissed}; }

private:
    void startThread();
    void onUpdate();
    void wake(bool redraw);
    void run();
    void attach(const Producer& producer);
    bool attendWindow();
    bool takeFrame();
    bool render(bool newFrame);
    android::status_t draw();
    FrameSize wantedSize();
    bool isShown() const { return mTarget.hasSurface() && mVisible && !mTarget.isHeld(); }
    bool isBehind();
    void queue();
    void deliverHeld(uint64_t frame, int64_t microseconds);
    void dropHeld();
    bool queueHeld();
    void releaseHeld();

    const std::function<void()> mOnFrame;
    const FrameTime mFrameTime;
    const DrawTarget::Exchange mExchange;
    std::thread mThread;

    std::mutex mWakeMutex;
    std::condition_variable mWakeUp;
    bool mWoken = false;
    bool mRedraw = false;
    bool mMayStart = false;
    bool mQuit = false;
    uint64_t mToldFrame = 0;
    int64_t mToldTimeUs = 0;
    Producer mWanted;
    uint64_t mWantedCount = 0;    // of producers that were set
    uint64_t mAttachedCount = 0;  // of those that the rendering thread has taken up
    std::condition_variable mAttached;

    // The rendering thread's.
    DrawTarget mTarget;
    FrameSize mDrawnSize;
    uint64_t mFrame = 0;  // mpv's newest
    std::optional<int64_t> mTimeUs;
    bool mIsTimed = false;  // else the time is what is expected
    bool mHolds = false;    // a drawn frame that is not timed

    std::atomic<bool> mVisible{true};
    std::atomic<FrameSize> mVideoSize{FrameSize()};
    std::atomic<bool> mHasPicture{false};
    std::atomic<uint64_t> mDelivered{0};
    std::atomic<uint64_t> mMissed{0};
};

}  // namespace orvtarn
