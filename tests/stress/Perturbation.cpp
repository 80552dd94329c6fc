// SPDX-License-Identifier: Apache-2.0
#include "Perturbation.h"

#include <pthread.h>
#include <sched.h>
#include <semaphore.h>
#include <time.h>
#include <utils/RefBase.h>

#include <atomic>

// The linker sends the program's calls to the wrappers and resolves the real
// names here.
extern "C" {
int __real_pthread_mutex_lock(pthread_mutex_t*);
int __real_pthread_mutex_unlock(pthread_mutex_t*);
int __real_sem_wait(sem_t*);
int __real_sem_post(sem_t*);
int __real_nanosleep(const timespec*, timespec*);
void __real__ZNK7android7RefBase9incStrongEPKv(const android::RefBase*, const void*);
void __real__ZNK7android7RefBase9decStrongEPKv(const android::RefBase*, const void*);
}

namespace stress {

namespace {

std::atomic<uint32_t> sSeed{0};
std::atomic<uint64_t> sPauses{0};

// A thread's own state, plain numbers: it is used inside the C library's calls, also
// while a thread ends.
thread_local uint32_t tNumber = 0;
thread_local uint32_t tSeed = 0;
thread_local uint64_t tState = 0;

// splitmix64
uint64_t next() {
    uint64_t z = (tState += 0x9E3779B97F4A7C15u);
    z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9u;
    z = (z ^ (z >> 27)) * 0x94D049BB133111EBu;
    return z ^ (z >> 31);
}

void startSequence(uint32_t seed) {
    tSeed = seed;
    tState = (static_cast<uint64_t>(seed) << 32) | tNumber;
}

// One point in 64 pauses; an eighth of those sleeps for up to 128 microseconds.
void meet() {
    const uint32_t seed = sSeed.load(std::memory_order_relaxed);
    if (seed == 0) return;
    if (seed != tSeed) startSequence(seed);
    const uint64_t choice = next();
    if (choice % 64 != 0) return;
    sPauses.fetch_add(1, std::memory_order_relaxed);
    if (choice % 512 != 0) {
        sched_yield();
        return;
    }
    const timespec pause = {0, static_cast<long>((choice >> 32) % 128 * 1000)};
    __real_nanosleep(&pause, nullptr);
}

}  // namespace

void setPerturbation(uint32_t seed) { sSeed.store(seed, std::memory_order_relaxed); }

void setPerturbationThread(uint32_t number) {
    tNumber = number;
    tSeed = 0;
}

uint64_t perturbations() { return sPauses.load(std::memory_order_relaxed); }

}  // namespace stress

extern "C" {

int __wrap_pthread_mutex_lock(pthread_mutex_t* mutex) {
    stress::meet();
    const int result = __real_pthread_mutex_lock(mutex);
    stress::meet();
    return result;
}
int __wrap_pthread_mutex_unlock(pthread_mutex_t* mutex) {
    stress::meet();
    const int result = __real_pthread_mutex_unlock(mutex);
    stress::meet();
    return result;
}
int __wrap_sem_wait(sem_t* sem) {
    stress::meet();
    return __real_sem_wait(sem);
}
int __wrap_sem_post(sem_t* sem) {
    const int result = __real_sem_post(sem);
    stress::meet();
    return result;
}
void __wrap__ZNK7android7RefBase9incStrongEPKv(const android::RefBase* object, const void* id) {
    stress::meet();
    __real__ZNK7android7RefBase9incStrongEPKv(object, id);
}
void __wrap__ZNK7android7RefBase9decStrongEPKv(const android::RefBase* object, const void* id) {
    stress::meet();
    __real__ZNK7android7RefBase9decStrongEPKv(object, id);
}
// The dispatcher's pause behind each delivery would be most of the program's time;
// that it is taken, and how long, contract_tests show.
int __wrap_nanosleep(const timespec*, timespec*) {
    sched_yield();
    return 0;
}

}  // extern "C"
