// SPDX-License-Identifier: Apache-2.0
#include "PosixCalls.h"

#include <string.h>

// The linker sends the program's calls to the wrappers and resolves the real
// names here.
extern "C" {
int __real_sem_init(sem_t*, int, unsigned);
int __real_sem_destroy(sem_t*);
int __real_sem_wait(sem_t*);
int __real_sem_post(sem_t*);
int __real_sem_timedwait(sem_t*, const timespec*);
int __real_nanosleep(const timespec*, timespec*);
int __real_sigaction(int, const struct sigaction*, struct sigaction*);
int __real_pthread_attr_init(pthread_attr_t*);
int __real_pthread_attr_destroy(pthread_attr_t*);
int __real_pthread_mutex_destroy(pthread_mutex_t*);
int __real_pthread_mutexattr_destroy(pthread_mutexattr_t*);
int __real_pthread_create(pthread_t*, const pthread_attr_t*, void* (*)(void*), void*);
void* __real_mmap(void*, size_t, int, int, int, off_t);
int __real_munmap(void*, size_t);
void* __real_malloc(size_t);
void __real_free(void*);
}

namespace orvtest {

PosixCall<int(sem_t*, int, unsigned)> semInitCall(__real_sem_init);
PosixCall<int(sem_t*)> semDestroyCall(__real_sem_destroy);
PosixCall<int(sem_t*)> semWaitCall(__real_sem_wait);
PosixCall<int(sem_t*)> semPostCall(__real_sem_post);
PosixCall<int(sem_t*, const timespec*)> semTimedwaitCall(__real_sem_timedwait);
PosixCall<int(const timespec*, timespec*)> nanosleepCall(__real_nanosleep);
PosixCall<int(int, const struct sigaction*, struct sigaction*)> sigactionCall(__real_sigaction);
PosixCall<int(pthread_attr_t*)> pthreadAttrInitCall(__real_pthread_attr_init);
PosixCall<int(pthread_attr_t*)> pthreadAttrDestroyCall(__real_pthread_attr_destroy);
PosixCall<int(pthread_mutex_t*)> pthreadMutexDestroyCall(__real_pthread_mutex_destroy);
PosixCall<int(pthread_mutexattr_t*)> pthreadMutexattrDestroyCall(__real_pthread_mutexattr_destroy);
PosixCall<int(pthread_t*, const pthread_attr_t*, void* (*)(void*), void*)> pthreadCreateCall(
    __real_pthread_create);
PosixCall<void*(void*, size_t, int, int, int, off_t)> mmapCall(__real_mmap);
PosixCall<int(void*, size_t)> munmapCall(__real_munmap);
PosixCall<void*(size_t)> mallocCall(__real_malloc);
PosixCall<void(void*)> freeCall(__real_free);

}  // namespace orvtest

extern "C" {

int __wrap_sem_init(sem_t* sem, int shared, unsigned value) {
    return orvtest::semInitCall(sem, shared, value);
}
int __wrap_sem_destroy(sem_t* sem) { return orvtest::semDestroyCall(sem); }
int __wrap_sem_wait(sem_t* sem) { return orvtest::semWaitCall(sem); }
int __wrap_sem_post(sem_t* sem) { return orvtest::semPostCall(sem); }
int __wrap_sem_timedwait(sem_t* sem, const timespec* deadline) {
    return orvtest::semTimedwaitCall(sem, deadline);
}
int __wrap_nanosleep(const timespec* duration, timespec* rest) {
    return orvtest::nanosleepCall(duration, rest);
}
int __wrap_sigaction(int signal, const struct sigaction* action, struct sigaction* previous) {
    return orvtest::sigactionCall(signal, action, previous);
}
int __wrap_pthread_attr_init(pthread_attr_t* attributes) {
    return orvtest::pthreadAttrInitCall(attributes);
}
int __wrap_pthread_attr_destroy(pthread_attr_t* attributes) {
    return orvtest::pthreadAttrDestroyCall(attributes);
}
int __wrap_pthread_mutex_destroy(pthread_mutex_t* mutex) {
    return orvtest::pthreadMutexDestroyCall(mutex);
}
int __wrap_pthread_mutexattr_destroy(pthread_mutexattr_t* attributes) {
    return orvtest::pthreadMutexattrDestroyCall(attributes);
}
int __wrap_pthread_create(pthread_t* thread, const pthread_attr_t* attributes,
                          void* (*entry)(void*), void* argument) {
    return orvtest::pthreadCreateCall(thread, attributes, entry, argument);
}
void* __wrap_mmap(void* address, size_t length, int protection, int flags, int fd, off_t offset) {
    return orvtest::mmapCall(address, length, protection, flags, fd, offset);
}
int __wrap_munmap(void* address, size_t length) { return orvtest::munmapCall(address, length); }
void* __wrap_malloc(size_t size) { return orvtest::mallocCall(size); }
// The compiler makes one calloc of a malloc and the zeroing behind it.
void* __wrap_calloc(size_t count, size_t size) {
    void* block = orvtest::mallocCall(count * size);
    if (block != nullptr) memset(block, 0, count * size);
    return block;
}
void __wrap_free(void* block) { orvtest::freeCall(block); }

}  // extern "C"
