// SPDX-License-Identifier: Apache-2.0
// Tables of video, subtitle and audio tracks, handed to the Java player one
// callback a track.

#include <orvtarn/TrackRecords.h>

#include "jni/BridgeLog.h"
#include "jni/JavaCallback.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"
#include "jni/StatusExceptions.h"

namespace android {

namespace {

void clearTexts(AudioTrackInfo& info) {
    clearText(info.mTitle);
    clearText(info.mCodecName);
    clearText(info.mChannelLayout);
    clearText(info.mProfile);
    clearText(info.mComment);
    clearText(info.mEncoder);
    clearText(info.mHandler);
    clearText(info.mLanguage);
}

void callSetAllAudioTrackInfo(JNIEnv* env, jobject thiz, jmethodID method, int count, int index,
                              AudioTrackInfo& info) {
    jstring title = newString(env, info.mTitle);
    jstring codecName = newString(env, info.mCodecName);
    jstring channelLayout = newString(env, info.mChannelLayout);
    jstring profile = newString(env, info.mProfile);
    jstring comment = newString(env, info.mComment);
    jstring encoder = newString(env, info.mEncoder);
    jstring handler = newString(env, info.mHandler);
    jstring language = env->NewStringUTF(info.mLanguage);
    ALOGE("OrvMediaClient_getAllAudioTrackInfo(): mLanguage %s\n", info.mLanguage);
    env->CallVoidMethod(thiz, method, count, index, info.mCodec, info.mChannels, info.mSampleRate,
                        info.mBitRate, info.mBitsPerSample, info.mTrackId, title, codecName,
                        channelLayout, profile, info.mFlags, comment, encoder, handler, language);
}

}  // namespace

jboolean OrvMediaClient_getVideoCodecInfo(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        logMissingService();  // and nothing is thrown
        return JNI_FALSE;
    }
    VideoCodecInfo info;
    if (!service->getVideoCodecInfo(info)) {
        logMissingService();  // the same text for the engine's failure
        return JNI_FALSE;
    }
    jmethodID method = findCallback(
        env, "setVideoCodecInfo", "(IIIIII)V",
        "OrvMediaClient_getVideoCodecInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getVideoCodecInfo(): get method id, setVideoCodecInfo, failed\n");
    if (method == nullptr) return JNI_FALSE;
    env->CallVoidMethod(thiz, method, info.mCodec, info.mWidth, info.mHeight, info.mFrameRate,
                        info.mBitRate, info.mFlags);
    logLeave(__func__);
    return JNI_TRUE;
}

jboolean OrvMediaClient_getSubtitleTrackInfo(JNIEnv* env, jobject thiz, jint index) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_getSubtitleTrackInfo(): service not exist, error\n");
        return JNI_FALSE;
    }
    SubtitleTrackInfo info;
    if (!service->getSubtitleTrackInfo(index, info)) {
        ALOGE("OrvMediaClient_getSubtitleTrackInfo(): service get failed\n");
        return JNI_FALSE;
    }
    jmethodID method = findCallback(
        env, "setSubtitleTrackInfo", "(IILjava/lang/String;I)V",
        "OrvMediaClient_getSubtitleTrackInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getSubtitleTrackInfo(): get method id, setSubtitleTrackInfo, failed\n");
    if (method == nullptr) return JNI_FALSE;
    env->CallVoidMethod(thiz, method, info.mTrackId, info.mCodec, env->NewStringUTF(info.mText),
                        info.mFlags);
    logLeave(__func__);
    return JNI_TRUE;
}

// The three tables differ in their results for the same failure, and in how
// they go on after an entry that the engine cannot give.

