// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include <string>

namespace orvbench {

// A com.quintora.mmp.Workload. After the first failure nothing reaches Java any
// more, and failure() says what it was.
class JavaWorkload {
public:
    // factory: the method of com.quintora.mmp.Workloads that makes it.
    explicit JavaWorkload(const char* factory);
    ~JavaWorkload();
    JavaWorkload(const JavaWorkload&) = delete;
    JavaWorkload& operator=(const JavaWorkload&) = delete;

    void run(jint times);
    void rewind();
    // To be called at the end: it checks what was done, and frees the player.
    void close();

    // The OrvMediaPlayer that is measured; null after a failure to make it.
    // Threads may share the reference.
    jobject player() const { return mPlayer; }

    bool failed() const { return !mFailure.empty(); }
    const std::string& failure() const { return mFailure; }

private:
    void make(JNIEnv* env, const char* factory);
    void call(jmethodID method, jint times = 0);

    jobject mWorkload = nullptr;  // global references
    jobject mPlayer = nullptr;
    jmethodID mRun = nullptr;
    jmethodID mRewind = nullptr;
    jmethodID mClose = nullptr;
    std::string mFailure;
};

}  // namespace orvbench
