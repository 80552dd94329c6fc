// SPDX-License-Identifier: Apache-2.0
#include "os/Mutex.h"

namespace os {

Mutex::Mutex() {
    pthread_mutexattr_init(&mAttributes);
    pthread_mutexattr_settype(&mAttributes, PTHREAD_MUTEX_RECURSIVE);
    pthread_mutex_init(&mMutex, &mAttributes);
}

Mutex::~Mutex() {
    pthread_mutexattr_destroy(&mAttributes);
    pthread_mutex_destroy(&mMutex);
}

int Mutex::lock() { return pthread_mutex_lock(&mMutex); }

int Mutex::unlock() { return pthread_mutex_unlock(&mMutex); }

}  // namespace os
