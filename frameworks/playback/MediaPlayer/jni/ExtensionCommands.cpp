// SPDX-License-Identifier: Apache-2.0
// The television player's extras. The capability and positioning commands throw
// for a player without a service; the others only log and return a value.

#include <nativehelper/JNIHelp.h>

#include "jni/BridgeLog.h"
#include "jni/JavaString.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"
#include "jni/StatusExceptions.h"

namespace android {

namespace {

// Most throwing commands here log another text than serviceOrThrow does. All
// line numbers of this file are fixed: the log's readers know them.
sp<OrvMediaService> serviceOrThrowAt(JNIEnv* env, jobject thiz, int line) {
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("service not exist,throw exception. Line:%d\n", line);
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    }
    return service;
}

// The service for a command that throws nothing; without one, a line.
sp<OrvMediaService> serviceOrLog(JNIEnv* env, jobject thiz, const char* function) {
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) ALOGE("%s(): service not exist, error\n", function);
    return service;
}

void logGetFailed(const char* function) { ALOGE("%s(): service get failed\n", function); }

}  // namespace

jint OrvMediaClient_setPlayMode(JNIEnv* env, jobject thiz, jint speed) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3521);
    if (service == nullptr) return -1;
    const status_t status = service->setSpeed(speed);
    ALOGI("OrvMediaClient_setPlayModeEx(): Leave\n");  // with the Ex
    return status;
}

jint OrvMediaClient_getPlayMode(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) return 0;
    int speed = 0;
    if (!service->getSpeed(speed)) logGetFailed(__func__);
    ALOGI("OrvMediaClient_getPlayMode(): i4Speed=%d\n", speed);
    logLeave(__func__);
    return speed;
}

// Asked many times a second: no enter or leave lines.
jint OrvMediaClient_getBufferingTime(JNIEnv* env, jobject thiz) {
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) return 0;
    return service->getBufferPercent();
}

void OrvMediaClient_onSubtitleTrack(JNIEnv* env, jobject thiz, jint index) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) return;
    if (!service->onSubtitleTrack(index)) logGetFailed(__func__);
    logLeave(__func__);
}

void OrvMediaClient_offSubtitleTrack(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) return;
    if (!service->offSubtitleTrack()) logGetFailed(__func__);
    logLeave(__func__);
}

void OrvMediaClient_deselectTrack(JNIEnv* env, jobject thiz, jint index) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) return;
    if (!service->deselectTrack(index)) logGetFailed(__func__);
    logLeave(__func__);
}

void OrvMediaClient_selectTrack(JNIEnv* env, jobject thiz, jint index) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) return;
    if (!service->selectTrack(index)) logGetFailed("OrvMediaClient_offSubtitleTrack");  // its text
    logLeave(__func__);
}

void OrvMediaClient_step(JNIEnv* env, jobject thiz, jint amount) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz, __func__);
    if (service == nullptr) {
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
        return;
    }
    if (!service->step(amount)) {
        logGetFailed(__func__);
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    }
    logLeave(__func__);
}

void OrvMediaClient_seekToPosition(JNIEnv* env, jobject thiz, jlong position) {
    logOccur(__func__);
    ALOGI("OrvMediaClient_seekToPosition(): seek position(byte) = %lld",
          static_cast<long long>(position));
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3500);
    if (service == nullptr) return;
    // Only the low 32 bits travel, widened again by sign.
    if (!service->seekToPosition(static_cast<int32_t>(position))) {
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
        logGetFailed(__func__);
    }
}

jboolean OrvMediaClient_canDoSeek(JNIEnv* env, jobject thiz, jint speed) {
    ALOGI("OrvMediaClient_canDoSeek: occur\n");
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3540);
    if (service == nullptr) return JNI_FALSE;
    return service->canDoSeek(speed);
}

jboolean OrvMediaClient_canDoTrick(JNIEnv* env, jobject thiz, jint speed) {
    ALOGI("OrvMediaClient_canDoTrick: occur\n");
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3555);
    if (service == nullptr) return JNI_FALSE;
    return service->canDoTrick(speed);
}

