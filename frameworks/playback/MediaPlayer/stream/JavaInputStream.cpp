// SPDX-License-Identifier: Apache-2.0
#include "stream/JavaInputStream.h"

#include <android_runtime/AndroidRuntime.h>
#include <nativehelper/JNIHelp.h>
#include <string.h>

#include <algorithm>

#include "jni/BridgeLog.h"
#include "jni/ClientFields.h"
#include "jni/JavaVm.h"
#include "os/ScopedMutex.h"

using android::AndroidRuntime;
using android::gClientFields;

namespace {

const long long kUnknownLength = 0x7FFFFFFFFFFFFFFF;

// Attaches the calling thread for one call; the caller detaches. The result of
// the attach is reported, never judged.
JNIEnv* attach(jint* result = nullptr) {
    JNIEnv* env = AndroidRuntime::getJNIEnv();
    const jint attachResult = g__JavaVM->AttachCurrentThread(&env, nullptr);
    if (result != nullptr) *result = attachResult;
    return env;
}

void detach() { g__JavaVM->DetachCurrentThread(); }

bool hasJavaVm(const char* operation) {
    if (g__JavaVM != nullptr) return true;
    ALOGE("%s g__JavaVM==NULL\n", operation);
    return false;
}

}  // namespace

JavaInputStream::JavaInputStream(JNIEnv* env, jobject thiz) : mValid(true), mThreadSelf(false) {
    ALOGI("JavaInputStream::JavaInputStream(): Enter\n");
    jclass clazz = env->GetObjectClass(thiz);
    if (clazz == nullptr) {
        // The poster's text, shared on purpose.
        ALOGE(
            "MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz): Can't find %s",
            android::kPlayerClassPath);
        jniThrowException(env, "java/lang/Exception", nullptr);
    }
    mClass = static_cast<jclass>(env->NewGlobalRef(clazz));
    mObject = env->NewGlobalRef(thiz);
    mDataSourceType = env->GetIntField(thiz, gClientFields.dataSourceType);
    ALOGI("JavaInputStream::JavaInputStream(): E_Orv_Stream_Source_Type is %d\n", mDataSourceType);
    ALOGI("JavaInputStream::JavaInputStream(): Leave\n");
}

JavaInputStream::~JavaInputStream() {
    ALOGI("JavaInputStream::~JavaInputStream(): Enter\n");
    mValid = false;
    JNIEnv* env = AndroidRuntime::getJNIEnv();
    env->DeleteGlobalRef(mObject);
    env->DeleteGlobalRef(mClass);
    ALOGI("JavaInputStream::~JavaInputStream(): Leave\n");
}

int JavaInputStream::read(char* buffer, int len, int& readLen) {
    readLen = 0;
    if (!mValid) {
        ALOGI("JavaInputStream::read(): input stream is not valid now, return directly!!!!");
        return ORV_STREAM_ERROR_CODE_EOF;
    }
    if (buffer == nullptr) {
        ALOGE("JavaInputStream::read(): buffer==NULL\n");
        return ORV_STREAM_ERROR_CODE_NOT_OK;
    }
    if (g__JavaVM == nullptr) {
        ALOGE("JavaInputStream::read(): g__JavaVM==NULL\n");
        return ORV_STREAM_ERROR_CODE_NOT_OK;
    }

    JNIEnv* env = attach();
    const int count = env->CallIntMethod(mObject, gClientFields.readStream, len);
    if (count == 0) {
        detach();
        ALOGI("JavaInputStream::read(): just return ORV_STREAM_ERROR_CODE_EOF!\n");
        return ORV_STREAM_ERROR_CODE_EOF;
    }
    if (count < 0) {
        detach();
        ALOGE("JavaInputStream::read(): just return ORV_STREAM_ERROR_CODE_NOT_OK!\n");
        return ORV_STREAM_ERROR_CODE_NOT_OK;
    }
    if (!mValid) {
        // The thread stays attached.
        ALOGI("JavaInputStream::read(): input stream is not valid now, return directly!!!!");
        return ORV_STREAM_ERROR_CODE_EOF;
    }
    copyReadBuffer(env, buffer, len, count);
    detach();
    readLen = count;  // Java's count, even when fewer bytes were copied
    return ORV_STREAM_ERROR_CODE_OK;
}

void JavaInputStream::copyReadBuffer(JNIEnv* env, char* buffer, int len, int count) {
    jbyteArray array =
        static_cast<jbyteArray>(env->GetObjectField(mObject, gClientFields.streamReadBuffer));
    jbyte* bytes = array != nullptr ? env->GetByteArrayElements(array, nullptr) : nullptr;
    if (bytes == nullptr) {
        ALOGE("JavaInputStream::read(): pByte_readBuffer=null, please check!\n");
        return;
    }
    // Java's count is not trusted beyond the end of its own array.
    const int available = std::min(count, env->GetArrayLength(array));
    memcpy(buffer, bytes, std::max(0, std::min(available, len)));
    if (count > len) ALOGE("JavaInputStream::read(): copy i4ReadResult>len Issue handle \n");
    env->ReleaseByteArrayElements(array, bytes, 0);
}

