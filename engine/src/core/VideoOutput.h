// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <mpv/render.h>
#include <stdint.h>
#include <utils/StrongPointer.h>

#include <atomic>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <optional>
#include <thread>

namespace orvtarn {

// Draws mpv's video frames into the surface's buffers, on a thread of its
// own, the only one that renders, which begins with the first picture. Never holds up playback: a
// surface without a free buffer misses a frame, and gets the newest one when it has.
class VideoOutput {
public:
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
    VideoOutput(std::function<void()> onFrame, FrameTime frameTime)
        : mOnFrame(std::move(onFrame)), mFrameTime(std::move(frameTime)) {}
    ~VideoOutput() { destroy(); }

    // Once; the surface may be there before.
    bool create(mpv_handle* mpv);
    // Before mpv goes, and quicker when no media is open.
    void destroy();

    // Null for none. No frame goes to an earlier surface afterwards; the new
    // one gets the picture at once, paused or not.
    void setProducer(const android::sp<android::IGraphicBufferProducer>& producer);
    // Any thread.
    void setFrameTime(uint64_t frame, int64_t microseconds);
    // Whether frames go to the surface at all.
    void setVisible(bool visible);
    void setVideoSize(int width, int height) { mVideoSize = {width, height}; }
    // The media is closed: nothing is drawn again before the next frame.
    void forgetPicture() { mHasPicture = false; }

    Counters counters() const { return {mDelivered, mMissed}; }

private:
    struct Size {
        int width = 0;
        int height = 0;
        bool operator==(Size other) const { return width == other.width && height == other.height; }
    };

    static void onUpdate(void* self);
    void wake(bool redraw);
    void startRendering();
    void stopRendering();
    void run();
    bool takeFrame();
    bool render(bool newFrame);
    Size wantedSize() const;
    bool hasSurface();
    bool sizeChanged();
    android::status_t draw();
    android::status_t drawInto(const android::IGraphicBufferProducer::PixelBuffer& buffer);
    void skip();
    android::status_t queue(int slot);
    void deliverHeld(uint64_t frame, int64_t microseconds);
    void dropHeld();
    bool queueHeld();
    void releaseHeld();

    const std::function<void()> mOnFrame;
    const FrameTime mFrameTime;
    mpv_render_context* mContext = nullptr;
    std::thread mThread;

    std::mutex mWakeMutex;
    std::condition_variable mWakeUp;
    bool mWoken = false;
    bool mRedraw = false;
    bool mMayStart = false;
    bool mQuit = false;
    uint64_t mToldFrame = 0;
    int64_t mToldTimeUs = 0;

    // Held while a frame is drawn.
    std::mutex mSurfaceMutex;
    android::sp<android::IGraphicBufferProducer> mProducer;
    bool mVisible = true;
    Size mDrawnSize;
    uint64_t mFrame = 0;  // mpv's newest
    std::optional<int64_t> mTimeUs;
    bool mIsTimed = false;     // else the time is what is expected
    std::optional<int> mHeld;  // the slot of a drawn frame that is not timed

    std::atomic<Size> mVideoSize{Size()};
    std::atomic<bool> mHasPicture{false};
    std::atomic<uint64_t> mDelivered{0};
    std::atomic<uint64_t> mMissed{0};
};

}  // namespace orvtarn
