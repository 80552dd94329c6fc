// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <os/MessageQueue.h>

#include <thread>
#include <vector>

#include "MutexProbe.h"
#include "PosixCalls.h"
#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(QueueItems, os::MessageQueue<int>, mQueue);
ORV_OPEN_MEMBER(QueueMutex, os::MessageQueue<int>, mMutex);

namespace {

TEST(OsMessageQueueTest, KeepsTheOrderAndPostsOnlyWhenItStopsBeingEmpty) {
    os::MessageQueue<int> queue;
    const std::thread::id self = std::this_thread::get_id();
    int posts = 0;
    auto record = semPostCall.replace([&](sem_t* sem) {
        if (std::this_thread::get_id() == self) posts++;
        return semPostCall.real(sem);
    });
    for (int item : {1, 2, 3}) queue.send(item);
    EXPECT_EQ(posts, 1);
    for (int item : {1, 2, 3}) EXPECT_EQ(queue.recv(), item);
    queue.send(4);
    EXPECT_EQ(posts, 2);
    EXPECT_EQ(queue.recv(), 4);
}

// Items found without waiting leave their wake-up behind: the receiver must
// see through it and wait for a real item.
TEST(OsMessageQueueTest, ReceiverWaitsForTheNextSendInSpiteOfStaleWakeUps) {
    os::MessageQueue<int> queue;
    for (int round = 0; round < 3; round++) {
        queue.send(round);
        EXPECT_EQ(queue.recv(), round);
    }
    // Three wake-ups are left; only the wait behind them is one for an item.
    const std::thread::id self = std::this_thread::get_id();
    int waits = 0;
    auto record = semWaitCall.replace([&](sem_t* sem) {
        if (std::this_thread::get_id() == self && ++waits == 4) queue.send(99);
        return semWaitCall.real(sem);
    });
    EXPECT_EQ(queue.recv(), 99);
    EXPECT_EQ(waits, 4);
}

TEST(OsMessageQueueTest, ManySendersLoseNothingAndKeepTheirOwnOrder) {
    const int kSenders = 4;
    const int kItems = 2000;
    os::MessageQueue<int> queue;
    std::vector<std::thread> senders;
    for (int sender = 0; sender < kSenders; sender++) {
        senders.emplace_back([&queue, sender] {
            for (int i = 0; i < kItems; i++) queue.send(sender * kItems + i);
        });
    }
    std::vector<int> next(kSenders, 0);
    for (int i = 0; i < kSenders * kItems; i++) {
        const int item = queue.recv();
        EXPECT_EQ(item % kItems, next[item / kItems]++);
    }
    for (std::thread& sender : senders) sender.join();
    EXPECT_EQ(next, std::vector<int>(kSenders, kItems));
}

TEST(OsMessageQueueTest, SendWaitsForTheMutex) {
    os::MessageQueue<int> queue;
    int posts = 0;
    const auto record = semPostCall.replace([&](sem_t* sem) {
        posts++;
        return semPostCall.real(sem);
    });
    expectToWaitFor(
        queue.*memberOf(QueueMutex{}), [&] { queue.send(2); },
        [&] { (queue.*memberOf(QueueItems{})).push(1); });
    EXPECT_EQ(posts, 0) << "it looked whether the queue is empty before it had the mutex";
    EXPECT_EQ(queue.recv(), 1);
    EXPECT_EQ(queue.recv(), 2);
}

// The item is the one that is first once the receiver has the mutex.
TEST(OsMessageQueueTest, RecvWaitsForTheMutexBeforeItLooksAtTheFirstItem) {
    os::MessageQueue<int> queue;
    queue.send(1);
    int received = 0;
    expectToWaitFor(
        queue.*memberOf(QueueMutex{}), [&] { received = queue.recv(); },
        [&] {
            auto& items = queue.*memberOf(QueueItems{});
            items.push(2);
            items.pop();
        });
    EXPECT_EQ(received, 2);
}

TEST(OsMessageQueueTest, DropsWhatIsStillQueuedWithoutFreeingIt) {
    int item = 7;
    {
        os::MessageQueue<int*> queue;
        queue.send(&item);
        queue.send(nullptr);
    }
    EXPECT_EQ(item, 7);
}

}  // namespace
}  // namespace orvtest
