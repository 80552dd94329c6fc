// SPDX-License-Identifier: Apache-2.0
// External subtitle files and timed text.

#include "jni/BridgeLog.h"
#include "jni/JavaString.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

// As the platform's log prints a null text.
const char* printable(const char* chars) { return chars != nullptr ? chars : "(null)"; }

void releaseChars(JNIEnv* env, jstring string, const char* chars) {
    if (chars != nullptr) env->ReleaseStringUTFChars(string, chars);
}

}  // namespace

// Despite their words, neither a missing service nor a missing path ends the
// next two: the service and the engine refuse what they cannot use.

void OrvMediaClient_setSubtitleDataSource(JNIEnv* env, jobject thiz, jstring url) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_setSubtitleDataSource(): service not exist, error\n");
    }
    const char* urlChars = stringChars(env, url);
    if (urlChars == nullptr) {
        ALOGE("OrvMediaClient_setSubtitleDataSource(): url=null, return directly, error!!!!\n");
    }
    ALOGI("OrvMediaClient_setSubtitleDataSource(): url=%s\n", printable(urlChars));
    if (service != nullptr) service->setSubtitleDataSource(urlChars);
    releaseChars(env, url, urlChars);
    logLeave(__func__);
}

void OrvMediaClient_setSubtitleDataSourceEx(JNIEnv* env, jobject thiz, jstring sub, jstring idx) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_setSubtitleDataSourceEx(): service not exist, error\n");
    }
    const char* subChars = stringChars(env, sub);
    if (subChars == nullptr) {
        ALOGE(
            "OrvMediaClient_setSubtitleDataSourceEx(): pszUrlSub=null, return directly, "
            "error!!!!\n");
    }
    ALOGI("OrvMediaClient_setSubtitleDataSourceEx(): pszUrlSub=%s\n", printable(subChars));
    const char* idxChars = stringChars(env, idx);
    if (idxChars == nullptr) {
        ALOGE(
            "OrvMediaClient_setSubtitleDataSourceEx(): pszUrlIdx=null, return directly, "
            "error!!!!\n");
    }
    ALOGI("OrvMediaClient_setSubtitleDataSourceEx(): pszUrlIdx=%s\n", printable(idxChars));
    if (service != nullptr) service->setSubtitleDataSourceEx(subChars, idxChars);
    releaseChars(env, sub, subChars);
    releaseChars(env, idx, idxChars);
    logLeave(__func__);
}

jint OrvMediaClient_addTimedTextSource(JNIEnv* env, jobject thiz, jstring url) {
    logEnter(__func__);
    ALOGI("OrvMediaClient_addTimedTextSource(): Test %s %d\n",
          "proprietary_tv/open/frameworks/playback/MediaPlayer/jni/OrvMediaClient", __LINE__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGI("OrvMediaClient_addTimedTextSource(): service not exist, error\n");
        return -1;
    }
    const char* urlChars = stringChars(env, url);  // never released
    if (urlChars == nullptr) {
        ALOGI("OrvMediaClient_addTimedTextSource(): url=null, return directly, error!!!!\n");
        return -1;
    }
    if (!service->addTimedTextSource(urlChars)) {
        ALOGI("OrvMediaClient_addTimedTextSource(): service get failed\n");
    }
    logLeave(__func__);
    return 0;
}

}  // namespace android