bool JavaInputStream::canSeek(const char* operation) {
    if (!mValid) {
        ALOGI("%s input stream is not valid now, return directly!!!!", operation);
        return false;
    }
    return hasJavaVm(operation);
}

long long JavaInputStream::byteSeek(E_Orv_Stream_Seek_Type type, long long offset) {
    if (!canSeek(__func__)) return -1;
    JNIEnv* env = attach();
    // Asked afresh: Java may change its mind after construction.
    const jint sourceType = env->GetIntField(mObject, gClientFields.dataSourceType);
    const jmethodID seek = sourceType == E_ORV_STREAM_SOURCE_EXTENDED_SEEK
                               ? gClientFields.seekStreamEx
                               : gClientFields.seekStream;
    const jlong position =
        env->CallLongMethod(mObject, seek, static_cast<jint>(type), static_cast<jlong>(offset));
    detach();
    return position;
}

long long JavaInputStream::timeSeek(long long first, long long second) {
    if (!canSeek(__func__)) return -1;
    JNIEnv* env = attach();
    env->GetIntField(mObject, gClientFields.dataSourceType);  // read, not used
    const jlong position =
        env->CallLongMethod(mObject, gClientFields.timeSeekStream, static_cast<jlong>(first),
                            static_cast<jlong>(second));
    detach();
    return position;
}

void JavaInputStream::callWithoutResult(const char* operation, jmethodID method) {
    ALOGI("JavaInputStream::%s Enter\n", operation);
    if (!hasJavaVm(operation)) return;
    JNIEnv* env = attach();
    env->CallLongMethod(mObject, method);  // the long-returning form of a void method
    detach();
    ALOGI("JavaInputStream::%s Leave\n", operation);
}

void JavaInputStream::cancelRead() { callWithoutResult(__func__, gClientFields.cancelRead); }

void JavaInputStream::closeStream() { callWithoutResult(__func__, gClientFields.closeStream); }

uint32_t JavaInputStream::getFileLength() {
    os::ScopedMutex lock(mCallMutex);
    ALOGI("%s Enter\n", __func__);
    if (!hasJavaVm(__func__)) return 0;
    ALOGI("%s g__JavaVM[X] = %p\n", __func__, g__JavaVM);
    jint attachResult;
    JNIEnv* env = attach(&attachResult);
    ALOGI("%s i4AttachRet = %d\n", __func__, attachResult);
    long long size = env->GetLongField(mObject, gClientFields.streamSize);
    ALOGI("%s stream size = %lld\n", __func__, size);
    if (size == 0) size = kUnknownLength;
    detach();
    ALOGI("%s stream size = %lld\n", __func__, size);
    ALOGI("%s Leave\n", __func__);
    return static_cast<uint32_t>(size);
}

long long JavaInputStream::getCurrentPosition() {
    os::ScopedMutex lock(mCallMutex);
    if (!hasJavaVm(__func__)) return 0;
    JNIEnv* env = attach();
    const jlong position = env->GetLongField(mObject, gClientFields.streamCurPos);
    detach();
    return position;
}

uint32_t JavaInputStream::getDuration() {
    os::ScopedMutex lock(mCallMutex);
    ALOGI("%s Enter\n", __func__);
    if (!hasJavaVm(__func__)) return 0;
    ALOGI("%s g__JavaVM[X] = %p\n", __func__, g__JavaVM);
    jint attachResult;
    JNIEnv* env = attach(&attachResult);
    ALOGI("%s i4AttachRet = %d\n", __func__, attachResult);
    const long long duration = env->GetLongField(mObject, gClientFields.streamDuration);
    ALOGI("%s stream Duration = %lld\n", __func__, duration);
    detach();
    ALOGI("%s stream Duration = %lld\n", __func__, duration);
    ALOGI("%s Leave\n", __func__);
    return static_cast<uint32_t>(duration);
}

bool JavaInputStream::isValid() { return mValid; }

void JavaInputStream::setInvalid() {
    ALOGI("JavaInputStream::setInvalid(): Enter\n");
    mValid = false;
    ALOGI("JavaInputStream::setInvalid(): Leave\n");
}

void JavaInputStream::lock() { mStreamMutex.lock(); }

void JavaInputStream::unlock() { mStreamMutex.unlock(); }

int JavaInputStream::getDataSourceType() { return mDataSourceType; }

bool JavaInputStream::isSeekable() {
    JNIEnv* env = attach();
    const jboolean seekable = env->GetBooleanField(mObject, gClientFields.streamSeekable);
    detach();
    return seekable;
}

bool JavaInputStream::isStallingSupport() {
    jint attachResult;
    JNIEnv* env = attach(&attachResult);
    ALOGI("%s: AttachCurrentThread i4AttachRet = %d\n", __func__, attachResult);
    const jboolean stalling = env->GetBooleanField(mObject, gClientFields.stallingSupport);
    ALOGI("%s: whether stream is StallingSupport: %d\n", __func__, stalling);
    detach();
    return stalling;
}

int JavaInputStream::getSeekType() {
    JNIEnv* env = attach();
    const jint type = env->CallIntMethod(mObject, gClientFields.getSeekType);
    detach();
    return type;
}

void JavaInputStream::setThreadSelf() { mThreadSelf = true; }

bool JavaInputStream::isThreadSelf() { return mThreadSelf; }
