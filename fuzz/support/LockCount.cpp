// SPDX-License-Identifier: Apache-2.0
#include "LockCount.h"

#include <pthread.h>

extern "C" {
int __real_pthread_mutex_lock(pthread_mutex_t* mutex);
int __real_pthread_mutex_trylock(pthread_mutex_t* mutex);
int __real_pthread_mutex_unlock(pthread_mutex_t* mutex);
int __wrap_pthread_mutex_lock(pthread_mutex_t* mutex);
int __wrap_pthread_mutex_trylock(pthread_mutex_t* mutex);
int __wrap_pthread_mutex_unlock(pthread_mutex_t* mutex);
}

namespace {

thread_local int tHeld = 0;

int counted(int result) {
    if (result == 0) tHeld++;
    return result;
}

}  // namespace

int __wrap_pthread_mutex_lock(pthread_mutex_t* mutex) {
    return counted(__real_pthread_mutex_lock(mutex));
}

int __wrap_pthread_mutex_trylock(pthread_mutex_t* mutex) {
    return counted(__real_pthread_mutex_trylock(mutex));
}

int __wrap_pthread_mutex_unlock(pthread_mutex_t* mutex) {
    const int result = __real_pthread_mutex_unlock(mutex);
    if (result == 0) tHeld--;
    return result;
}

int orvfuzz::heldLocks() { return tHeld; }
