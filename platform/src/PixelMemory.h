// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <utils/RefBase.h>
#include <utils/StrongPointer.h>

namespace android {

// Zeroed, page-aligned memory for one frame, counted: it outlives its queue for
// as long as a reader looks at it.
class PixelMemory : public RefBase {
public:
    // At least that many bytes; null when the system has none left.
    static sp<PixelMemory> allocate(size_t bytes);

    uint8_t* data() const { return mData; }

    // Whether a frame of that many bytes fits without wasting most of it.
    bool suits(size_t bytes) const { return bytes <= mCapacity && mCapacity / 4 < bytes; }

private:
    PixelMemory(uint8_t* data, size_t capacity) : mData(data), mCapacity(capacity) {}
    ~PixelMemory() override;

    uint8_t* const mData;
    const size_t mCapacity;
};

}  // namespace android
