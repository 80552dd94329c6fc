// SPDX-License-Identifier: Apache-2.0
#include "core/BufferDrawer.h"

#include <new>

#include "base/EngineLog.h"

namespace orvtarn {

std::unique_ptr<FrameDrawer> BufferDrawer::create(mpv_handle* mpv) {
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_API_TYPE, const_cast<char*>(MPV_RENDER_API_TYPE_SW)},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    mpv_render_context* context = nullptr;
    const int error = mpv_render_context_create(&context, mpv, parameters);
    if (error >= 0) return std::unique_ptr<FrameDrawer>(new (std::nothrow) BufferDrawer(context));
    refused("VideoOutput", mpv_error_string(error));
    return nullptr;
}

BufferDrawer::~BufferDrawer() { mpv_render_context_free(mContext); }

void BufferDrawer::attach(const android::sp<android::IGraphicBufferProducer>& producer) {
    mProducer = producer;
}

FrameSize BufferDrawer::wantedSize() {
    FrameSize size;
    if (mProducer->getDefaultSize(&size.width, &size.height) != android::NO_ERROR) return {};
    return size;
}

android::status_t BufferDrawer::draw(FrameSize size) {
    android::IGraphicBufferProducer::PixelBuffer buffer = {};
    android::status_t status = mProducer->dequeueBuffer(size.width, size.height, &buffer);
    if (status != android::NO_ERROR) return status;
    status = drawInto(buffer);
    if (status != android::NO_ERROR) mProducer->cancelBuffer(buffer.slot);
    mSlot = buffer.slot;
    return status;
}

android::status_t BufferDrawer::drawInto(
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

android::status_t BufferDrawer::deliver(int64_t microseconds) {
    return mProducer->queueBuffer(mSlot, microseconds);
}

void BufferDrawer::cancel() { mProducer->cancelBuffer(mSlot); }

}  // namespace orvtarn
