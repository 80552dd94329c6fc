// SPDX-License-Identifier: Apache-2.0
#include "core/VideoOutput.h"

#include <chrono>
#include <utility>

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
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_API_TYPE, const_cast<char*>(MPV_RENDER_API_TYPE_SW)},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    const int error = mpv_render_context_create(&mContext, mpv, parameters);
    if (error < 0) return refused("VideoOutput", mpv_error_string(error));
    // mpv calls at once, and then when it has a picture.
    mpv_render_context_set_update_callback(mContext, onUpdate, this);
    std::lock_guard<std::mutex> lock(mWakeMutex);
    mMayStart = true;
    return true;
}

void VideoOutput::destroy() {
    if (mContext != nullptr) stopRendering();
    mProducer.clear();
}

void VideoOutput::stopRendering() {
    mpv_render_context_set_update_callback(mContext, nullptr, nullptr);
    {
        std::lock_guard<std::mutex> lock(mWakeMutex);
        mQuit = true;
        mWakeUp.notify_one();
    }
    if (mThread.joinable()) mThread.join();
    dropHeld();
    mpv_render_context_free(mContext);
    mContext = nullptr;
}

void VideoOutput::setProducer(const android::sp<android::IGraphicBufferProducer>& producer) {
    {
        std::lock_guard<std::mutex> lock(mSurfaceMutex);
        if (mProducer == producer) return;
        dropHeld();
        mProducer = producer;
    }
    wake(true);
}

void VideoOutput::setVisible(bool visible) {
    {
        std::lock_guard<std::mutex> lock(mSurfaceMutex);
        mVisible = visible;
    }
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

void VideoOutput::onUpdate(void* self) {
    auto& output = *static_cast<VideoOutput*>(self);
    output.wake(false);
    output.startRendering();
}

void VideoOutput::startRendering() {
    std::lock_guard<std::mutex> lock(mWakeMutex);
    if (mMayStart && !mThread.joinable()) mThread = std::thread(&VideoOutput::run, this);
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
        if (mQuit) return;
        bool redraw = mRedraw || retry;
        const bool isWoken = mWoken;
        mWoken = mRedraw = false;
        const uint64_t toldFrame = mToldFrame;
        const int64_t toldTimeUs = mToldTimeUs;
        lock.unlock();
        deliverHeld(toldFrame, toldTimeUs);
        const bool newFrame = isWoken && takeFrame();
        if (!newFrame && !redraw) redraw = sizeChanged();
        retry = (newFrame || (redraw && mHasPicture)) && !render(newFrame);
        showsPicture = mHasPicture && hasSurface();
        lock.lock();
    }
}

bool VideoOutput::takeFrame() {
    if ((mpv_render_context_update(mContext) & MPV_RENDER_UPDATE_FRAME) == 0) return false;
    mpv_render_frame_info info = {};
    mpv_render_param parameter = {MPV_RENDER_PARAM_NEXT_FRAME_INFO, &info};
    if (mpv_render_context_get_info(mContext, parameter) < 0) return false;
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
    android::status_t status = android::NO_ERROR;
    {
        std::lock_guard<std::mutex> lock(mSurfaceMutex);
        const bool shown = mProducer != nullptr && mVisible;
        dropHeld();
        status = shown ? draw() : android::NO_INIT;
        if (mHeld) return true;
        if (status != android::NO_ERROR && newFrame) {
            skip();
            if (status == android::WOULD_BLOCK) mMissed++;
        }
    }
    if (status == android::NOT_ENOUGH_DATA) return false;
    mOnFrame();
    return status != android::WOULD_BLOCK;
}

VideoOutput::Size VideoOutput::wantedSize() const {
    Size size;
    if (mProducer->getDefaultSize(&size.width, &size.height) != android::NO_ERROR)
        return mVideoSize;
    return size.width > 0 && size.height > 0 ? size : mVideoSize.load();
}

bool VideoOutput::hasSurface() {
    std::lock_guard<std::mutex> lock(mSurfaceMutex);
    return mProducer != nullptr && mVisible;
}

bool VideoOutput::sizeChanged() {
    std::lock_guard<std::mutex> lock(mSurfaceMutex);
    return mProducer != nullptr && mVisible && !(wantedSize() == mDrawnSize);
}

android::status_t VideoOutput::draw() {
    const Size size = wantedSize();
    // The first frame may be here before the word of the video's size.
    if (size == Size()) return android::NOT_ENOUGH_DATA;
    android::IGraphicBufferProducer::PixelBuffer buffer = {};
    android::status_t status = mProducer->dequeueBuffer(size.width, size.height, &buffer);
    if (status != android::NO_ERROR) return status;
    status = drawInto(buffer);
    if (status != android::NO_ERROR) {
        mProducer->cancelBuffer(buffer.slot);
        return status;
    }
    mDrawnSize = size;
    if (mIsTimed) return queue(buffer.slot);
    mHeld = buffer.slot;
    return android::NO_ERROR;
}

android::status_t VideoOutput::queue(int slot) {
    const android::status_t status = mProducer->queueBuffer(slot, *mTimeUs);
    if (status == android::NO_ERROR) mDelivered++;
    return status;
}

void VideoOutput::deliverHeld(uint64_t frame, int64_t microseconds) {
    {
        std::lock_guard<std::mutex> lock(mSurfaceMutex);
        if (mIsTimed || frame != mFrame) return;
        mTimeUs = microseconds;
        mIsTimed = true;
        if (!queueHeld()) return;
    }
    mOnFrame();
}

// The frame that follows is here, and the answer is not.
void VideoOutput::releaseHeld() {
    {
        std::lock_guard<std::mutex> lock(mSurfaceMutex);
        if (!mTimeUs || !queueHeld()) return;
    }
    mOnFrame();
}

// Whether there was one.
bool VideoOutput::queueHeld() {
    // The media may be closed by now.
    if (!mHasPicture) dropHeld();
    if (!mHeld) return false;
    queue(*std::exchange(mHeld, std::nullopt));
    return true;
}

// The frame is drawn anew, or nobody wants it any more.
void VideoOutput::dropHeld() {
    if (mHeld) mProducer->cancelBuffer(*mHeld);
    mHeld.reset();
}

android::status_t VideoOutput::drawInto(
    const android::IGraphicBufferProducer::PixelBuffer& buffer) {
    int size[2] = {buffer.width, buffer.height};
    size_t stride = buffer.stride;
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_SW_SIZE, size},
        {MPV_RENDER_PARAM_SW_FORMAT, const_cast<char*>("bgr0")},
        {MPV_RENDER_PARAM_SW_STRIDE, &stride},
        {MPV_RENDER_PARAM_SW_POINTER, buffer.pixels},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    const int error = mpv_render_context_render(mContext, parameters);
    if (error >= 0) return android::NO_ERROR;
    return failed(android::UNKNOWN_ERROR, "VideoOutput", mpv_error_string(error));
}

// Reports to mpv that the frame is done with, without drawing it.
void VideoOutput::skip() {
    int yes = 1;
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_SKIP_RENDERING, &yes},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    mpv_render_context_render(mContext, parameters);
}

}  // namespace orvtarn
