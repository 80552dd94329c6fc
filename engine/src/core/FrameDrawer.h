// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <mpv/render.h>
#include <stdint.h>
#include <utils/Errors.h>
#include <utils/StrongPointer.h>

namespace orvtarn {

// Aligned by its size, as an atomic one is stored: clang would call libatomic for less.
struct alignas(8) FrameSize {
    int width = 0;  // pixels
    int height = 0;
    bool operator==(FrameSize other) const {
        return width == other.width && height == other.height;
    }
};

// A way in which mpv's frames come to a surface; owns mpv's render context, of which
// a player has one at a time. On the rendering thread, but for the context.
class FrameDrawer {
public:
    virtual ~FrameDrawer() = default;

    virtual mpv_render_context* context() const = 0;
    // Draws to that surface from now on, null for none. The one before is let go of.
    virtual void attach(const android::sp<android::IGraphicBufferProducer>& producer) = 0;
    // The size that the surface wants; 0 x 0 for the video's own.
    virtual FrameSize wantedSize() = 0;
    // Whether the surface lacks what was drawn last.
    virtual bool isBehind() { return false; }
    // Draws the newest frame. It is delivered or cancelled afterwards.
    // WOULD_BLOCK when there is no room for it now; any other error is final.
    virtual android::status_t draw(FrameSize size) = 0;
    // Reports to mpv that its frame is done with, without drawing it.
    virtual void skip();
    // The drawn frame has that media time.
    virtual android::status_t deliver(int64_t microseconds) = 0;
    virtual void cancel() = 0;
};

}  // namespace orvtarn
