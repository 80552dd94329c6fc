// SPDX-License-Identifier: Apache-2.0
// The native methods that mirror a classic media player.

#include <media/MediaTrack.h>
#include <nativehelper/JNIHelp.h>
#if __has_include(<nativehelper/JNIPlatformHelp.h>)
#include <nativehelper/JNIPlatformHelp.h>  // file descriptors, from Android 12 on
#endif
#include <utils/KeyedVector.h>
#include <utils/String8.h>

#include "jni/BridgeLog.h"
#include "jni/JavaString.h"
#include "jni/KeyValueArrays.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"
#include "jni/StatusExceptions.h"
#include "jni/VideoSurface.h"

namespace android {

void OrvMediaClient_setDataSource(JNIEnv* env, jobject thiz, jstring path) {
    logEnter(__func__);
    OrvMediaClient_setDataSourceAndHeaders(env, thiz, path, nullptr, nullptr);
    logLeave(__func__);
}

void OrvMediaClient_setDataSourceAndHeaders(JNIEnv* env, jobject thiz, jstring path,
                                            jobjectArray keys, jobjectArray values) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        // With a blank before the line end, unlike everywhere else.
        ALOGE("service not exist, throw exception. Line:%d \n", __LINE__);
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
        return;
    }
    if (path == nullptr) {
        ALOGE("path==null, thow exception. Line:%d \n", __LINE__);
        jniThrowException(env, "java/lang/IllegalArgumentException", nullptr);
        return;
    }
    const char* pathChars = stringChars(env, path);
    if (pathChars == nullptr) {
        ALOGE("OrvMediaClient_setDataSourceAndHeaders(): out of memory!!!n\n");
        return;
    }
    const String8 url(pathChars);
    env->ReleaseStringUTFChars(path, pathChars);

    KeyedVector<String8, String8> headers;
    if (!ConvertKeyValueArraysToKeyedVector(env, keys, values, &headers)) return;

    const status_t status =
        service->setDataSource(url.c_str(), headers.size() > 0 ? &headers : nullptr);
    process_media_player_call(env, thiz, status, "java/io/IOException", "setDataSource failed.");
    logLeave(__func__);
}

void OrvMediaClient_setDataSourceFD(JNIEnv* env, jobject thiz, jobject fileDescriptor, jlong offset,
                                    jlong length) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    if (fileDescriptor == nullptr) {
        logMissingService();  // the same text for a missing descriptor
        jniThrowException(env, "java/lang/IllegalArgumentException", nullptr);
        return;
    }
    const int fd = jniGetFDFromFileDescriptor(env, fileDescriptor);
    const status_t status = service->setDataSource(fd, offset, length);
    process_media_player_call(env, thiz, status, "java/io/IOException", "setDataSourceFD failed.");
    logLeave(__func__);
}

void OrvMediaClient_prepare(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    service->setVideoSurfaceTexture(getVideoSurfaceTexture(env, thiz));
    process_media_player_call(env, thiz, service->prepare(), "java/io/IOException",
                              "Prepare failed.");
    logLeave(__func__);
}

void OrvMediaClient_prepareAsync(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->prepareAsync(), "java/io/IOException",
                              "Prepare Async failed.");
    logLeave(__func__);
}

void OrvMediaClient_start(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->start(), "java/lang/IllegalStateException",
                              nullptr);
    logLeave(__func__);
}

void OrvMediaClient_stop(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->stop(), "java/lang/IllegalStateException",
                              nullptr);
    logLeave(__func__);
}

void OrvMediaClient_pause(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->pause(), "java/io/IOException", "pause failed.");
    logLeave(__func__);
}

void OrvMediaClient_seekTo(JNIEnv* env, jobject thiz, jint msec) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    const status_t status = service->seekTo(msec, MediaTrack::ReadOptions::SEEK_PREVIOUS_SYNC);
    ALOGI("OrvMediaClient_seekTo(): %d\n", status);
    if (status != NO_ERROR) {
        // Not mapped by status: always an IllegalStateException.
        ALOGE("OrvMediaClient_seekTo(): throw exception\n");
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    }
    logLeave(__func__);
}

jint OrvMediaClient_getVideoWidth(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return 0;
    int width = 0;
    service->getVideoWidth(&width);
    logLeave(__func__);
    return width;
}

jint OrvMediaClient_getVideoHeight(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return 0;
    int height = 0;
    service->getVideoHeight(&height);
    logLeave(__func__);
    return height;
}

