// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <cstring>
#include <future>
#include <thread>

#include "BufferQueue.h"

namespace android {
namespace {

using PixelBuffer = IGraphicBufferProducer::PixelBuffer;

// A wait that nothing ends is longer than what a test waits for its end.
constexpr int kLongWaitMs = 20000;
constexpr std::chrono::seconds kShortWait{10};

class BufferQueueTest : public testing::Test {
protected:
    PixelBuffer dequeue(int width = 16, int height = 4) {
        PixelBuffer buffer = {};
        EXPECT_EQ(mQueue->dequeueBuffer(width, height, &buffer), NO_ERROR);
        return buffer;
    }

    void produce(int64_t timestampUs) {
        EXPECT_EQ(mQueue->queueBuffer(dequeue().slot, timestampUs), NO_ERROR);
    }

    BufferQueue::Frame acquire() {
        BufferQueue::Frame frame = {};
        EXPECT_EQ(mQueue->acquireFrame(&frame), NO_ERROR);
        return frame;
    }

    status_t tryAcquire() {
        BufferQueue::Frame frame = {};
        return mQueue->acquireFrame(&frame);
    }

    status_t tryDequeue(int width = 16, int height = 4) {
        PixelBuffer buffer = {};
        return mQueue->dequeueBuffer(width, height, &buffer);
    }

