// SPDX-License-Identifier: Apache-2.0
#include <android_runtime/android_view_Surface.h>
#include <gui/Surface.h>
#include <jni.h>

#include <new>

#include "NativeHandle.h"
#include "WindowProducer.h"

using namespace android;

namespace {

// The reference id of the Java objects' references; any fixed address does.
const int kJavaReference = 0;

NativeWindow* windowOf(jlong handle) { return fromHandle<NativeWindow>(handle); }

}  // namespace

#define VIEW_METHOD(type, name) \
    extern "C" JNIEXPORT type JNICALL Java_android_view_SurfaceView_##name

VIEW_METHOD(jlong, nativeCreate)(JNIEnv*, jclass, jlong id, jboolean acceptsSoftwareGl) {
    auto* const window = new (std::nothrow)
        NativeWindow(static_cast<unsigned long>(id), acceptsSoftwareGl == JNI_TRUE);
    if (window != nullptr) window->incStrong(&kJavaReference);
    return toHandle(window);
}

VIEW_METHOD(void, nativeDestroy)(JNIEnv*, jclass, jlong window) {
    windowOf(window)->decStrong(&kJavaReference);
}

// The producer behind a surface for the window whose buffers are another surface's;
// the caller passes it to a surface, and gives it up with nativeReleaseProducer.
VIEW_METHOD(jlong, nativeCreateProducer)(JNIEnv* env, jclass, jlong window, jobject buffers) {
    const sp<Surface> surface = android_view_Surface_getSurface(env, buffers);
    if (surface == nullptr) return 0;
    IGraphicBufferProducer* const producer =
        new (std::nothrow) WindowProducer(windowOf(window), surface->getIGraphicBufferProducer());
    if (producer != nullptr) producer->incStrong(&kJavaReference);
    return toHandle(producer);
}

VIEW_METHOD(void, nativeReleaseProducer)(JNIEnv*, jclass, jlong producer) {
    fromHandle<IGraphicBufferProducer>(producer)->decStrong(&kJavaReference);
}

VIEW_METHOD(void, nativeRedraw)(JNIEnv*, jclass, jlong window) { windowOf(window)->redraw(); }

VIEW_METHOD(void, nativeHold)(JNIEnv*, jclass, jlong window, jboolean held) {
    windowOf(window)->hold(held == JNI_TRUE);
}

VIEW_METHOD(void, nativeReportFrame)(JNIEnv*, jclass, jlong window, jlong timeUs) {
    windowOf(window)->reportFrame(timeUs);
}

VIEW_METHOD(void, nativeClose)(JNIEnv*, jclass, jlong window) { windowOf(window)->close(); }

VIEW_METHOD(jboolean, nativeIsDrawnByGpu)(JNIEnv*, jclass, jlong window) {
    return static_cast<jboolean>(windowOf(window)->drawing().byGpu);
}

VIEW_METHOD(jstring, nativeDescribeDrawing)(JNIEnv* env, jclass, jlong window) {
    return env->NewStringUTF(windowOf(window)->drawing().description.c_str());
}

// Fills in number and time in microseconds of the frame after that number.
VIEW_METHOD(void, nativeAwaitFrame)
(JNIEnv* env, jclass, jlong window, jlong seen, jint timeoutMs, jlongArray numberAndTime) {
    const NativeWindow::Frame frame =
        windowOf(window)->awaitFrame(static_cast<uint64_t>(seen), timeoutMs);
    const jlong values[] = {static_cast<jlong>(frame.number), frame.timeUs};
    env->SetLongArrayRegion(numberAndTime, 0, 2, values);
}
