// SPDX-License-Identifier: Apache-2.0
#include "os/Semaphore.h"

#include <errno.h>
#include <stdio.h>
#include <time.h>

#include "os/Thread.h"

namespace os {

Semaphore::Semaphore(int value) {
    if (sem_init(&mSemaphore, 0, value) != 0) {
        printf("semaphore init error %d\n", errno);
    }
}

Semaphore::~Semaphore() { sem_destroy(&mSemaphore); }

int Semaphore::acquire() { return sem_wait(&mSemaphore); }

int Semaphore::acquire(int ms) {
    // Whole seconds only: the fraction of the current one is left out.
    timespec deadline;
    deadline.tv_sec = time(nullptr) + ms / 1000;
    deadline.tv_nsec = (ms % 1000) * 1000000L;
    return sem_timedwait(&mSemaphore, &deadline);
}

int Semaphore::tryAcquire() {
    while (sem_trywait(&mSemaphore) != 0) Thread::sleep(50);
    return 0;
}

int Semaphore::release() { return sem_post(&mSemaphore); }

}  // namespace os
