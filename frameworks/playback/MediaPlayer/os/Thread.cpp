// SPDX-License-Identifier: Apache-2.0
#include "os/Thread.h"

#include <signal.h>
#include <stdio.h>
#include <sys/prctl.h>
#include <time.h>

#include "os/Semaphore.h"

namespace os {

namespace {

// The first real-time signal number of the kernel.
const int kIgnoredSignal = 32;

}  // namespace

// The signal that Run has returned.
class Thread::Implmentation {
public:
    Implmentation() : mFinished(0) {}
    int wait() { return mFinished.acquire(); }
    void notify() { mFinished.release(); }

private:
    Semaphore mFinished;
};

Thread::Thread(const std::string& name)
    : mName(name), mHandle(), mAttributes(nullptr), mImplmentation(new Implmentation) {}

Thread::~Thread() {
    delete mImplmentation;
    if (mAttributes != nullptr) {
        pthread_attr_destroy(mAttributes);
        delete mAttributes;
    }
}

void Thread::Start() {
    mAttributes = new pthread_attr_t;
    int result = pthread_attr_init(mAttributes);
    if (result != 0) {
        printf("Error pthread_attr_init %d \n", result);
        return;
    }
    result = pthread_create(&mHandle, mAttributes, start, this);
    if (result != 0) {
        printf("Error pthread_create %d \n", result);
    }
}

int Thread::Wait() { return mImplmentation != nullptr ? mImplmentation->wait() : -1; }

void Thread::sleep(const int& ms) {
    timespec duration;
    duration.tv_sec = ms / 1000;
    duration.tv_nsec = (ms % 1000) * 1000000L;
    nanosleep(&duration, nullptr);
}

void* Thread::start(void* arg) {
    Thread* thread = static_cast<Thread*>(arg);

    sigset_t terminate;
    sigemptyset(&terminate);
    sigaddset(&terminate, SIGTERM);
    sigprocmask(SIG_BLOCK, &terminate, nullptr);

    // Ignored process-wide while Run executes. A C library that keeps the
    // number to itself refuses both calls; previous is defined all the same.
    struct sigaction ignore = {};
    struct sigaction previous = {};
    ignore.sa_handler = SIG_IGN;
    sigemptyset(&ignore.sa_mask);
    sigaction(kIgnoredSignal, &ignore, &previous);

    prctl(PR_SET_NAME, thread->mName.c_str(), 0, 0, 0);
    thread->Run();
    // From here on the thread object may be gone: Wait returns.
    thread->mImplmentation->notify();

    sigaction(kIgnoredSignal, &previous, nullptr);
    return arg;
}

}  // namespace os
