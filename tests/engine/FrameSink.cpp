// SPDX-License-Identifier: Apache-2.0
#include "FrameSink.h"

#include <stdlib.h>
#include <string.h>

#include <algorithm>
#include <chrono>

namespace orvtest {
namespace {

constexpr int kNoise = 24;  // what compression changes at most

}  // namespace

double Picture::brightness(int left, int top, int right, int bottom) const {
    int64_t sum = 0;
    int64_t count = 0;
    for (int y = height * top / 1000; y < height * bottom / 1000; y++) {
        for (int x = width * left / 1000; x < width * right / 1000; x++, count++) {
            sum += pixels[(size_t(y) * width + x) * 4 + 1];
        }
    }
    return count == 0 ? 0 : static_cast<double>(sum) / static_cast<double>(count);
}

int Picture::differences(const Picture& other) const {
    if (width != other.width || height != other.height) return width * height;
    int count = 0;
    for (size_t i = 0; i < pixels.size(); i += 4) {
        int difference = 0;
        for (size_t c = 0; c < 3; c++) {
            difference = std::max(difference, abs(pixels[i + c] - other.pixels[i + c]));
        }
        count += difference > kNoise;
    }
    return count;
}

void FrameSink::setDefaultSize(int width, int height) {
    std::lock_guard<std::mutex> lock(mMutex);
    mDefaultWidth = width;
    mDefaultHeight = height;
}

void FrameSink::block(bool blocked) {
    std::lock_guard<std::mutex> lock(mMutex);
    mBlocked = blocked;
}

void FrameSink::abandon() {
    std::lock_guard<std::mutex> lock(mMutex);
    mAbandoned = true;
}

uint64_t FrameSink::frameCount() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mTimestamps.size();
}

Picture FrameSink::newest() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mNewest;
}

bool FrameSink::waitFor(uint64_t count,
                        const std::function<bool(const Picture&)>& condition) const {
    std::unique_lock<std::mutex> lock(mMutex);
    return mArrived.wait_for(lock, std::chrono::seconds(10),
                             [&] { return mTimestamps.size() > count && condition(mNewest); });
}

std::vector<int64_t> FrameSink::timestamps() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mTimestamps;
}

android::status_t FrameSink::getDefaultSize(int* width, int* height) {
    std::lock_guard<std::mutex> lock(mMutex);
    *width = mDefaultWidth;
    *height = mDefaultHeight;
    return android::NO_ERROR;
}

android::status_t FrameSink::dequeueBuffer(int width, int height, PixelBuffer* buffer) {
    std::lock_guard<std::mutex> lock(mMutex);
    if (mAbandoned) return android::NO_INIT;
    if (mBlocked || mDequeued) return android::WOULD_BLOCK;
    if (width <= 0 || height <= 0) return android::BAD_VALUE;
    const size_t stride = (size_t(width) * 4 + 63) / 64 * 64;
    mBuffer.assign(stride * height + 64, 0);
    auto address = reinterpret_cast<uintptr_t>(mBuffer.data());
    auto* aligned = reinterpret_cast<uint8_t*>((address + 63) / 64 * 64);
    mCurrent = {aligned, width, height, stride, 0};
    mDequeued = true;
    *buffer = mCurrent;
    return android::NO_ERROR;
}

android::status_t FrameSink::queueBuffer(int slot, int64_t timestampUs) {
    std::lock_guard<std::mutex> lock(mMutex);
    if (slot != 0 || !mDequeued) return android::BAD_VALUE;
    mDequeued = false;
    const size_t row = size_t(mCurrent.width) * 4;
    mNewest = {mCurrent.width, mCurrent.height, timestampUs, {}};
    mNewest.pixels.resize(row * mCurrent.height);
    for (int y = 0; y < mCurrent.height; y++) {
        memcpy(&mNewest.pixels[y * row], mCurrent.pixels + y * mCurrent.stride, row);
    }
    mTimestamps.push_back(timestampUs);
    mArrived.notify_all();
    return android::NO_ERROR;
}

android::status_t FrameSink::cancelBuffer(int slot) {
    std::lock_guard<std::mutex> lock(mMutex);
    if (slot != 0 || !mDequeued) return android::BAD_VALUE;
    mDequeued = false;
    return android::NO_ERROR;
}

}  // namespace orvtest
