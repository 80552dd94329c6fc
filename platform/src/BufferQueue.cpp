// SPDX-License-Identifier: Apache-2.0
#include "BufferQueue.h"

#include <chrono>

namespace android {

namespace {

using Lock = std::lock_guard<std::mutex>;

constexpr size_t kBytesPerPixel = 4;

size_t strideOf(int width) { return (width * kBytesPerPixel + 63) & ~size_t{63}; }

bool isFrameSize(int width, int height) {
    return width > 0 && height > 0 && width <= BufferQueue::kMaxDimension &&
           height <= BufferQueue::kMaxDimension;
}

}  // namespace

status_t BufferQueue::getDefaultSize(int* width, int* height) {
    Lock lock(mLock);
    if (mAbandoned) return NO_INIT;
    *width = mDefaultWidth;
    *height = mDefaultHeight;
    return NO_ERROR;
}

status_t BufferQueue::dequeueBuffer(int width, int height, PixelBuffer* buffer) {
    if (!isFrameSize(width, height)) return BAD_VALUE;
    Lock lock(mLock);
    if (mAbandoned) return NO_INIT;
    const int index = findFreeSlot();
    if (index < 0) return WOULD_BLOCK;

    Slot& slot = mSlots[index];
    const size_t bytes = strideOf(width) * height;
    if (slot.memory == nullptr || !slot.memory->suits(bytes)) {
        // The old memory first: two of a large size may not fit at once.
        slot.memory.clear();
        slot.memory = PixelMemory::allocate(bytes);
        if (slot.memory == nullptr) return NO_MEMORY;
    }
    slot.width = width;
    slot.height = height;
    slot.state = State::DEQUEUED;
    *buffer = describe(index);
    return NO_ERROR;
}

status_t BufferQueue::queueBuffer(int index, int64_t timestampUs) {
    Lock lock(mLock);
    Slot* const slot = slotIn(index, State::DEQUEUED);
    if (slot == nullptr) return BAD_VALUE;
    if (mAbandoned) {
        freeSlot(slot);
        return NO_INIT;
    }
    const int superseded = findSlot(State::QUEUED);
    if (superseded >= 0) {
        freeSlot(&mSlots[superseded]);
        ++mStatistics.dropped;
    }
    slot->timestampUs = timestampUs;
    slot->state = State::QUEUED;
    ++mStatistics.queued;
    mFrameQueued.notify_all();
    return NO_ERROR;
}

status_t BufferQueue::cancelBuffer(int index) {
    Lock lock(mLock);
    Slot* const slot = slotIn(index, State::DEQUEUED);
    if (slot == nullptr) return BAD_VALUE;
    freeSlot(slot);
    return NO_ERROR;
}

status_t BufferQueue::setDefaultSize(int width, int height) {
    const bool videoSize = width == 0 && height == 0;
    if (!videoSize && !isFrameSize(width, height)) return BAD_VALUE;
    Lock lock(mLock);
    mDefaultWidth = width;
    mDefaultHeight = height;
    return NO_ERROR;
}

status_t BufferQueue::acquireFrame(Frame* frame) {
    Lock lock(mLock);
    if (mAbandoned) return NO_INIT;
    if (findSlot(State::ACQUIRED) >= 0) return INVALID_OPERATION;
    const int index = findSlot(State::QUEUED);
    if (index < 0) return WOULD_BLOCK;
    Slot& slot = mSlots[index];
    slot.state = State::ACQUIRED;
    *frame = Frame{describe(index), slot.timestampUs, slot.memory};
    return NO_ERROR;
}

status_t BufferQueue::releaseFrame(int index) {
    Lock lock(mLock);
    Slot* const slot = slotIn(index, State::ACQUIRED);
    if (slot == nullptr) return BAD_VALUE;
    freeSlot(slot);
    mLastReleased = index;
    return NO_ERROR;
}

uint64_t BufferQueue::awaitFrame(uint64_t seen, int timeoutMs) {
    std::unique_lock<std::mutex> lock(mLock);
    mFrameQueued.wait_for(lock, std::chrono::milliseconds(timeoutMs),
                          [&] { return mAbandoned || mStatistics.queued > seen; });
    return mStatistics.queued;
}

void BufferQueue::abandon() {
    Lock lock(mLock);
    mAbandoned = true;
    // Buffers in somebody's hands are freed when they come back.
    for (Slot& slot : mSlots) {
        if (slot.state == State::FREE || slot.state == State::QUEUED) freeSlot(&slot);
    }
    mFrameQueued.notify_all();
}

bool BufferQueue::isAbandoned() {
    Lock lock(mLock);
    return mAbandoned;
}

BufferQueue::Statistics BufferQueue::getStatistics() {
    Lock lock(mLock);
    return mStatistics;
}

BufferQueue::Slot* BufferQueue::slotIn(int index, State state) {
    if (index < 0 || index >= kSlotCount || mSlots[index].state != state) return nullptr;
    return &mSlots[index];
}

int BufferQueue::findSlot(State state) const {
    for (int index = 0; index < kSlotCount; ++index) {
        if (mSlots[index].state == state) return index;
    }
    return -1;
}

int BufferQueue::findFreeSlot() const {
    for (int index = 0; index < kSlotCount; ++index) {
        if (index != mLastReleased && mSlots[index].state == State::FREE) return index;
    }
    return findSlot(State::FREE);
}

void BufferQueue::freeSlot(Slot* slot) {
    slot->state = State::FREE;
    if (mAbandoned) slot->memory.clear();
}

IGraphicBufferProducer::PixelBuffer BufferQueue::describe(int index) const {
    const Slot& slot = mSlots[index];
    return PixelBuffer{slot.memory->data(), slot.width, slot.height, strideOf(slot.width), index};
}

}  // namespace android
