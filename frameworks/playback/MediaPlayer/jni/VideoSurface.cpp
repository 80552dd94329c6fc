// SPDX-License-Identifier: Apache-2.0
#include "jni/VideoSurface.h"

// android_view_Surface.h uses sp without including its header.
#include <android_runtime/android_view_Surface.h>
#include <gui/Surface.h>
#include <nativehelper/JNIHelp.h>
#include <utils/RefBase.h>

#include "jni/BridgeLog.h"
#include "jni/ClientFields.h"
#include "jni/NativePointer.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"
#include "jni/StatusExceptions.h"

namespace android {

namespace {

// The producer behind a Java surface; null, with the exception thrown, when it
// has none.
sp<IGraphicBufferProducer> producerOf(JNIEnv* env, jobject jsurface) {
    sp<Surface> surface = android_view_Surface_getSurface(env, jsurface);
    if (surface == nullptr) {
        ALOGE("setVideoSurface(): surface==null, throw exception\n");
        jniThrowException(env, "java/lang/IllegalArgumentException",
                          "The surface has been released");
        return nullptr;
    }
    sp<IGraphicBufferProducer> producer = surface->getIGraphicBufferProducer();
    if (producer == nullptr) {
        ALOGE("setVideoSurface(): new_st==null, throw exception\n");
        jniThrowException(env, "java/lang/IllegalArgumentException",
                          "The surface does not have a binding SurfaceTexture!");
    }
    return producer;
}

}  // namespace

sp<IGraphicBufferProducer> getVideoSurfaceTexture(JNIEnv* env, jobject thiz) {
    return fromJavaLong<IGraphicBufferProducer>(
        env->GetLongField(thiz, gClientFields.surfaceTexture));
}

void decVideoSurfaceRef(JNIEnv* env, jobject thiz) {
    ALOGI("decVideoSurfaceRef(): Enter\n");
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) return;
    sp<IGraphicBufferProducer> old = getVideoSurfaceTexture(env, thiz);
    if (old != nullptr) old->decStrong(thiz);
    ALOGI("decVideoSurfaceRef(): Leave\n");
}

void setVideoSurface(JNIEnv* env, jobject thiz, jobject jsurface, bool mediaPlayerMustBeAlive) {
    ALOGI("setVideoSurface(): Enter\n");
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        logMissingService();
        if (mediaPlayerMustBeAlive) {
            logMissingService();
            jniThrowException(env, "java/lang/IllegalStateException", nullptr);
        }
        return;
    }
    // The old producer loses its reference before the new surface is checked;
    // when the check fails, the field keeps the old address.
    decVideoSurfaceRef(env, thiz);

    sp<IGraphicBufferProducer> producer;
    if (jsurface != nullptr) {
        producer = producerOf(env, jsurface);
        if (producer == nullptr) return;
        producer->incStrong(thiz);
    }
    env->SetLongField(thiz, gClientFields.surfaceTexture, toJavaLong(producer.get()));
    service->setVideoSurfaceTexture(producer);
    ALOGI("setVideoSurface(): Leave\n");
}

void OrvMediaClient_setVideoSurface(JNIEnv* env, jobject thiz, jobject jsurface) {
    logEnter(__func__);
    setVideoSurface(env, thiz, jsurface, true);
    logLeave(__func__);
}

}  // namespace android
