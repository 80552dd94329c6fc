// SPDX-License-Identifier: Apache-2.0
// Where DivX records reach Java.

#include "jni/BridgeLog.h"
#include "jni/DivxNavigation.h"
#include "jni/JavaCallback.h"

namespace android {

bool deliverDivxTitleInfo(JNIEnv* env, jobject thiz, const DivxTitleInfo& info) {
    jmethodID method = findCallback(
        env, "setDivxTitleInfoPrm", "(III)V",
        "OrvMediaClient_getDivxTitleInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getDivxTitleInfo(): get method id, setDivxTitleInfoPrm, failed\n");
    if (method == nullptr) return false;
    env->CallVoidMethod(thiz, method, info.mTitle, info.mPlayListCount, info.mChapterCount);
    return true;
}

bool deliverDivxChapInfo(JNIEnv* env, jobject thiz, const DivxChapInfo& info) {
    jmethodID method = findCallback(
        env, "setDivxChapInfoPrm", "(IIII)V",
        "OrvMediaClient_getDivxChapInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getDivxChapInfo(): get method id, setDivxChapInfoPrm, failed\n");
    if (method == nullptr) return false;
    env->CallVoidMethod(thiz, method, info.mTitle, info.mPlayList, info.mChapter, info.mStart);
    return true;
}

bool deliverDivxPlayListInfo(JNIEnv* env, jobject thiz, const DivxPlayListInfo& info) {
    jmethodID method = findCallback(
        env, "setDivxPlayListInfoPrm", "(IIII)V",
        "OrvMediaClient_getDivxPlayListInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getDivxPlayListInfo(): get method id, setDivxPlayListInfoPrm, failed\n");
    if (method == nullptr) return false;
    env->CallVoidMethod(thiz, method, info.mTitle, info.mPlayList, info.mChapter, info.mStart);
    return true;
}

bool deliverDivxPositionInfo(JNIEnv* env, jobject thiz, const DivxPositionInfo& info) {
    jmethodID method = findCallback(
        env, "setDivxPositionInfoPrm", "(III)V",
        "OrvMediaClient_getDivxPositionInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getDivxPositionInfo(): get method id, setDivxPositionInfoPrm, failed\n");
    if (method == nullptr) return false;
    env->CallVoidMethod(thiz, method, info.mTitle, info.mPlayListCount, info.mChapterCount);
    return true;
}

bool deliverDivxDisplayInfo(JNIEnv* env, jobject thiz, DivxDisplayInfo& info) {
    jmethodID method = findCallback(
        env, "setDivxDisplayInfoPrm", "(IIIIILjava/lang/String;ILjava/lang/String;I)V",
        "OrvMediaClient_getDivxDisplayInfo(): find class(%s) failed, please check\n",
        "OrvMediaClient_getDivxDisplayInfo(): get method id, setDivxDisplayInfoPrm, failed\n");
    if (method == nullptr) return false;
    jstring text1 = newString(env, info.mText1);
    jstring text2 = newString(env, info.mText2);
    // Against the signature this pairs the sixth number with the first string,
    // and so on to the last.
    env->CallVoidMethod(thiz, method, info.mValues[0], info.mValues[1], info.mValues[2],
                        info.mValues[3], info.mValues[4], info.mValues[5], text1, info.mValue7,
                        text2);
    return true;
}

bool deliverDivxLastMemoryFilePosition(JNIEnv* env, jobject thiz,
                                       const DivxLastMemoryFilePosition& position) {
    jmethodID method = findCallback(
        env, "setDivxLastMemoryFilePositionPrm", "(JIIIIIJJJJJJIIJJI)V",
        "OrvMediaClient_getDivxLastMemoryFilePosition(): find class(%s) failed, please check\n",
        "OrvMediaClient_getDivxLastMemoryFilePosition(): get method id, "
        "setDivxLastMemoryFilePositionPrm, failed\n");
    if (method == nullptr) return false;
    const DivxLastMemoryFilePosition& p = position;
    // 32-bit values throughout, whatever the signature says.
    env->CallVoidMethod(thiz, method, p.ui8_clip_id, p.ui4_title_idx, p.ui4_playlist_idx,
                        p.ui4_chap_idx, p.ui2_aud_idx, p.ui2_sub_idx, p.ui8_aud_pts_info,
                        p.ui8_aud_frame_position, p.ui8_i_pts_info, p.ui8_pts_info,
                        p.ui8_i_frame_position, p.ui8_frame_position, p.i4_temporal_reference,
                        p.ui2_decoding_order, p.ui8_stc, p.ui8_frame_position_disp, p.ui4_timestap);
    return true;
}

}  // namespace android
