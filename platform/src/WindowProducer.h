// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <gui/NativeWindow.h>

namespace android {

// A window, and the buffers for a producer that cannot draw on it.
class WindowProducer : public IGraphicBufferProducer {
public:
    WindowProducer(const sp<NativeWindow>& window, const sp<IGraphicBufferProducer>& buffers)
        : mWindow(window), mBuffers(buffers) {}

    status_t getDefaultSize(int* width, int* height) override {
        return mBuffers->getDefaultSize(width, height);
    }
    status_t dequeueBuffer(int width, int height, PixelBuffer* buffer) override {
        return mBuffers->dequeueBuffer(width, height, buffer);
    }
    status_t queueBuffer(int slot, int64_t timestampUs) override {
        return mBuffers->queueBuffer(slot, timestampUs);
    }
    status_t cancelBuffer(int slot) override { return mBuffers->cancelBuffer(slot); }
    sp<NativeWindow> nativeWindow() override { return mWindow; }

private:
    const sp<NativeWindow> mWindow;
    const sp<IGraphicBufferProducer> mBuffers;
};

}  // namespace android
