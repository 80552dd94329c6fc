// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/NativeWindow.h>
#include <stddef.h>
#include <stdint.h>
#include <utils/Errors.h>
#include <utils/RefBase.h>
#include <utils/StrongPointer.h>

namespace android {

// Where a player puts its video frames. A producer takes a free buffer, fills
// it and queues it; the consumer shows the newest. All operations may be
// called from any thread; none waits for the consumer.
class IGraphicBufferProducer : public virtual RefBase {
public:
    // One frame in memory. Pixels are 32 bits, bytes B, G, R, X in memory
    // order; rows are stride bytes apart, a multiple of 64.
    struct PixelBuffer {
        uint8_t* pixels;
        int width;      // pixels
        int height;     // rows
        size_t stride;  // bytes
        int slot;       // the queue's own number of the buffer
    };

    // The size the consumer would like, in pixels; 0 x 0 for the video's own.
    virtual status_t getDefaultSize(int* width, int* height) = 0;
    // BAD_VALUE for a size that is not positive; NO_INIT once the consumer is
    // gone; WOULD_BLOCK when every buffer is in use.
    virtual status_t dequeueBuffer(int width, int height, PixelBuffer* buffer) = 0;
    // timestampUs: the frame's media time. BAD_VALUE for a slot not dequeued.
    virtual status_t queueBuffer(int slot, int64_t timestampUs) = 0;
    virtual status_t cancelBuffer(int slot) = 0;

    // The window that a producer may draw on instead; null for none. The desktop's
    // alone: a television's producer has no such operation.
    virtual sp<NativeWindow> nativeWindow() { return nullptr; }

protected:
    virtual ~IGraphicBufferProducer() = default;
};

}  // namespace android
