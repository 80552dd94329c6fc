// SPDX-License-Identifier: Apache-2.0
// The life of a Java player's native half: setup, release, reset, finalize.

#include "jni/PlayerContext.h"

#include <nativehelper/JNIHelp.h>
#include <utils/Mutex.h>

#include <new>

#include "dispatch/MsgDispatcher.h"
#include "dispatch/SyncToAsync.h"
#include "jni/BridgeLog.h"
#include "jni/ClientFields.h"
#include "jni/NativePointer.h"
#include "jni/OrvMediaClient.h"
#include "jni/StatusExceptions.h"
#include "jni/VideoSurface.h"
#include "jni/media-service/MediaClientListener.h"
#include "os/StaticOrder.h"

namespace android {

namespace {

// Guards mNativeContext of every Java player and the reference it stands for;
// held for nothing else.
Mutex sServiceLock ORV_INIT_ORDER(ORV_INIT_SERVICE_LOCK);

OrvMediaService* contextOf(JNIEnv* env, jobject thiz) {
    return fromJavaLong<OrvMediaService>(env->GetLongField(thiz, gClientFields.context));
}

}  // namespace

sp<OrvMediaService> getMediaService(JNIEnv* env, jobject thiz) {
    Mutex::Autolock lock(sServiceLock);
    return contextOf(env, thiz);
}

sp<OrvMediaService> setMediaService(JNIEnv* env, jobject thiz, const sp<OrvMediaService>& service) {
    ALOGI("setMediaService(): Enter\n");
    sp<OrvMediaService> old;
    {
        Mutex::Autolock lock(sServiceLock);
        old = contextOf(env, thiz);
        if (service != nullptr) service->incStrong(thiz);
        if (old != nullptr) old->decStrong(thiz);
        env->SetLongField(thiz, gClientFields.context, toJavaLong(service.get()));
    }
    ALOGI("setMediaService(): Leave\n");
    return old;
}

void createPlayer(JNIEnv* env, sp<OrvMediaService> service, E_OrvPlayer_Type) {
    ALOGI("createPlayer(): Enter\n");
    if (service == nullptr) {
        ALOGE("createPlayer(): OrvMediaService==NULL\n");
        return;
    }
    if (env == nullptr) {
        ALOGE("createPlayer(): env==NULL\n");
        return;
    }
    sp<TarnPlayer> player = new (std::nothrow) TarnPlayer(-1);  // whatever the type
    if (player == nullptr) {
        ALOGE("createPlayer(): out of memory, new TarnPlayer failed, throw exception\n");
        jniThrowException(env, "java/lang/RuntimeException", "Out of memory");
        return;
    }
    service->attachPlayer(player);
    ALOGI("createPlayer(): Leave\n");
}

void OrvMediaClient_setup(JNIEnv* env, jobject thiz, jobject weak_this) {
    logEnter(__func__);
    sp<OrvMediaService> service = new (std::nothrow) OrvMediaService();
    if (service == nullptr) {
        ALOGE(
            "OrvMediaClient_setup(): out of memory, new OrvMediaService failed, throw "
            "exception\n");
        jniThrowException(env, "java/lang/RuntimeException", "Out of memory");
        return;
    }
    sp<ORV::MsgDispatcher> dispatcher = new ORV::MsgDispatcher(env, thiz, weak_this);
    ORV::SyncToAsync::getInstance()->addMsgHandler(service, dispatcher);
    service->setListener(new MediaClientListener());
    createPlayer(env, service, E_ORV_PLAYER_TYPE_TARN);
    setMediaService(env, thiz, service);
    logLeave(__func__);
}

void OrvMediaClient_release(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    decVideoSurfaceRef(env, thiz);
    // From here on no other call finds the service.
    sp<OrvMediaService> old = setMediaService(env, thiz, nullptr);
    if (old != nullptr) {
        if (old->release() != NO_ERROR) {
            ALOGE("OrvMediaClient_release(): throw exception. Line:%d\n", __LINE__);
            jniThrowException(env, "java/lang/IllegalStateException", nullptr);
        }
        ORV::SyncToAsync::getInstance()->abortAllActions(old, false);
        ORV::SyncToAsync::getInstance()->delMsgHandler(old);
        old->setListener(nullptr);
        old->disconnect();
    }
    logLeave(__func__);
}

void OrvMediaClient_reset(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    if (service->reset() != NO_ERROR) {
        // An IOException whatever the status.
        ALOGI("OrvMediaClient_reset(): jniThrowException\n");
        jniThrowException(env, "java/io/IOException", nullptr);
    }
    logLeave(__func__);
}

void OrvMediaClient_finalize(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    if (getMediaService(env, thiz) != nullptr) {
        ALOGW("OrvMediaClient_finalize(): MediaPlayer finalized without being released");
    }
    OrvMediaClient_release(env, thiz);
    logLeave(__func__);
}

}  // namespace android
