// SPDX-License-Identifier: Apache-2.0
#include <errno.h>
#include <gtest/gtest.h>
#include <os/Semaphore.h>

#include <vector>

#include "PosixCalls.h"

namespace orvtest {
namespace {

using testing::internal::CaptureStdout;
using testing::internal::GetCapturedStdout;

// Whether the semaphore is above 0; takes one if so. The deadline has passed
// already, so this never waits.
bool takeOne(os::Semaphore& semaphore) {
    if (semaphore.acquire(0) == 0) return true;
    EXPECT_EQ(errno, ETIMEDOUT);
    return false;
}

TEST(OsSemaphoreTest, StartsAtItsValue) {
    os::Semaphore semaphore(2);
    EXPECT_EQ(semaphore.acquire(), 0);
    EXPECT_EQ(semaphore.acquire(), 0);
    EXPECT_FALSE(takeOne(semaphore));
}

TEST(OsSemaphoreTest, ReleaseCounts) {
    os::Semaphore semaphore(0);
    EXPECT_EQ(semaphore.release(), 0);
    EXPECT_EQ(semaphore.release(), 0);
    EXPECT_TRUE(takeOne(semaphore));
    EXPECT_TRUE(takeOne(semaphore));
    EXPECT_FALSE(takeOne(semaphore));
}

TEST(OsSemaphoreTest, FailedInitialisationIsPrintedWithErrno) {
    CaptureStdout();
    {
        auto failure = semInitCall.replace([](sem_t*, int, unsigned) {
            errno = ENOSYS;
            return -1;
        });
        os::Semaphore semaphore(1);
    }
    EXPECT_EQ(GetCapturedStdout(), "semaphore init error " + std::to_string(ENOSYS) + "\n");
}

TEST(OsSemaphoreTest, NegativeValueIsRefusedByTheSystemAndPrinted) {
    CaptureStdout();
    {
        os::Semaphore semaphore(-1);
    }
    EXPECT_EQ(GetCapturedStdout(), "semaphore init error " + std::to_string(EINVAL) + "\n");
}

TEST(OsSemaphoreTest, IsNotSharedBetweenProcesses) {
    int shared = -1;
    unsigned value = 0;
    auto record = semInitCall.replace([&](sem_t* sem, int s, unsigned v) {
        shared = s;
        value = v;
        return semInitCall.real(sem, s, v);
    });
    os::Semaphore semaphore(7);
    EXPECT_EQ(shared, 0);
    EXPECT_EQ(value, 7u);
}

TEST(OsSemaphoreTest, ResultsAreTheSystems) {
    os::Semaphore semaphore(1);
    {
        auto failure = semWaitCall.replace([](sem_t*) { return -1; });
        EXPECT_EQ(semaphore.acquire(), -1);
    }
    auto failure = semPostCall.replace([](sem_t*) { return -1; });
    EXPECT_EQ(semaphore.release(), -1);
}

TEST(OsSemaphoreTest, IsDestroyedWithItsObject) {
    int destroyed = 0;
    auto record = semDestroyCall.replace([&](sem_t* sem) {
        destroyed++;
        return semDestroyCall.real(sem);
    });
    {
        os::Semaphore semaphore(1);
        EXPECT_EQ(destroyed, 0);
    }
    EXPECT_EQ(destroyed, 1);
}

class TimedAcquireTest : public testing::TestWithParam<int> {};

// The fraction of the current second is not in the deadline: 1500 ms asked for
// at 10.9 s end at 11.5 s.
TEST_P(TimedAcquireTest, DeadlineCountsFromTheStartOfTheCurrentSecond) {
    const int ms = GetParam();
    timespec deadline = {};
    auto record = semTimedwaitCall.replace([&](sem_t*, const timespec* t) {
        deadline = *t;
        errno = ETIMEDOUT;
        return -1;
    });
    os::Semaphore semaphore(0);
    const time_t before = time(nullptr);
    EXPECT_EQ(semaphore.acquire(ms), -1);
    EXPECT_EQ(errno, ETIMEDOUT);
    const time_t after = time(nullptr);
    EXPECT_GE(deadline.tv_sec, before + ms / 1000);
    EXPECT_LE(deadline.tv_sec, after + ms / 1000);
    EXPECT_EQ(deadline.tv_nsec, ms % 1000 * 1000000);
}

INSTANTIATE_TEST_SUITE_P(Milliseconds, TimedAcquireTest,
                         testing::Values(0, 1, 50, 999, 1000, 1500, 60001, 2147483647));

TEST(OsSemaphoreTest, TimedAcquireTakesWhatIsThere) {
    os::Semaphore semaphore(1);
    EXPECT_EQ(semaphore.acquire(10000), 0);
    EXPECT_FALSE(takeOne(semaphore));
}

TEST(OsSemaphoreTest, TryAcquirePollsEvery50MillisecondsUntilItHoldsTheSemaphore) {
    os::Semaphore semaphore(0);
    std::vector<timespec> sleeps;
    auto record = nanosleepCall.replace([&](const timespec* duration, timespec*) {
        sleeps.push_back(*duration);
        if (sleeps.size() == 3) semaphore.release();
        return 0;
    });
    EXPECT_EQ(semaphore.tryAcquire(), 0);
    ASSERT_EQ(sleeps.size(), 3u);
    for (const timespec& sleep : sleeps) {
        EXPECT_EQ(sleep.tv_sec, 0);
        EXPECT_EQ(sleep.tv_nsec, 50000000);
    }
    EXPECT_FALSE(takeOne(semaphore));
}

TEST(OsSemaphoreTest, TryAcquireDoesNotSleepWhenTheSemaphoreIsFree) {
    os::Semaphore semaphore(1);
    int sleeps = 0;
    auto record = nanosleepCall.replace([&](const timespec*, timespec*) {
        sleeps++;
        return 0;
    });
    EXPECT_EQ(semaphore.tryAcquire(), 0);
    EXPECT_EQ(sleeps, 0);
}

}  // namespace
}  // namespace orvtest
