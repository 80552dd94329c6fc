// SPDX-License-Identifier: Apache-2.0
#include <jni.h>

#include <new>

#include "BufferQueue.h"
#include "JavaSurface.h"
#include "NativeHandle.h"

using namespace android;

namespace {

// The layout of the long[] that nativeAcquire fills, as FrameReader reads it.
enum FrameField { SLOT, WIDTH, HEIGHT, STRIDE, TIMESTAMP_US, MEMORY, FIELD_COUNT };

BufferQueue* queueOf(jlong handle) { return fromHandle<BufferQueue>(handle); }

}  // namespace

#define READER_METHOD(type, name) \
    extern "C" JNIEXPORT type JNICALL Java_com_quintora_mmp_desktop_FrameReader_##name

READER_METHOD(jlong, nativeCreate)(JNIEnv*, jclass) {
    BufferQueue* const queue = new (std::nothrow) BufferQueue;
    if (queue != nullptr) queue->incStrong(&kJavaReference);
    return toHandle(queue);
}

READER_METHOD(void, nativeDestroy)(JNIEnv*, jclass, jlong queue) {
    queueOf(queue)->decStrong(&kJavaReference);
}

READER_METHOD(jobject, nativeCreateSurface)(JNIEnv* env, jobject, jlong queue) {
    return newJavaSurface(env, queueOf(queue));
}

READER_METHOD(jint, nativeSetFrameSize)(JNIEnv*, jobject, jlong queue, jint width, jint height) {
    return queueOf(queue)->setDefaultSize(width, height);
}

READER_METHOD(jint, nativeAcquire)(JNIEnv* env, jobject, jlong queue, jlongArray fields) {
    BufferQueue::Frame frame = {};
    const status_t status = queueOf(queue)->acquireFrame(&frame);
    if (status != NO_ERROR) return status;
    jlong values[FIELD_COUNT];
    values[SLOT] = frame.buffer.slot;
    values[WIDTH] = frame.buffer.width;
    values[HEIGHT] = frame.buffer.height;
    values[STRIDE] = static_cast<jlong>(frame.buffer.stride);
    values[TIMESTAMP_US] = frame.timestampUs;
    values[MEMORY] = toHandle(frame.memory.get());
    env->SetLongArrayRegion(fields, 0, FIELD_COUNT, values);
    // From here on the Java side's own reference.
    frame.memory->incStrong(&kJavaReference);
    return NO_ERROR;
}

READER_METHOD(jint, nativeRelease)(JNIEnv*, jobject, jlong queue, jint slot) {
    return queueOf(queue)->releaseFrame(slot);
}

READER_METHOD(jlong, nativeAwaitFrame)
(JNIEnv*, jobject, jlong queue, jlong seen, jint timeoutMs) {
    return static_cast<jlong>(queueOf(queue)->awaitFrame(static_cast<uint64_t>(seen), timeoutMs));
}

READER_METHOD(void, nativeAbandon)(JNIEnv*, jobject, jlong queue) { queueOf(queue)->abandon(); }

READER_METHOD(jlong, nativeGetQueuedCount)(JNIEnv*, jobject, jlong queue) {
    return static_cast<jlong>(queueOf(queue)->getStatistics().queued);
}

READER_METHOD(jlong, nativeGetDroppedCount)(JNIEnv*, jobject, jlong queue) {
    return static_cast<jlong>(queueOf(queue)->getStatistics().dropped);
}

READER_METHOD(jobject, nativeWrapMemory)(JNIEnv* env, jclass, jlong memory, jlong bytes) {
    return env->NewDirectByteBuffer(fromHandle<PixelMemory>(memory)->data(), bytes);
}

READER_METHOD(void, nativeReleaseMemory)(JNIEnv*, jclass, jlong memory) {
    fromHandle<PixelMemory>(memory)->decStrong(&kJavaReference);
}
