// SPDX-License-Identifier: Apache-2.0
#include "core/VideoOutput.h"

#include <mpv/render.h>

#include <chrono>

#include "base/EngineLog.h"
#include "base/ThreadName.h"

namespace orvtarn {
namespace {

using std::chrono::milliseconds;

// How soon a surface that had no free buffer is asked again.
constexpr milliseconds kRetryInterval{5};
// How soon a still picture follows a surface that wants another size.
constexpr milliseconds kSizePollInterval{100};

}  // namespace

bool VideoOutput::create(mpv_handle* mpv) {
    // mpv calls at once, and then when it has a picture.
    if (!mTarget.create(mpv)) return false;
    std::lock_guard<std::mutex> lock(mWakeMutex);
    mMayStart = true;
    return true;
}

// Pictures begin it. A window does, too: it may turn out not to be drawn on, which
// whoever offers it is to see at once.
void VideoOutput::startThread() {
    if (mMayStart && !mQuit && !mThread.joinable()) mThread = std::thread(&VideoOutput::run, this);
}

bool VideoOutput::hasWindow(const Producer& producer) {
    return producer != nullptr && producer->nativeWindow() != nullptr;
}

void VideoOutput::destroy() {
    {
        std::lock_guard<std::mutex> lock(mWakeMutex);
        mQuit = true;
        mWanted = nullptr;
        mWakeUp.notify_one();
        mAttached.notify_all();
    }
    if (mThread.joinable()) {
        mThread.join();
    } else {
        mTarget.destroy();
    }
}

void VideoOutput::setProducer(const Producer& producer) {
    std::unique_lock<std::mutex> lock(mWakeMutex);
    if (mWanted == producer) return;
    mWanted = producer;
    const uint64_t count = ++mWantedCount;
    mWoken = mRedraw = true;
    mWakeUp.notify_one();
    if (hasWindow(producer)) startThread();
    if (!mThread.joinable()) return;
    mAttached.wait(lock, [&] { return mAttachedCount >= count || mQuit; });
}

void VideoOutput::setVisible(bool visible) {
    mVisible = visible;
    wake(true);
}

void VideoOutput::setFrameTime(uint64_t frame, int64_t microseconds) {
    {
        std::lock_guard<std::mutex> lock(mWakeMutex);
        mToldFrame = frame;
        mToldTimeUs = microseconds;
    }
    wake(false);
}

void VideoOutput::onUpdate() {
    std::lock_guard<std::mutex> lock(mWakeMutex);
    startThread();
    mWoken = true;
    mWakeUp.notify_one();
}

void VideoOutput::wake(bool redraw) {
    std::lock_guard<std::mutex> lock(mWakeMutex);
    mWoken = true;
    mRedraw = mRedraw || redraw;
    mWakeUp.notify_one();
}

void VideoOutput::run() {
    nameThisThread("orv-render");
    bool retry = false;
    bool showsPicture = false;  // whose surface may come to want another size
    std::unique_lock<std::mutex> lock(mWakeMutex);
    while (true) {
        const auto woken = [this] { return mWoken || mQuit; };
        if (retry || showsPicture) {
            mWakeUp.wait_for(lock, retry ? kRetryInterval : kSizePollInterval, woken);
        } else {
            mWakeUp.wait(lock, woken);
        }
        if (mQuit) break;
        bool redraw = mRedraw || retry;
        const bool isWoken = mWoken;
        mWoken = mRedraw = false;
        const uint64_t toldFrame = mToldFrame;
        const int64_t toldTimeUs = mToldTimeUs;
        const uint64_t wantedCount = mWantedCount;
        const Producer wanted = mWanted;
        const bool isAnother = wantedCount != mAttachedCount;
        lock.unlock();
        if (isAnother) attach(wanted);
        redraw = attendWindow() || redraw;
        deliverHeld(toldFrame, toldTimeUs);
        const bool newFrame = isWoken && takeFrame();
        if (!newFrame && !redraw) redraw = isBehind();
        retry = (newFrame || (redraw && mHasPicture)) && !render(newFrame);
        showsPicture = mHasPicture && isShown();
        lock.lock();
        mAttachedCount = wantedCount;
        mAttached.notify_all();
    }
    lock.unlock();
    dropHeld();
    mTarget.destroy();
}

void VideoOutput::attach(const Producer& producer) {
    dropHeld();
    mTarget.attach(producer);
}

// Whether its picture is to be drawn anew.
bool VideoOutput::attendWindow() {
    const bool closes = mTarget.isWindowClosing();
    if (closes) attach(nullptr);
    return mTarget.takeRedraw() || closes;
}

bool VideoOutput::takeFrame() {
    mpv_render_context* const context = mTarget.context();
    if (context == nullptr) return false;
    if ((mpv_render_context_update(context) & MPV_RENDER_UPDATE_FRAME) == 0) return false;
    mpv_render_frame_info info = {};
    mpv_render_param parameter = {MPV_RENDER_PARAM_NEXT_FRAME_INFO, &info};
    if (mpv_render_context_get_info(context, parameter) < 0) return false;
    if ((info.flags & MPV_RENDER_FRAME_INFO_PRESENT) == 0) return false;
    const bool isAnother = (info.flags & MPV_RENDER_FRAME_INFO_REDRAW) == 0 || !mHasPicture;
    if (isAnother) {
        releaseHeld();
        mIsTimed = false;
        mTimeUs = mFrameTime(++mFrame, info.target_time);
    }
    mHasPicture = true;
    return true;
}

// False when the picture could not be drawn yet and is to be tried again.
bool VideoOutput::render(bool newFrame) {
    dropHeld();
    const android::status_t status = isShown() ? draw() : android::NO_INIT;
    if (mHolds) return true;
    if (status != android::NO_ERROR && newFrame) {
        mTarget.skip();
        if (status == android::WOULD_BLOCK) mMissed++;
    }
    if (status == android::NOT_ENOUGH_DATA) return false;
    mOnFrame();
    return status != android::WOULD_BLOCK;
}

// Whether the picture on the surface is not the one that belongs there.
bool VideoOutput::isBehind() {
    return isShown() && (!(wantedSize() == mDrawnSize) || mTarget.drawer().isBehind());
}

FrameSize VideoOutput::wantedSize() {
    const FrameSize size = mTarget.drawer().wantedSize();
    return size.width > 0 && size.height > 0 ? size : mVideoSize.load();
}

android::status_t VideoOutput::draw() {
    const FrameSize size = wantedSize();
    // The first frame may be here before the word of the video's size.
    if (size == FrameSize()) return android::NOT_ENOUGH_DATA;
    const android::status_t status = mTarget.drawer().draw(size);
    if (status == android::UNKNOWN_ERROR && mTarget.isOnWindow()) {
        mTarget.fallBack("a frame could not be drawn");
        return android::NO_INIT;
    }
    if (status != android::NO_ERROR) return status;
    mDrawnSize = size;
    mHolds = !mIsTimed;
    if (mIsTimed) queue();
    return android::NO_ERROR;
}

void VideoOutput::queue() {
    if (mTarget.drawer().deliver(*mTimeUs) == android::NO_ERROR) mDelivered++;
}

void VideoOutput::deliverHeld(uint64_t frame, int64_t microseconds) {
    if (mIsTimed || frame != mFrame) return;
    mTimeUs = microseconds;
    mIsTimed = true;
    if (queueHeld()) mOnFrame();
}

// The frame that follows is here, and the answer is not.
void VideoOutput::releaseHeld() {
    if (mTimeUs && queueHeld()) mOnFrame();
}

// Whether there was one.
bool VideoOutput::queueHeld() {
    // The media may be closed by now.
    if (!mHasPicture) dropHeld();
    if (!mHolds) return false;
    mHolds = false;
    queue();
    return true;
}

// The frame is drawn anew, or nobody wants it any more.
void VideoOutput::dropHeld() {
    if (mHolds) mTarget.drawer().cancel();
    mHolds = false;
}

}  // namespace orvtarn
