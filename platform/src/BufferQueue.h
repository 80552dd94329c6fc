// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <stdint.h>
#include <utils/StrongPointer.h>

#include <condition_variable>
#include <mutex>

#include "PixelMemory.h"

namespace android {

// A few frame buffers between one producer and one consumer. The newest frame
// wins: a queued frame that the consumer has not taken is dropped for the next
// one, so a slow consumer never holds up the producer. All operations may be
// called from any thread; only awaitFrame blocks.
class BufferQueue : public IGraphicBufferProducer {
public:
    static constexpr int kSlotCount = 3;
    static constexpr int kMaxDimension = 16384;  // pixels, for width and height

    // A frame lent to the consumer. The memory stays valid while it is held;
    // its content is the consumer's until releaseFrame.
    struct Frame {
        PixelBuffer buffer;
        int64_t timestampUs;
        sp<PixelMemory> memory;
    };

    struct Statistics {
        uint64_t queued;   // frames handed in by the producer
        uint64_t dropped;  // of those, superseded before the consumer took them
    };

    // Producer side.
    status_t getDefaultSize(int* width, int* height) override;
    status_t dequeueBuffer(int width, int height, PixelBuffer* buffer) override;
    status_t queueBuffer(int slot, int64_t timestampUs) override;
    status_t cancelBuffer(int slot) override;

    // Consumer side.

    // What getDefaultSize answers: pixels, 0 x 0 for the video's own size.
    // BAD_VALUE for anything else that is not positive or too large.
    status_t setDefaultSize(int width, int height);
    // Takes the newest frame. WOULD_BLOCK when there is no new one;
    // INVALID_OPERATION while an earlier one is not released; NO_INIT once
    // abandoned.
    status_t acquireFrame(Frame* frame);
    // BAD_VALUE for a slot that is not acquired. The frame that was given back last keeps its
    // content while another slot is free, for a consumer that shows it still.
    status_t releaseFrame(int slot);
    // Waits until more than seen frames were queued, the queue is abandoned or
    // the time is over; returns the number of frames queued so far.
    uint64_t awaitFrame(uint64_t seen, int timeoutMs);
    // The consumer goes away: the producer gets NO_INIT from now on, waiters
    // wake up, free memory goes back. Cannot be undone; may be repeated.
    void abandon();
    bool isAbandoned();
    Statistics getStatistics();

private:
    enum class State { FREE, DEQUEUED, QUEUED, ACQUIRED };

    struct Slot {
        State state = State::FREE;
        int width = 0;
        int height = 0;
        int64_t timestampUs = 0;
        sp<PixelMemory> memory;
    };

    Slot* slotIn(int index, State state);
    int findSlot(State state) const;
    int findFreeSlot() const;
    void freeSlot(Slot* slot);
    PixelBuffer describe(int index) const;

    std::mutex mLock;
    std::condition_variable mFrameQueued;
    Slot mSlots[kSlotCount];
    int mDefaultWidth = 0;
    int mDefaultHeight = 0;
    bool mAbandoned = false;
    int mLastReleased = -1;
    Statistics mStatistics = {0, 0};
};

}  // namespace android
