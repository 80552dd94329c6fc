// SPDX-License-Identifier: Apache-2.0
#include <android_runtime/android_view_Surface.h>
#include <gui/Surface.h>

#include <new>

#include "JavaSurface.h"
#include "NativeHandle.h"

namespace android {

sp<Surface> android_view_Surface_getSurface(JNIEnv* env, jobject surfaceObj) {
    if (surfaceObj == nullptr) return nullptr;
    jclass const clazz = env->GetObjectClass(surfaceObj);
    jfieldID const field = env->GetFieldID(clazz, "mNativeObject", "J");
    env->DeleteLocalRef(clazz);
    if (field == nullptr) return nullptr;

    // Under the object's monitor, as its release(): the reference must be taken
    // before another thread can drop the Java object's.
    if (env->MonitorEnter(surfaceObj) != JNI_OK) return nullptr;
    const sp<Surface> surface = fromHandle<Surface>(env->GetLongField(surfaceObj, field));
    env->MonitorExit(surfaceObj);
    return surface;
}

// Through the surface's own constructor, which takes a producer.
jobject newJavaSurface(JNIEnv* env, IGraphicBufferProducer* producer) {
    jclass const clazz = env->FindClass("android/view/Surface");
    if (clazz == nullptr) return nullptr;
    jmethodID const constructor = env->GetMethodID(clazz, "<init>", "(J)V");
    if (constructor == nullptr) return nullptr;
    return env->NewObject(clazz, constructor, toHandle(producer));
}

}  // namespace android

using android::fromHandle;
using android::Surface;

// Takes over nothing: the producer, null for none, keeps its own references.
extern "C" JNIEXPORT jlong JNICALL Java_android_view_Surface_nativeCreate(JNIEnv*, jclass,
                                                                          jlong producer) {
    Surface* const surface =
        new (std::nothrow) Surface(fromHandle<android::IGraphicBufferProducer>(producer));
    if (surface != nullptr) surface->incStrong(&android::kJavaReference);
    return android::toHandle(surface);
}

extern "C" JNIEXPORT void JNICALL Java_android_view_Surface_nativeRelease(JNIEnv*, jclass,
                                                                          jlong handle) {
    fromHandle<Surface>(handle)->decStrong(&android::kJavaReference);
}
