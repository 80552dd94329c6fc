// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <os/Mutex.h>

#include <atomic>
#include <functional>
#include <future>
#include <vector>

namespace orvtest {

// 0 when another thread could take the mutex at this moment, else EBUSY.
int tryFromAnotherThread(os::Mutex& mutex);

// Whether a thread waits for the mutex, which another one has.
bool isAwaited(os::Mutex& mutex);

// An operation on a thread of its own, begun at once; the destructor waits for its end.
class OtherThread {
public:
    using Operation = std::function<void()>;
    // within: called on that thread, to run what it is given there or on yet another.
    explicit OtherThread(
        Operation operation,
        std::function<void(const Operation&)> within = [](const Operation& run) { run(); });

    // Waits until the operation has found a mutex taken, or has ended without. While
    // the caller's thread has the mutex, the operation cannot go on.
    bool isStopped();
    void join() { mEnd.get(); }

private:
    std::atomic<bool> mIsStopped{false};
    std::future<void> mEnd;
};

// The mutexes that were made while the program loaded, in their order, up to the
// objects without a priority of their own; without those of libraries.
std::vector<const pthread_mutex_t*> mutexesMadeFirst();
const pthread_mutex_t* nativeMutex(const os::Mutex& mutex);

// Runs the operation on another thread while the mutex is held here: it must wait for
// it. The other action runs meanwhile.
void expectToWaitFor(
    os::Mutex& mutex, const std::function<void()>& operation,
    const std::function<void()>& meanwhile = [] {});

}  // namespace orvtest
