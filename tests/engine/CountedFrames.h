// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <mutex>
#include <vector>

#include "FrameSink.h"

namespace orvtest {

// A frame of the media whose frames show their numbers, and the time that it
// came with.
struct CountedFrame {
    int number;
    int64_t timestampUs;
};

// The number that a frame shows in stripes.
int numberIn(const Picture& picture);

// A surface's consumer that reads the number of each frame.
class CountingSink : public FrameSink {
public:
    android::status_t queueBuffer(int slot, int64_t timestampUs) override;
    // Those since the last call, in order of arrival.
    std::vector<CountedFrame> take();
    // The newest of all; number -1 before the first.
    CountedFrame last() const;

private:
    mutable std::mutex mFramesMutex;
    std::vector<CountedFrame> mFrames;
    CountedFrame mLast = {-1, 0};
};

}  // namespace orvtest
