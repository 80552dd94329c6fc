// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <pthread.h>
#include <semaphore.h>
#include <signal.h>
#include <sys/mman.h>
#include <time.h>

#include <functional>
#include <mutex>
#include <utility>

namespace orvtest {

// One system call that the code under test reaches through the linker's
// --wrap: it goes to the system unless a test has put a replacement there.
template <class Signature>
class PosixCall;

template <class Result, class... Arguments>
class PosixCall<Result(Arguments...)> {
public:
    using Function = std::function<Result(Arguments...)>;

    // In force while it lives.
    class Replacement {
    public:
        Replacement(PosixCall& call, Function function) : mCall(call) {
            mCall.set(std::move(function));
        }
        ~Replacement() { mCall.set(nullptr); }
        Replacement(const Replacement&) = delete;
        Replacement& operator=(const Replacement&) = delete;

    private:
        PosixCall& mCall;
    };

    explicit PosixCall(Result (*systemCall)(Arguments...)) : real(systemCall) {}

    [[nodiscard]] Replacement replace(Function function) {
        return Replacement(*this, std::move(function));
    }

    Result operator()(Arguments... arguments) {
        Function replacement;
        {
            std::lock_guard<std::mutex> lock(mMutex);
            replacement = mReplacement;
        }
        return replacement ? replacement(arguments...) : real(arguments...);
    }

    Result (*const real)(Arguments...);

private:
    void set(Function function) {
        std::lock_guard<std::mutex> lock(mMutex);
        mReplacement = std::move(function);
    }

    std::mutex mMutex;
    Function mReplacement;
};

extern PosixCall<int(sem_t*, int, unsigned)> semInitCall;
extern PosixCall<int(sem_t*)> semDestroyCall;
extern PosixCall<int(sem_t*)> semWaitCall;
extern PosixCall<int(sem_t*)> semPostCall;
extern PosixCall<int(sem_t*, const timespec*)> semTimedwaitCall;
extern PosixCall<int(const timespec*, timespec*)> nanosleepCall;
extern PosixCall<int(int, const struct sigaction*, struct sigaction*)> sigactionCall;
extern PosixCall<int(pthread_attr_t*)> pthreadAttrInitCall;
extern PosixCall<int(pthread_attr_t*)> pthreadAttrDestroyCall;
extern PosixCall<int(pthread_mutex_t*)> pthreadMutexDestroyCall;
extern PosixCall<int(pthread_mutexattr_t*)> pthreadMutexattrDestroyCall;
extern PosixCall<int(pthread_t*, const pthread_attr_t*, void* (*)(void*), void*)> pthreadCreateCall;
extern PosixCall<void*(void*, size_t, int, int, int, off_t)> mmapCall;
extern PosixCall<int(void*, size_t)> munmapCall;
extern PosixCall<void*(size_t)> mallocCall;
extern PosixCall<void(void*)> freeCall;

}  // namespace orvtest
