// SPDX-License-Identifier: Apache-2.0
#include "MutexProbe.h"

#include <thread>

#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(NativeMutex, os::Mutex, mMutex);

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

}  // namespace orvtest
