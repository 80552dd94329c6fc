// SPDX-License-Identifier: Apache-2.0
#include <errno.h>
#include <gtest/gtest.h>
#include <os/Mutex.h>
#include <os/ScopedMutex.h>

#include <string>
#include <thread>
#include <vector>

#include "MutexProbe.h"
#include "PosixCalls.h"
#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(MutexAttributes, os::Mutex, mAttributes);

namespace {

TEST(OsMutexTest, IsFreeOnlyAfterItsOwnerUnlockedItAsOftenAsItLockedIt) {
    os::Mutex mutex;
    EXPECT_EQ(mutex.lock(), 0);
    EXPECT_EQ(mutex.lock(), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), EBUSY);
    EXPECT_EQ(mutex.unlock(), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), EBUSY);
    EXPECT_EQ(mutex.unlock(), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), 0);
}

// A misuse on purpose; cmake/tsan.supp names it.
void unlockWithoutHolding(os::Mutex* mutex, int* result) { *result = mutex->unlock(); }

TEST(OsMutexTest, UnlockByAnotherThreadGivesThePosixError) {
    os::Mutex mutex;
    mutex.lock();
    int result = 0;
    std::thread(unlockWithoutHolding, &mutex, &result).join();
    EXPECT_EQ(result, EPERM);
    EXPECT_EQ(tryFromAnotherThread(mutex), EBUSY);
    mutex.unlock();
}

TEST(OsMutexTest, IsALockThroughItsInterface) {
    os::Mutex mutex;
    os::Lock& lock = mutex;
    EXPECT_EQ(lock.lock(), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), EBUSY);
    EXPECT_EQ(lock.unlock(), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), 0);
}

TEST(OsMutexTest, DestructionGivesTheAttributesBackBeforeTheMutex) {
    std::vector<const void*> expected;
    std::vector<const void*> destroyed;
    const std::thread::id self = std::this_thread::get_id();
    const auto note = [&](const void* block) {
        if (std::this_thread::get_id() == self) destroyed.push_back(block);
    };
    auto attributes = pthreadMutexattrDestroyCall.replace([&](pthread_mutexattr_t* block) {
        note(block);
        return pthreadMutexattrDestroyCall.real(block);
    });
    auto mutexes = pthreadMutexDestroyCall.replace([&](pthread_mutex_t* block) {
        note(block);
        return pthreadMutexDestroyCall.real(block);
    });
    {
        os::Mutex mutex;
        expected = {&(mutex.*memberOf(MutexAttributes{})), nativeMutex(mutex)};
    }
    EXPECT_EQ(destroyed, expected);
}

// Refuses both, to show that a scope guard looks at neither result.
class RefusingLock : public os::Lock {
public:
    int lock() override {
        calls += "lock ";
        return EINVAL;
    }
    int unlock() override {
        calls += "unlock ";
        return EINVAL;
    }
    std::string calls;
};

TEST(ScopedMutexTest, LocksOnceAndUnlocksAtTheEndOfTheScope) {
    RefusingLock lock;
    {
        os::ScopedMutex scope(lock);
        EXPECT_EQ(lock.calls, "lock ");
    }
    EXPECT_EQ(lock.calls, "lock unlock ");
}

TEST(ScopedMutexTest, NestsOnOneThread) {
    os::Mutex mutex;
    {
        os::ScopedMutex outer(mutex);
        {
            os::ScopedMutex inner(mutex);
        }
        EXPECT_EQ(tryFromAnotherThread(mutex), EBUSY);
    }
    EXPECT_EQ(tryFromAnotherThread(mutex), 0);
}

}  // namespace
}  // namespace orvtest
