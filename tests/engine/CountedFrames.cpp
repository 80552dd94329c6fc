// SPDX-License-Identifier: Apache-2.0
#include "CountedFrames.h"

#include <utility>

namespace orvtest {

// The lowest binary digit comes first; white stands for one.
int numberIn(const Picture& picture) {
    int number = 0;
    for (int digit = 0; digit < 8; digit++) {
        const int left = digit * 125 + 40;
        if (picture.brightness(left, 300, left + 45, 700) > 128) number |= 1 << digit;
    }
    return number;
}

android::status_t CountingSink::queueBuffer(int slot, int64_t timestampUs) {
    const android::status_t status = FrameSink::queueBuffer(slot, timestampUs);
    if (status != android::NO_ERROR) return status;
    const CountedFrame frame = {numberIn(newest()), timestampUs};
    std::lock_guard<std::mutex> lock(mFramesMutex);
    mFrames.push_back(frame);
    mLast = frame;
    return status;
}

std::vector<CountedFrame> CountingSink::take() {
    std::lock_guard<std::mutex> lock(mFramesMutex);
    return std::exchange(mFrames, {});
}

CountedFrame CountingSink::last() const {
    std::lock_guard<std::mutex> lock(mFramesMutex);
    return mLast;
}

}  // namespace orvtest