    const sp<BufferQueue> mQueue = new BufferQueue;
};

TEST_F(BufferQueueTest, AsksForTheVideosOwnSizeAtFirst) {
    int width = -1;
    int height = -1;
    EXPECT_EQ(mQueue->getDefaultSize(&width, &height), NO_ERROR);
    EXPECT_EQ(width, 0);
    EXPECT_EQ(height, 0);
}

TEST_F(BufferQueueTest, PassesTheConsumersSizeOn) {
    EXPECT_EQ(mQueue->setDefaultSize(640, 360), NO_ERROR);
    int width = 0;
    int height = 0;
    mQueue->getDefaultSize(&width, &height);
    EXPECT_EQ(width, 640);
    EXPECT_EQ(height, 360);
}

TEST_F(BufferQueueTest, RefusesImpossibleDefaultSizes) {
    mQueue->setDefaultSize(640, 360);
    EXPECT_EQ(mQueue->setDefaultSize(0, 1), BAD_VALUE);
    EXPECT_EQ(mQueue->setDefaultSize(1, 0), BAD_VALUE);
    EXPECT_EQ(mQueue->setDefaultSize(-1, -1), BAD_VALUE);
    EXPECT_EQ(mQueue->setDefaultSize(BufferQueue::kMaxDimension + 1, 1), BAD_VALUE);
    int width = 0;
    int height = 0;
    mQueue->getDefaultSize(&width, &height);
    EXPECT_EQ(width, 640);
    EXPECT_EQ(height, 360);
}

TEST_F(BufferQueueTest, RefusesImpossibleFrameSizes) {
    EXPECT_EQ(tryDequeue(0, 4), BAD_VALUE);
    EXPECT_EQ(tryDequeue(4, 0), BAD_VALUE);
    EXPECT_EQ(tryDequeue(-4, 4), BAD_VALUE);
    EXPECT_EQ(tryDequeue(4, BufferQueue::kMaxDimension + 1), BAD_VALUE);
}

TEST_F(BufferQueueTest, RowsAreAMultipleOf64BytesApartAndAllWritable) {
    for (const int width : {1, 15, 16, 17, 641}) {
        const PixelBuffer buffer = dequeue(width, 3);
        EXPECT_EQ(buffer.width, width);
        EXPECT_EQ(buffer.height, 3);
        EXPECT_EQ(buffer.stride, (static_cast<size_t>(width) * 4 + 63) / 64 * 64);
        EXPECT_EQ(reinterpret_cast<uintptr_t>(buffer.pixels) % 64, 0u);
        memset(buffer.pixels, 0xab, buffer.stride * 3);
        mQueue->cancelBuffer(buffer.slot);
    }
}

TEST_F(BufferQueueTest, GivesOutEverySlotOnceThenWouldBlock) {
    const int first = dequeue().slot;
    const int second = dequeue().slot;
    const int third = dequeue().slot;
    EXPECT_TRUE(first != second && second != third && first != third);
    EXPECT_EQ(tryDequeue(), WOULD_BLOCK);
    EXPECT_EQ(mQueue->cancelBuffer(second), NO_ERROR);
    EXPECT_EQ(dequeue().slot, second);
}

TEST_F(BufferQueueTest, OnlyADequeuedSlotCanBeQueuedOrCancelled) {
    const int slot = dequeue().slot;
    for (const int wrong : {-1, BufferQueue::kSlotCount, (slot + 1) % BufferQueue::kSlotCount}) {
        EXPECT_EQ(mQueue->queueBuffer(wrong, 0), BAD_VALUE);
        EXPECT_EQ(mQueue->cancelBuffer(wrong), BAD_VALUE);
    }
    EXPECT_EQ(mQueue->queueBuffer(slot, 0), NO_ERROR);
    EXPECT_EQ(mQueue->queueBuffer(slot, 0), BAD_VALUE);
    EXPECT_EQ(mQueue->cancelBuffer(slot), BAD_VALUE);
}

TEST_F(BufferQueueTest, TheFrameArrivesAsItWasQueued) {
    const PixelBuffer buffer = dequeue(17, 2);
    memset(buffer.pixels, 0x5a, buffer.stride * 2);
    mQueue->queueBuffer(buffer.slot, 123456);
    const BufferQueue::Frame frame = acquire();
    EXPECT_EQ(frame.timestampUs, 123456);
    EXPECT_EQ(frame.buffer.slot, buffer.slot);
    EXPECT_EQ(frame.buffer.width, 17);
    EXPECT_EQ(frame.buffer.height, 2);
    EXPECT_EQ(frame.buffer.stride, 128u);
    EXPECT_EQ(frame.buffer.pixels, buffer.pixels);
    EXPECT_EQ(frame.memory->data()[2 * 128 - 1], 0x5a);
}

TEST_F(BufferQueueTest, TheNewestFrameWins) {
    for (int64_t time = 1; time <= 10; ++time) produce(time);
    EXPECT_EQ(acquire().timestampUs, 10);
    EXPECT_EQ(mQueue->getStatistics().queued, 10u);
    EXPECT_EQ(mQueue->getStatistics().dropped, 9u);
}

TEST_F(BufferQueueTest, AHeldFrameNeitherHoldsUpTheProducerNorChanges) {
    produce(1);
    const BufferQueue::Frame held = acquire();
    for (int64_t time = 2; time <= 10; ++time) produce(time);
    EXPECT_NE(dequeue().pixels, held.buffer.pixels);
    EXPECT_EQ(mQueue->releaseFrame(held.buffer.slot), NO_ERROR);
    EXPECT_EQ(acquire().timestampUs, 10);
}

TEST_F(BufferQueueTest, TheFrameThatWasGivenBackKeepsItsContentWhileThereAreOthers) {
    produce(1);
    const int shown = acquire().buffer.slot;
    EXPECT_EQ(mQueue->releaseFrame(shown), NO_ERROR);
    const int next = dequeue().slot;
    const int other = dequeue().slot;
    EXPECT_NE(next, shown);
    EXPECT_NE(other, shown);
    EXPECT_EQ(dequeue().slot, shown) << "when it is the only one";
    EXPECT_EQ(mQueue->queueBuffer(next, 2), NO_ERROR);
    EXPECT_EQ(mQueue->releaseFrame(acquire().buffer.slot), NO_ERROR);
    EXPECT_EQ(mQueue->cancelBuffer(shown), NO_ERROR);
    EXPECT_EQ(dequeue().slot, shown) << "once another was given back";
}

TEST_F(BufferQueueTest, ATakenFrameIsNotTakenTwice) {
    EXPECT_EQ(tryAcquire(), WOULD_BLOCK);
    produce(1);
    const int slot = acquire().buffer.slot;
    EXPECT_EQ(tryAcquire(), INVALID_OPERATION);
    EXPECT_EQ(mQueue->releaseFrame(slot), NO_ERROR);
    EXPECT_EQ(mQueue->releaseFrame(slot), BAD_VALUE);
    EXPECT_EQ(tryAcquire(), WOULD_BLOCK);
    EXPECT_EQ(mQueue->getStatistics().dropped, 0u);
}

TEST_F(BufferQueueTest, ACancelledBufferIsNoFrame) {
    mQueue->cancelBuffer(dequeue().slot);
    EXPECT_EQ(tryAcquire(), WOULD_BLOCK);
    EXPECT_EQ(mQueue->getStatistics().queued, 0u);
}

TEST_F(BufferQueueTest, BuffersFollowTheSize) {
    for (const int size : {8, 2000, 500, 1, 3000}) {
        const PixelBuffer buffer = dequeue(size, size);
        EXPECT_EQ(buffer.width, size);
        EXPECT_EQ(buffer.height, size);
        memset(buffer.pixels, 1, buffer.stride * size);
        mQueue->queueBuffer(buffer.slot, size);
        const BufferQueue::Frame frame = acquire();
        EXPECT_EQ(frame.buffer.width, size);
        mQueue->releaseFrame(frame.buffer.slot);
    }
}

TEST_F(BufferQueueTest, AbandonedQueuesRefuseTheProducer) {
    const int slot = dequeue().slot;
    mQueue->abandon();
    mQueue->abandon();
    EXPECT_TRUE(mQueue->isAbandoned());
    int width = 0;
    int height = 0;
    EXPECT_EQ(mQueue->getDefaultSize(&width, &height), NO_INIT);
    EXPECT_EQ(tryDequeue(), NO_INIT);
    EXPECT_EQ(mQueue->queueBuffer(slot, 0), NO_INIT);
    EXPECT_EQ(mQueue->queueBuffer(slot, 0), BAD_VALUE);
    EXPECT_EQ(tryAcquire(), NO_INIT);
}

TEST_F(BufferQueueTest, BuffersInUseSurviveAbandoning) {
    produce(1);
    const BufferQueue::Frame held = acquire();
    const PixelBuffer drawn = dequeue();
    mQueue->abandon();
    memset(drawn.pixels, 1, drawn.stride * drawn.height);
    memset(held.memory->data(), 2, held.buffer.stride * held.buffer.height);
    EXPECT_EQ(mQueue->cancelBuffer(drawn.slot), NO_ERROR);
    EXPECT_EQ(mQueue->releaseFrame(held.buffer.slot), NO_ERROR);
    EXPECT_EQ(held.memory->data()[0], 2);
}

TEST_F(BufferQueueTest, WaitingReturnsAtOnceForAnUnseenFrameAndAfterTheTimeForNone) {
    EXPECT_EQ(mQueue->awaitFrame(0, 1), 0u);
    produce(1);
    EXPECT_EQ(mQueue->awaitFrame(0, kLongWaitMs), 1u);
    EXPECT_EQ(mQueue->awaitFrame(1, 1), 1u);
}

// Many rounds: in some the consumer is asleep when the event comes.
TEST_F(BufferQueueTest, FramesAndAbandoningWakeAWaitingConsumer) {
    constexpr uint64_t kRounds = 200;
    std::atomic<uint64_t> seen{0};
    std::future<void> consumer = std::async(std::launch::async, [&] {
        while (!mQueue->isAbandoned()) seen = mQueue->awaitFrame(seen, kLongWaitMs);
    });
    for (uint64_t round = 1; round <= kRounds; ++round) {
        produce(1);
        const auto deadline = std::chrono::steady_clock::now() + kShortWait;
        while (seen != round && std::chrono::steady_clock::now() < deadline) {
            std::this_thread::yield();
        }
        EXPECT_EQ(seen, round);
        if (seen != round) break;
    }
    mQueue->abandon();
    EXPECT_EQ(consumer.wait_for(kShortWait), std::future_status::ready);
}

TEST_F(BufferQueueTest, AFastProducerNeverTearsASlowConsumersFrame) {
    constexpr int kFrames = 5000;
    std::thread producer([&] {
        for (int i = 1; i <= kFrames; ++i) {
            const PixelBuffer buffer = dequeue(64, 4);
            memset(buffer.pixels, i & 0xff, buffer.stride * 4);
            mQueue->queueBuffer(buffer.slot, i);
        }
    });
    int64_t newest = 0;
    for (uint64_t seen = 0; newest < kFrames;) {
        seen = mQueue->awaitFrame(seen, kLongWaitMs);
        BufferQueue::Frame frame = {};
        if (mQueue->acquireFrame(&frame) != NO_ERROR) continue;
        EXPECT_GT(frame.timestampUs, newest);
        newest = frame.timestampUs;
        const uint8_t* const pixels = frame.buffer.pixels;
        EXPECT_EQ(pixels[0], newest & 0xff);
        EXPECT_EQ(memcmp(pixels, pixels + 1, frame.buffer.stride * 4 - 1), 0);
        mQueue->releaseFrame(frame.buffer.slot);
    }
    producer.join();
}

}  // namespace
}  // namespace android
