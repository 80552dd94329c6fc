// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <utils/RefBase.h>

namespace android {

// The native half of a Java surface: a counted holder of a buffer producer.
class Surface : public RefBase {
public:
    explicit Surface(const sp<IGraphicBufferProducer>& bufferProducer)
        : mGraphicBufferProducer(bufferProducer) {}

    // Null for a surface that was made without a consumer.
    sp<IGraphicBufferProducer> getIGraphicBufferProducer() const { return mGraphicBufferProducer; }

private:
    const sp<IGraphicBufferProducer> mGraphicBufferProducer;
};

}  // namespace android