jboolean OrvMediaClient_isPlaying(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    const bool playing = service->isPlaying();
    logLeave(__func__);
    return playing;
}

// Asked many times a second: no enter or leave lines.
jint OrvMediaClient_getCurrentPosition(JNIEnv* env, jobject thiz) {
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return 0;
    int msec = 0;
    process_media_player_call(env, thiz, service->getCurrentPosition(&msec), "java/io/IOException",
                              "getCurrentPosition failed.");
    return msec;
}

jint OrvMediaClient_getDuration(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return 0;
    int msec = 0;
    service->getDuration(&msec);
    ALOGI("OrvMediaClient_getDuration(): %d (msec)", msec);
    logLeave(__func__);
    return msec;
}

void OrvMediaClient_setAudioStreamType(JNIEnv* env, jobject thiz, jint type) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->setAudioStreamType(type), "java/io/IOException",
                              "OrvMediaClient_setAudioStreamType failed.");
    logLeave(__func__);
}

void OrvMediaClient_setLooping(JNIEnv* env, jobject thiz, jboolean looping) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->setLooping(looping), "java/io/IOException",
                              "OrvMediaClient_setLooping failed.");
    logLeave(__func__);
}

jboolean OrvMediaClient_isLooping(JNIEnv* env, jobject thiz) {
    logOccur(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return JNI_FALSE;
    return service->isLooping();
}

void OrvMediaClient_setVolume(JNIEnv* env, jobject thiz, jfloat left, jfloat right) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->setVolume(left, right), "java/io/IOException",
                              "OrvMediaClient_setVolume failed.");
    logLeave(__func__);
}

// Always null: pictures come through the thumbnail method.
jobject OrvMediaClient_getFrameAt(JNIEnv*, jobject, jint) {
    logOccur(__func__);
    return nullptr;
}

// The invoke, metadata and parameter methods forward nothing at this layer,
// whatever the service could do.

jint OrvMediaClient_invoke(JNIEnv* env, jobject thiz, jobject, jobject) {
    logOccur(__func__);
    return serviceOrThrow(env, thiz) != nullptr ? NO_ERROR : UNKNOWN_ERROR;
}

jint OrvMediaClient_setMetadataFilter(JNIEnv* env, jobject thiz, jobject) {
    logOccur(__func__);
    return serviceOrThrow(env, thiz) != nullptr ? NO_ERROR : UNKNOWN_ERROR;
}

jboolean OrvMediaClient_getMetadata(JNIEnv* env, jobject thiz, jboolean, jboolean, jobject) {
    logOccur(__func__);
    serviceOrThrow(env, thiz);
    return JNI_FALSE;
}

jboolean OrvMediaClient_setParameter(JNIEnv* env, jobject thiz, jint, jobject) {
    logEnter(__func__);
    serviceOrThrow(env, thiz);
    return JNI_FALSE;  // without a leave line
}

void OrvMediaClient_getParameter(JNIEnv* env, jobject thiz, jint, jobject) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    logLeave(__func__);
}

jint OrvMediaClient_get_audio_session_id(JNIEnv* env, jobject thiz) {
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return 0;
    return service->getAudioSessionId();
}

void OrvMediaClient_set_audio_session_id(JNIEnv* env, jobject thiz, jint id) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->setAudioSessionId(id), "java/io/IOException",
                              "OrvMediaClient_set_audio_session_id failed.");
    logLeave(__func__);
}

void OrvMediaClient_setAuxEffectSendLevel(JNIEnv* env, jobject thiz, jfloat level) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    process_media_player_call(env, thiz, service->setAuxEffectSendLevel(level),
                              "java/io/IOException",
                              "OrvMediaClient_setAuxEffectSendLevel failed.");
    logLeave(__func__);
}

void OrvMediaClient_attachAuxEffect(JNIEnv* env, jobject thiz, jint effectId) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return;
    // The message is another command's.
    process_media_player_call(env, thiz, service->attachAuxEffect(effectId), "java/io/IOException",
                              "getCurrentBytePosition failed.");
    logLeave(__func__);
}

jboolean OrvMediaClient_setAudioTrack(JNIEnv* env, jobject thiz, jint track) {
    logEnter(__func__);
    ALOGI("OrvMediaClient_setAudioTrack(): track num = %d\n", track);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        logMissingService();  // and nothing is thrown
        return JNI_FALSE;
    }
    if (!service->setAudioTrack(track)) {
        logMissingService();  // the same text for a refused track
        return JNI_FALSE;
    }
    logLeave(__func__);
    return JNI_TRUE;
}

}  // namespace android
