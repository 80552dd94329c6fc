// SPDX-License-Identifier: Apache-2.0
// The summary of the media's numbers and titles.

#include <orvtarn/MetaDataInfo.h>

#include "jni/BridgeLog.h"
#include "jni/JavaCallback.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

void clearTexts(MetaDataInfo& info) {
    clearText(info.mTitle);
    clearText(info.mArtist);
    clearText(info.mAlbum);
    clearText(info.mGenre);
    clearText(info.mComposer);
    clearText(info.mContainer);
    clearText(info.mComment);
}

void callSetMetaDataInfo(JNIEnv* env, jobject thiz, jmethodID method, MetaDataInfo& info) {
    jstring title = newString(env, info.mTitle);
    jstring artist = newString(env, info.mArtist);
    jstring album = newString(env, info.mAlbum);
    jstring genre = newString(env, info.mGenre);
    jstring composer = newString(env, info.mComposer);
    jstring container = newString(env, info.mContainer);
    jstring comment = newString(env, info.mComment);
    // The fourth and the sixth number stay behind.
    env->CallVoidMethod(thiz, method, info.mDuration, info.mBitRate, info.mYear, info.mTrackNumber,
                        title, artist, album, genre, info.mChapterCount, composer, container,
                        comment);
}

}  // namespace

jboolean OrvMediaClient_getMetaDataInfo(JNIEnv* env, jobject thiz) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("service not exist. Line:%d\n", __LINE__);
        return JNI_FALSE;
    }
    MetaDataInfo info;
    clearTexts(info);
    if (!service->getMetaDataInfo(info)) {
        ALOGE("OrvMediaClient_getMetaDataInfo(): service get failed\n");
        return JNI_FALSE;
    }
    jmethodID method = findCallback(
        env, "setMetaDataInfo",
        "(IIIILjava/lang/String;Ljava/lang/String;Ljava/lang/String;Ljava/lang/String;I"
        "Ljava/lang/String;Ljava/lang/String;Ljava/lang/String;)V",
        "OrvMediaClient_getMetaDataInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getMetaDataInfo(): get method id, setAudioTrackInfo, failed\n");
    if (method == nullptr) return JNI_FALSE;
    callSetMetaDataInfo(env, thiz, method, info);
    logLeave(__func__);
    return JNI_TRUE;
}

}  // namespace android
