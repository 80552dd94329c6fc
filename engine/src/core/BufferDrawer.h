// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>

#include "core/FrameDrawer.h"

namespace orvtarn {

// Draws by software into a surface's buffers.
class BufferDrawer : public FrameDrawer {
public:
    // Null, and a line in the log, when mpv refuses.
    static std::unique_ptr<FrameDrawer> create(mpv_handle* mpv);
    ~BufferDrawer() override;

    mpv_render_context* context() const override { return mContext; }
    void attach(const android::sp<android::IGraphicBufferProducer>& producer) override;
    FrameSize wantedSize() override;
    android::status_t draw(FrameSize size) override;
    android::status_t deliver(int64_t microseconds) override;
    void cancel() override;

private:
    explicit BufferDrawer(mpv_render_context* context) : mContext(context) {}
    android::status_t drawInto(const android::IGraphicBufferProducer::PixelBuffer& buffer);

    mpv_render_context* const mContext;
    android::sp<android::IGraphicBufferProducer> mProducer;
    int mSlot = 0;  // of the drawn frame
};

}  // namespace orvtarn
