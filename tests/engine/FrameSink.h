// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <stdint.h>

#include <condition_variable>
#include <functional>
#include <mutex>
#include <vector>

namespace orvtest {

// A picture as a player delivered it: 32 bits a pixel, bytes B, G, R, X.
struct Picture {
    int width = 0;
    int height = 0;
    int64_t timestampUs = 0;
    std::vector<uint8_t> pixels;  // rows without padding

    // Mean of the green bytes of a part, given in thousandths of the size.
    double brightness(int left = 0, int top = 0, int right = 1000, int bottom = 1000) const;
    // Pixels whose brightest colour differs from the other picture's by more
    // than a little.
    int differences(const Picture& other) const;
};

// A surface's consumer that keeps the newest frame.
class FrameSink : public android::IGraphicBufferProducer {
public:
    // 0 x 0 for the video's own size.
    void setDefaultSize(int width, int height);
    // Takes no more frames: every buffer is in use.
    void block(bool blocked);
    void abandon();

    uint64_t frameCount() const;
    Picture newest() const;
    // Waits until more than count frames came and the condition holds for the
    // newest; false after ten seconds.
    bool waitFor(
        uint64_t count, const std::function<bool(const Picture&)>& condition = [](const Picture&) {
            return true;
        }) const;
    // Times of all frames so far, in order of arrival.
    std::vector<int64_t> timestamps() const;

    android::status_t getDefaultSize(int* width, int* height) override;
    android::status_t dequeueBuffer(int width, int height, PixelBuffer* buffer) override;
    android::status_t queueBuffer(int slot, int64_t timestampUs) override;
    android::status_t cancelBuffer(int slot) override;

private:
    mutable std::mutex mMutex;
    mutable std::condition_variable mArrived;
    int mDefaultWidth = 0;
    int mDefaultHeight = 0;
    bool mBlocked = false;
    bool mAbandoned = false;
    bool mDequeued = false;
    std::vector<uint8_t> mBuffer;
    PixelBuffer mCurrent = {};
    Picture mNewest;
    std::vector<int64_t> mTimestamps;
};

}  // namespace orvtest
