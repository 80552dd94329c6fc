// SPDX-License-Identifier: Apache-2.0
// DivX titles, chapters, playlists and positions.

#include "jni/DivxNavigation.h"

#include "jni/BridgeLog.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

// The service of a navigation method; without one a line, and nothing is thrown.
sp<OrvMediaService> serviceOrLog(JNIEnv* env, jobject thiz, int line = __builtin_LINE()) {
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) ALOGE("service not exist. Line:%d\n", line);
    return service;
}

// A setter's result: success gives 1.
jint setterResult(const char* function, bool done) {
    if (!done) ALOGI("%s(): service get failed\n", function);
    logLeave(function);
    return done ? 1 : -1;
}

}  // namespace

jboolean OrvMediaClient_getDivxTitleInfo(JNIEnv* env, jobject thiz, jint title) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    DivxTitleInfo info;
    if (!service->getDivxTitleInfo(title, info)) {
        ALOGE("OrvMediaClient_getDivxTitleInfo(): service get failed\n");
        return JNI_FALSE;
    }
    if (!deliverDivxTitleInfo(env, thiz, info)) return JNI_FALSE;
    logLeave(__func__);
    return JNI_TRUE;
}

jboolean OrvMediaClient_getDivxChapInfo(JNIEnv* env, jobject thiz, jint title, jint playlist,
                                        jint chapter) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    DivxChapInfo info;
    if (!service->getDivxChapInfo(title, playlist, chapter, info)) {
        ALOGE("OrvMediaClient_getDivxChapInfo(): service get failed\n");
        return JNI_FALSE;
    }
    if (!deliverDivxChapInfo(env, thiz, info)) return JNI_FALSE;
    logLeave(__func__);
    return JNI_TRUE;
}

jboolean OrvMediaClient_getDivxPlayListInfo(JNIEnv* env, jobject thiz, jint title, jint playlist) {
    ALOGI("OrvMediaClient_getDivxChapInfo(): Enter\n");  // the chapter getter's line
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    DivxPlayListInfo info;
    if (!service->getDivxPlayListInfo(title, playlist, info)) {
        ALOGE("OrvMediaClient_getDivxPlayListInfo(): service get failed\n");
        return JNI_FALSE;
    }
    if (!deliverDivxPlayListInfo(env, thiz, info)) return JNI_FALSE;
    logLeave(__func__);
    return JNI_TRUE;
}

jboolean OrvMediaClient_getDivxPositionInfo(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    DivxPositionInfo info;
    if (!service->getDivxPositionInfo(info)) {
        ALOGE("OrvMediaClient_getDivxPositionInfo(): service get failed\n");
        return JNI_FALSE;
    }
    if (!deliverDivxPositionInfo(env, thiz, info)) return JNI_FALSE;
    logLeave(__func__);
    return JNI_TRUE;
}

jboolean OrvMediaClient_getDivxDisplayInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c,
                                           jint d, jint e) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    DivxDisplayInfo info;
    clearText(info.mText1);
    clearText(info.mText2);
    if (!service->getDivxDisplayInfo(a, b, c, d, e, info)) {
        ALOGE("OrvMediaClient_getDivxDisplayInfo(): service get failed\n");
        return JNI_FALSE;
    }
    if (!deliverDivxDisplayInfo(env, thiz, info)) return JNI_FALSE;
    logLeave(__func__);
    return JNI_TRUE;
}

jboolean OrvMediaClient_getDivxLastMemoryFilePosition(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    DivxLastMemoryFilePosition info;
    if (!service->getDivxLastMemoryFilePosition(info)) {
        ALOGE("OrvMediaClient_getDivxLastMemoryFilePosition(): service get failed\n");
        return JNI_FALSE;
    }
    if (!deliverDivxLastMemoryFilePosition(env, thiz, info)) return JNI_FALSE;
    logLeave(__func__);
    return JNI_TRUE;
}

jint OrvMediaClient_getDivxTitleNum(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return 0;
    int number = 0;
    service->getDivxTitleNum(number);
    logLeave(__func__);
    return number;
}

jint OrvMediaClient_getDivxLastMemoryFileID(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return 0;
    int number = 0;
    service->getDivxLastMemoryFileID(number);
    logLeave(__func__);
    return number;
}

jint OrvMediaClient_setDivxTitleInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return -1;
    return setterResult(__func__, service->setDivxTitleInfo(a, b, c));
}

jint OrvMediaClient_setDivxChapInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c, jint d) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return -1;
    return setterResult(__func__, service->setDivxChapInfo(a, b, c, d));
}

jint OrvMediaClient_setDivxPlayListInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c, jint d) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return -1;
    return setterResult(__func__, service->setDivxPlayListInfo(a, b, c, d));
}

jint OrvMediaClient_setDivxBtnInfo(JNIEnv* env, jobject thiz, jint a, jint b) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return -1;
    return setterResult(__func__, service->setDivxBtnInfo(a, b));
}

jint OrvMediaClient_setDivxFilePosition(JNIEnv* env, jobject thiz, jint a, jint b) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrLog(env, thiz);
    if (service == nullptr) return -1;
    return setterResult(__func__, service->setDivxFilePosition(a, b));
}

}  // namespace android
