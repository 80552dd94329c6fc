// SPDX-License-Identifier: Apache-2.0
#include <android_runtime/android_view_Surface.h>
#include <gui/Surface.h>
#include <jni.h>

#include <new>

#include "JavaSurface.h"
#include "NativeHandle.h"
#include "WindowProducer.h"

using namespace android;

namespace {

NativeWindow* windowOf(jlong handle) { return fromHandle<NativeWindow>(handle); }

}  // namespace

#define WINDOW_METHOD(type, name) \
    extern "C" JNIEXPORT type JNICALL Java_com_quintora_mmp_platform_internal_ViewWindow_##name

WINDOW_METHOD(jlong, nativeCreate)(JNIEnv*, jclass, jlong id, jboolean acceptsSoftwareGl) {
    auto* const window = new (std::nothrow)
        NativeWindow(static_cast<unsigned long>(id), acceptsSoftwareGl == JNI_TRUE);
    if (window != nullptr) window->incStrong(&kJavaReference);
    return toHandle(window);
}

WINDOW_METHOD(void, nativeDestroy)(JNIEnv*, jclass, jlong window) {
    windowOf(window)->decStrong(&kJavaReference);
}

// A surface for the window whose buffers are another surface's.
WINDOW_METHOD(jobject, nativeCreateSurface)(JNIEnv* env, jclass, jlong window, jobject buffers) {
    const sp<Surface> surface = android_view_Surface_getSurface(env, buffers);
    if (surface == nullptr) return nullptr;
    const sp<IGraphicBufferProducer> producer =
        new (std::nothrow) WindowProducer(windowOf(window), surface->getIGraphicBufferProducer());
    return producer == nullptr ? nullptr : newJavaSurface(env, producer.get());
}

WINDOW_METHOD(void, nativeRedraw)(JNIEnv*, jclass, jlong window) { windowOf(window)->redraw(); }

WINDOW_METHOD(void, nativeHold)(JNIEnv*, jclass, jlong window, jboolean held) {
    windowOf(window)->hold(held == JNI_TRUE);
}

WINDOW_METHOD(void, nativeReportFrame)(JNIEnv*, jclass, jlong window, jlong timeUs) {
    windowOf(window)->reportFrame(timeUs);
}

WINDOW_METHOD(void, nativeClose)(JNIEnv*, jclass, jlong window) { windowOf(window)->close(); }

WINDOW_METHOD(jboolean, nativeIsDrawnByGpu)(JNIEnv*, jclass, jlong window) {
    return static_cast<jboolean>(windowOf(window)->drawing().byGpu);
}

WINDOW_METHOD(jstring, nativeDescribeDrawing)(JNIEnv* env, jclass, jlong window) {
    return env->NewStringUTF(windowOf(window)->drawing().description.c_str());
}

// Fills in number and time in microseconds of the frame after that number.
WINDOW_METHOD(void, nativeAwaitFrame)
(JNIEnv* env, jclass, jlong window, jlong seen, jint timeoutMs, jlongArray numberAndTime) {
    const NativeWindow::Frame frame =
        windowOf(window)->awaitFrame(static_cast<uint64_t>(seen), timeoutMs);
    const jlong values[] = {static_cast<jlong>(frame.number), frame.timeUs};
    env->SetLongArrayRegion(numberAndTime, 0, 2, values);
}
