// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include "os/Export.h"
#include "os/Mutex.h"
#include "os/Relaxed.h"
#include "stream/IOrvStreamSource.h"

// Media bytes from a Java player object. Each operation attaches the calling
// thread to the virtual machine, calls the Java object and detaches; it blocks
// as long as the Java method does. No lock is held around reads and seeks, so
// cancelRead reaches Java while a read is still there.
class ORV_EXPORT JavaInputStream : public IOrvStreamSource {
public:
    // On a Java thread. thiz: the player object, kept alive by this.
    JavaInputStream(JNIEnv* env, jobject thiz);
    // On an attached thread.
    ~JavaInputStream() override;
    JavaInputStream(const JavaInputStream&) = delete;
    JavaInputStream& operator=(const JavaInputStream&) = delete;

    int read(char* buffer, int len, int& readLen) override;
    long long byteSeek(E_Orv_Stream_Seek_Type type, long long offset) override;
    uint32_t getFileLength() override;
    long long getCurrentPosition() override;
    bool isValid() override;
    void setInvalid() override;
    void lock() override;
    void unlock() override;
    int getDataSourceType() override;
    bool isSeekable() override;
    void setThreadSelf() override;
    bool isThreadSelf() override;
    void cancelRead() override;
    void closeStream() override;
    long long timeSeek(long long first, long long second) override;
    int getSeekType() override;
    bool isStallingSupport() override;
    uint32_t getDuration() override;

private:
    void copyReadBuffer(JNIEnv* env, char* buffer, int len, int count);
    bool canSeek(const char* operation);
    void callWithoutResult(const char* operation, jmethodID method);

    os::Relaxed<bool> mValid;
    jclass mClass;            // global reference
    jobject mObject;          // global reference
    os::Mutex mCallMutex;     // serialises the getters of size, position and duration
    os::Mutex mStreamMutex;   // for lock and unlock alone
    int32_t mDataSourceType;  // as of construction
    os::Relaxed<bool> mThreadSelf;
};
