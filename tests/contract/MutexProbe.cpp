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

}  // namespace orvtest
