// SPDX-License-Identifier: Apache-2.0
#include "MutexProbe.h"

#include <errno.h>
#include <gtest/gtest.h>
#include <os/ScopedMutex.h>

#include <atomic>
#include <chrono>
#include <thread>

#include "PrivateMember.h"

extern "C" {
int __real_pthread_mutex_init(pthread_mutex_t*, const pthread_mutexattr_t*);
int __real_pthread_mutex_lock(pthread_mutex_t*);
}

namespace orvtest {

ORV_OPEN_MEMBER(NativeMutex, os::Mutex, mMutex);

namespace {

thread_local std::atomic<bool>* tIsStopped = nullptr;

// Plain memory, for the mutexes are made before anything else.
constexpr int kMaxFirst = 16;
const pthread_mutex_t* gFirst[kMaxFirst];
int gFirstCount = 0;
bool gIsLoading = true;

// Before all objects without a priority of their own.
struct EndOfPriorities {
    EndOfPriorities() { gIsLoading = false; }
};
[[maybe_unused]] EndOfPriorities gEndOfPriorities __attribute__((init_priority(65534)));

}  // namespace

OtherThread::OtherThread(Operation operation, std::function<void(const Operation&)> within)
    : mEnd(std::async(std::launch::async, [this, operation, within] {
          within([&] {
              tIsStopped = &mIsStopped;
              operation();
              tIsStopped = nullptr;
          });
      })) {}

bool OtherThread::isStopped() {
    const auto hasEnded = [this] {
        return mEnd.wait_for(std::chrono::seconds(0)) == std::future_status::ready;
    };
    while (!mIsStopped && !hasEnded()) std::this_thread::yield();
    return mIsStopped;
}

std::vector<const pthread_mutex_t*> mutexesMadeFirst() { return {gFirst, gFirst + gFirstCount}; }

const pthread_mutex_t* nativeMutex(const os::Mutex& mutex) {
    return &(mutex.*memberOf(NativeMutex{}));
}

int tryFromAnotherThread(os::Mutex& mutex) {
    int result = -1;
    std::thread([&] {
        pthread_mutex_t* native = &(mutex.*memberOf(NativeMutex{}));
        result = pthread_mutex_trylock(native);
        if (result == 0) pthread_mutex_unlock(native);
    }).join();
    return result;
}

bool isAwaited(os::Mutex& mutex) {
    // As glibc's mutexes have it: 0 for free, 1 for taken, 2 for taken and awaited.
    const int* lock = &(mutex.*memberOf(NativeMutex{})).__data.__lock;
    return __atomic_load_n(lock, __ATOMIC_RELAXED) > 1;
}

void expectToWaitFor(os::Mutex& mutex, const std::function<void()>& operation,
                     const std::function<void()>& meanwhile) {
    std::atomic<bool> done{false};
    std::thread operating;
    {
        const os::ScopedMutex held(mutex);
        operating = std::thread([&] {
            operation();
            done = true;
        });
        while (!done && !isAwaited(mutex)) std::this_thread::yield();
        EXPECT_FALSE(done) << "it does not wait";
        meanwhile();
    }
    operating.join();
}

}  // namespace orvtest

extern "C" {

int __wrap_pthread_mutex_init(pthread_mutex_t* mutex, const pthread_mutexattr_t* attributes) {
    using namespace orvtest;
    if (gIsLoading && gFirstCount < kMaxFirst) gFirst[gFirstCount++] = mutex;
    return __real_pthread_mutex_init(mutex, attributes);
}

int __wrap_pthread_mutex_lock(pthread_mutex_t* mutex) {
    std::atomic<bool>* isStopped = orvtest::tIsStopped;
    if (isStopped == nullptr) return __real_pthread_mutex_lock(mutex);
    const int result = pthread_mutex_trylock(mutex);
    if (result != EBUSY) return result;
    *isStopped = true;
    return __real_pthread_mutex_lock(mutex);
}

}  // extern "C"