jboolean OrvMediaClient_setTS(JNIEnv* env, jobject thiz, jint ts) {
    ALOGI("OrvMediaClient_setTS: occur\n");
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3570);
    if (service == nullptr) return 255;  // neither true nor false
    if (!service->setTS(static_cast<uint16_t>(ts))) {
        logGetFailed(__func__);
        return JNI_FALSE;
    }
    ALOGI("OrvMediaClient_setTS()end");
    return JNI_TRUE;
}

// Asked many times a second: no enter or leave lines.
jint OrvMediaClient_getCurrentBytePosition(JNIEnv* env, jobject thiz) {
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3591);
    if (service == nullptr) return 0;
    int position = 0;
    process_media_player_call(env, thiz, service->getCurrentBytePosition(&position),
                              "java/io/IOException", "getCurrentBytePosition failed.");
    return position;
}

void OrvMediaClient_setPlayerRole(JNIEnv* env, jobject thiz, jint role) {
    logOccur(__func__);
    ALOGI("OrvMediaClient_setPlayerRole(): player's role is = %d", role);
    sp<OrvMediaService> service = serviceOrThrowAt(env, thiz, 3617);
    if (service == nullptr) return;
    service->setPlayerRole(static_cast<E_Orv_Player_Role_Type>(role));
}

jint OrvMediaClient_setABRepeat(JNIEnv* env, jobject thiz, jint type) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGI("OrvMediaClient_setABRepeat(): service not exist, error\n");  // at info priority
        return -1;
    }
    const bool repeating = service->setABRepeat(type) != 0;
    if (!repeating) ALOGI("OrvMediaClient_setABRepeat(): service get failed\n");
    logLeave(__func__);
    return repeating ? 1 : 0;
}

jint OrvMediaClient_QTVDEC_SendCliCommand(JNIEnv* env, jobject thiz, jstring command,
                                          jint argument) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("service not exist. Line:%d\n", 3718);
        return -1;
    }
    const char* chars = stringChars(env, command);  // never released
    if (chars == nullptr) {
        ALOGI("OrvMediaClient_QTVDEC_SendCliCommand(): url=null, return directly, error!!!!\n");
        return 0;
    }
    unsigned char* text = reinterpret_cast<unsigned char*>(const_cast<char*>(chars));
    const bool accepted = service->ServiceSendCliCommand(text, argument);
    if (!accepted) ALOGI("OrvMediaClient_QTVDEC_SendCliCommand(): service get failed\n");
    logLeave(__func__);
    return accepted ? 0 : -1;
}

jint OrvMediaClient_getCurrentAudioIndex(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz, 1408);
    if (service == nullptr) return 0;
    int index = 0;
    const bool known = service->getCurrentAudioIndex(&index) != 0;  // 0 is the failure here
    if (!known) ALOGE("OrvMediaClient_getCurrentAudioIndex(): getCurrentAudioIndex failed");
    logLeave(__func__);
    return known ? index : 0;
}

jint OrvMediaClient_getCurrentSubtitleIndex(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz, 1435);
    if (service == nullptr) return 0;
    int index = 0;
    const bool known = service->getCurrentSubtitleIndex(&index) != 0;  // 0 is the failure here
    if (!known) ALOGE("OrvMediaClient_getCurrentSubtitleIndex(): getCurrentAudioIndex failed");
    logLeave(__func__);
    return known ? index : 0;
}

jint OrvMediaClient_setUnLockPin(JNIEnv* env, jobject thiz, jint pin) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_setUnLockPin(): service not exist, error. Line:%d\n", 3634);
        return -1;
    }
    const bool unlocked = service->setUnLockPin(pin) == NO_ERROR;
    if (!unlocked) ALOGE("OrvMediaClient_setUnLockPin(): service get failed. Line:%d \n", 3640);
    logLeave(__func__);
    return unlocked ? 0 : -1;
}

}  // namespace android