jint OrvMediaClient_getAllSubtitleTrackInfo(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_getAllSubtitleTrackInfo(): service not exist, error\n");
        return -1;
    }
    int count = 0;
    if (!service->getSubtitleTrackCount(count)) {
        ALOGE(
            "OrvMediaClient_getAllSubtitleTrackInfo(): getSubtitleTrackCount(), service get "
            "failed\n");
        return -1;
    }
    ALOGI("OrvMediaClient_getAllSubtitleTrackInfo(): subtitle count = %d\n", count);
    if (count == 0) {
        ALOGI(
            "OrvMediaClient_getAllSubtitleTrackInfo(): subtitle count = 0, no need to fetch "
            "subtitle info\n");
        return 0;
    }
    jmethodID method = findCallback(
        env, "setAllSubtitleTrackInfo", "(IIIILjava/lang/String;I)V",
        "OrvMediaClient_getAllSubtitleTrackInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getAllSubtitleTrackInfo(): get method id, getAllSubtitleTrackInfo, "
        "failed\n");
    if (method == nullptr) return -1;
    for (int index = 0; index < count; ++index) {
        SubtitleTrackInfo info;
        if (!service->getSubtitleTrackInfo(index, info)) {
            // Java still gets the entry, empty whatever the engine wrote before it failed.
            info = SubtitleTrackInfo();
            ALOGE(
                "OrvMediaClient_getAllSubtitleTrackInfo(): getSubtitleTrackInfo(%d), service get "
                "failed\n",
                index);
        }
        env->CallVoidMethod(thiz, method, count, index, info.mTrackId, info.mCodec,
                            env->NewStringUTF(info.mText), info.mFlags);
    }
    logLeave(__func__);
    return count;
}

jint OrvMediaClient_getAllVideoTrackInfo(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        logMissingService();  // and nothing is thrown
        return 0;
    }
    int count = 0;
    if (!service->getVideoTrackCount(count)) {
        ALOGE("OrvMediaClient_getAllVideoTrackInfo(): getVideoTrackCount(), service get failed\n");
        return -1;
    }
    ALOGI("OrvMediaClient_getAllVideoTrackInfo():  count = %d\n", count);
    if (count == 0) {
        ALOGI(
            "OrvMediaClient_getAllVideoTrackInfo():  count = 0, no need to fetch subtitle "
            "info\n");
        return 0;
    }
    jmethodID method = findCallback(
        env, "setAllVideoCodecInfo", "(IIIIIIII)V",
        "OrvMediaClient_getVideoCodecInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getAllVideoTrackInfo(): get method id, setVideoCodecInfo, failed\n");
    if (method == nullptr) return -1;
    for (int index = 0; index < count; ++index) {
        VideoCodecInfo info;
        if (!service->getVideoCodecInfo(index, info)) {
            ALOGE("OrvMediaClient_getAllVideoTrackInfo(): service get failed\n");
            return -1;
        }
        env->CallVoidMethod(thiz, method, count, index, info.mCodec, info.mWidth, info.mHeight,
                            info.mFrameRate, info.mBitRate, info.mFlags);
    }
    logLeave(__func__);
    return 0;
}

jint OrvMediaClient_getAllAudioTrackInfo(JNIEnv* env, jobject thiz, jboolean flag) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        logMissingService();  // and nothing is thrown
        return 0;
    }
    int count = 0;
    if (!service->getAudioTrackCount(count)) {
        ALOGE("OrvMediaClient_getAllAudioTrackInfo(): getAudioTrackCount(), service get failed\n");
        return -1;
    }
    ALOGI("OrvMediaClient_getAllAudioTrackInfo(): count = %d\n", count);
    if (count == 0) {
        ALOGI("OrvMediaClient_getAllAudioTrackInfo(): count = 0, no need to fetch subtitle info\n");
        return 0;
    }
    jmethodID method = findCallback(
        env, "setAllAudioTrackInfo",
        "(IIIIIIIILjava/lang/String;Ljava/lang/String;Ljava/lang/String;Ljava/lang/String;I"
        "Ljava/lang/String;Ljava/lang/String;Ljava/lang/String;Ljava/lang/String;)V",
        "OrvMediaClient_getAllAudioTrackInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getAllAudioTrackInfo(): get method id, setAudioTrackInfo, failed\n");
    if (method == nullptr) return 0;
    for (int index = 0; index < count; ++index) {
        AudioTrackInfo info;
        clearTexts(info);
        if (!service->getAudioTrackInfo(flag, index, info)) {
            ALOGE("OrvMediaClient_getAllAudioTrackInfo(): service get failed\n");
            return 0;
        }
        callSetAllAudioTrackInfo(env, thiz, method, count, index, info);
    }
    logLeave(__func__);
    return 1;
}

}  // namespace android
