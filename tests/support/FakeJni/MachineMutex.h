// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mutex>

#ifdef __SANITIZE_THREAD__
#define ORV_THREAD_SANITIZER 1
#elif defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define ORV_THREAD_SANITIZER 1
#endif
#endif

#ifdef ORV_THREAD_SANITIZER
// Of the sanitizer's runtime; no header declares them.
extern "C" {
void AnnotateIgnoreReadsBegin(const char* file, int line);
void AnnotateIgnoreReadsEnd(const char* file, int line);
void AnnotateIgnoreWritesBegin(const char* file, int line);
void AnnotateIgnoreWritesEnd(const char* file, int line);
void AnnotateIgnoreSyncBegin(const char* file, int line);
void AnnotateIgnoreSyncEnd(const char* file, int line);
}
#endif

namespace fakejni {

// The fake machine's lock. The thread sanitizer overlooks it and all that is done
// with it held: the machine's bookkeeping must not put an order on the code under
// test that a real machine does not give, or its races would stay unseen.
class MachineMutex {
public:
    void lock() {
        beginOverlooking();
        mMutex.lock();
        mDepth++;
    }
    void unlock() {
        mDepth--;
        mMutex.unlock();
        endOverlooking();
    }

    // Looks again while it lives: around what is not the machine's own.
    class Look {
    public:
        // With the mutex held.
        explicit Look(const MachineMutex& mutex) : mDepth(mutex.mDepth) {
            for (int i = 0; i < mDepth; ++i) endOverlooking();
        }
        ~Look() {
            for (int i = 0; i < mDepth; ++i) beginOverlooking();
        }
        Look(const Look&) = delete;
        Look& operator=(const Look&) = delete;

    private:
        const int mDepth;
    };

private:
#ifdef ORV_THREAD_SANITIZER
    static void beginOverlooking() {
        AnnotateIgnoreReadsBegin(__FILE__, __LINE__);
        AnnotateIgnoreWritesBegin(__FILE__, __LINE__);
        AnnotateIgnoreSyncBegin(__FILE__, __LINE__);
    }
    static void endOverlooking() {
        AnnotateIgnoreSyncEnd(__FILE__, __LINE__);
        AnnotateIgnoreWritesEnd(__FILE__, __LINE__);
        AnnotateIgnoreReadsEnd(__FILE__, __LINE__);
    }
#else
    static void beginOverlooking() {}
    static void endOverlooking() {}
#endif

    std::recursive_mutex mMutex;
    int mDepth = 0;  // how often its owner holds it
};

}  // namespace fakejni
