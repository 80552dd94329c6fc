// SPDX-License-Identifier: Apache-2.0
// The front door: every native method of the Java player class, in the order of
// registration, under the name of the file that defines its function.

#include "jni/NativeMethodTable.h"

#include <android_runtime/AndroidRuntime.h>

#include "jni/ClientFields.h"
#include "jni/NativeMethodSignature.h"
#include "jni/OrvMediaClient.h"

namespace android {

namespace {

template <bool kMatches>
constexpr const char* checked(const char* signature) {
    static_assert(kMatches, "the JNI signature is not that of the function");
    return signature;
}

#define ROW(javaName, signature, function)                                                 \
    {javaName,                                                                             \
     checked<NativeMethodSignature<decltype(&(function))>::matches(signature)>(signature), \
     reinterpret_cast<void*>(&(function))}

// One row a line, however long.
// clang-format off
const JNINativeMethod kNativeMethods[] = {
    // PlaybackCommands.cpp
    ROW("native_setDataSource", "(Ljava/lang/String;)V", OrvMediaClient_setDataSource),
    ROW("native_setDataSource", "(Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V", OrvMediaClient_setDataSourceAndHeaders),
    ROW("native_setDataSource", "(Ljava/io/FileDescriptor;JJ)V", OrvMediaClient_setDataSourceFD),
    // VideoSurface.cpp
    ROW("native_setVideoSurface", "(Landroid/view/Surface;)V", OrvMediaClient_setVideoSurface),
    // PlaybackCommands.cpp
    ROW("native_prepare", "()V", OrvMediaClient_prepare),
    ROW("native_prepareAsync", "()V", OrvMediaClient_prepareAsync),
    ROW("native_start", "()V", OrvMediaClient_start),
    ROW("native_stop", "()V", OrvMediaClient_stop),
    ROW("native_getVideoWidth", "()I", OrvMediaClient_getVideoWidth),
    ROW("native_getVideoHeight", "()I", OrvMediaClient_getVideoHeight),
    ROW("native_seekTo", "(I)V", OrvMediaClient_seekTo),
    ROW("native_pause", "()V", OrvMediaClient_pause),
    ROW("native_isPlaying", "()Z", OrvMediaClient_isPlaying),
    ROW("native_getCurrentPosition", "()I", OrvMediaClient_getCurrentPosition),
    ROW("native_getDuration", "()I", OrvMediaClient_getDuration),
    // PlayerContext.cpp
    ROW("native_release", "()V", OrvMediaClient_release),
    ROW("native_reset", "()V", OrvMediaClient_reset),
    // PlaybackCommands.cpp
    ROW("native_setAudioStreamType", "(I)V", OrvMediaClient_setAudioStreamType),
    ROW("native_setLooping", "(Z)V", OrvMediaClient_setLooping),
    ROW("native_isLooping", "()Z", OrvMediaClient_isLooping),
    ROW("native_setVolume", "(FF)V", OrvMediaClient_setVolume),
    ROW("native_getFrameAt", "(I)Landroid/graphics/Bitmap;", OrvMediaClient_getFrameAt),
    ROW("native_invoke", "(Landroid/os/Parcel;Landroid/os/Parcel;)I", OrvMediaClient_invoke),
    ROW("native_setMetadataFilter", "(Landroid/os/Parcel;)I", OrvMediaClient_setMetadataFilter),
    ROW("native_getMetadata", "(ZZLandroid/os/Parcel;)Z", OrvMediaClient_getMetadata),
    // ClientFields.cpp
    ROW("native_init", "()V", OrvMediaClient_init),
    // PlayerContext.cpp
    ROW("native_setup", "(Ljava/lang/Object;)V", OrvMediaClient_setup),
    ROW("native_finalize", "()V", OrvMediaClient_finalize),
    // PlaybackCommands.cpp
    ROW("native_getAudioSessionId", "()I", OrvMediaClient_get_audio_session_id),
    ROW("native_setAudioSessionId", "(I)V", OrvMediaClient_set_audio_session_id),
    ROW("native_setAuxEffectSendLevel", "(F)V", OrvMediaClient_setAuxEffectSendLevel),
    ROW("native_attachAuxEffect", "(I)V", OrvMediaClient_attachAuxEffect),
    ROW("native_setParameter", "(ILandroid/os/Parcel;)Z", OrvMediaClient_setParameter),
    ROW("native_getParameter", "(ILandroid/os/Parcel;)V", OrvMediaClient_getParameter),
    ROW("native_setAudioTrack", "(I)Z", OrvMediaClient_setAudioTrack),
    // TrackInfo.cpp
    ROW("native_getVideoCodecInfo", "()Z", OrvMediaClient_getVideoCodecInfo),
    // ExtensionCommands.cpp
    ROW("native_setPlayMode", "(I)I", OrvMediaClient_setPlayMode),
    ROW("native_getPlayMode", "()I", OrvMediaClient_getPlayMode),
    ROW("native_getBufferPercent", "()I", OrvMediaClient_getBufferingTime),
    ROW("native_onSubtitleTrack", "(I)V", OrvMediaClient_onSubtitleTrack),
    ROW("native_offSubtitleTrack", "()V", OrvMediaClient_offSubtitleTrack),
    ROW("native_deselectTrack", "(I)V", OrvMediaClient_deselectTrack),
    ROW("native_selectTrack", "(I)V", OrvMediaClient_selectTrack),
    // TrackInfo.cpp
    ROW("native_getSubtitleTrackInfo", "(I)Z", OrvMediaClient_getSubtitleTrackInfo),
    ROW("native_getAllSubtitleTrackInfo", "()I", OrvMediaClient_getAllSubtitleTrackInfo),
    ROW("native_getAllAudioTrackInfo", "(Z)I", OrvMediaClient_getAllAudioTrackInfo),
    ROW("native_getAllVideoTrackInfo", "()I", OrvMediaClient_getAllVideoTrackInfo),
    // SubtitleSources.cpp
    ROW("native_setSubtitleDataSource", "(Ljava/lang/String;)V", OrvMediaClient_setSubtitleDataSource),
    ROW("native_setSubtitleDataSourceEx", "(Ljava/lang/String;Ljava/lang/String;)V", OrvMediaClient_setSubtitleDataSourceEx),
    ROW("native_addTimedTextSource", "(Ljava/lang/String;)I", OrvMediaClient_addTimedTextSource),
    // SubtitleAttr.cpp
    ROW("native_setSubtitleAttr", "(Lcom/quintora/SubtitleAttr;)V", OrvMediaClient_setSubtitleAttr),
    // Pictures.cpp
    ROW("native_getThumbnailInfo", "(Lcom/quintora/mmp/util/ThumbnailInfo;)[B", OrvMediaClient_getThumbnailInfo),
    // ExtensionCommands.cpp
    ROW("native_step", "(I)V", OrvMediaClient_step),
    // Pictures.cpp
    ROW("native_getEmbeddedPicture", "(I)[B", OrvMediaClient_getEmbeddedPicture),
    // PcmMediaInfo.cpp
    ROW("native_setPcmMediaInfo", "(Lcom/quintora/mmp/util/PcmMediaInfo;)V", OrvMediaClient_setPcmMediaInfo),
    ROW("native_setPcmFlag", "()V", OrvMediaClient_setPcmFlag),
    // StreamSource.cpp
    ROW("native_setDataSourceByInputStream", "()V", OrvMediaClient_setDataSourceByInputStream),
    // ExtensionCommands.cpp
    ROW("native_seekToPosition", "(J)V", OrvMediaClient_seekToPosition),
    ROW("native_canDoSeek", "(I)Z", OrvMediaClient_canDoSeek),
    ROW("native_canDoTrick", "(I)Z", OrvMediaClient_canDoTrick),
    ROW("native_setTS", "(I)Z", OrvMediaClient_setTS),
    ROW("native_getCurrentBytePosition", "()I", OrvMediaClient_getCurrentBytePosition),
    ROW("native_setPlayerRole", "(I)V", OrvMediaClient_setPlayerRole),
    // MetaData.cpp
    ROW("native_getMetaDataInfo", "()Z", OrvMediaClient_getMetaDataInfo),
    // ExtensionCommands.cpp
    ROW("native_setABRepeat", "(I)I", OrvMediaClient_setABRepeat),
    ROW("native_QTVDECSendCliCommand", "(Ljava/lang/String;I)I", OrvMediaClient_QTVDEC_SendCliCommand),
    // DivxNavigation.cpp
    ROW("native_getDivxTitleInfo", "(I)Z", OrvMediaClient_getDivxTitleInfo),
    ROW("native_getDivxChapInfo", "(III)Z", OrvMediaClient_getDivxChapInfo),
    ROW("native_getDivxPlayListInfo", "(II)Z", OrvMediaClient_getDivxPlayListInfo),
    ROW("native_getDivxPositionInfo", "()Z", OrvMediaClient_getDivxPositionInfo),
    ROW("native_getDivxDisplayInfo", "(IIIII)Z", OrvMediaClient_getDivxDisplayInfo),
    ROW("native_getDivxLastMemoryFilePosition", "()Z", OrvMediaClient_getDivxLastMemoryFilePosition),
    ROW("native_getDivxTitleNum", "()I", OrvMediaClient_getDivxTitleNum),
    ROW("native_getDivxLastMemoryFileID", "()I", OrvMediaClient_getDivxLastMemoryFileID),
    ROW("native_setDivxTitleInfo", "(III)I", OrvMediaClient_setDivxTitleInfo),
    ROW("native_setDivxChapInfo", "(IIII)I", OrvMediaClient_setDivxChapInfo),
    ROW("native_setDivxPlayListInfo", "(IIII)I", OrvMediaClient_setDivxPlayListInfo),
    ROW("native_setDivxBtnInfo", "(II)I", OrvMediaClient_setDivxBtnInfo),
    // DivxLastMemory.cpp
    ROW("native_setDivxLastMemoryFilePosition", "(Lcom/quintora/mmp/util/DivxLastMemoryFilePosition;)I", OrvMediaClient_setDivxLastMemoryFilePosition),
    // DivxNavigation.cpp
    ROW("native_setDivxFilePosition", "(II)I", OrvMediaClient_setDivxFilePosition),
    // ExtensionCommands.cpp
    ROW("native_getCurrentAudioIndex", "()I", OrvMediaClient_getCurrentAudioIndex),
    ROW("native_getCurrentSubtitleIndex", "()I", OrvMediaClient_getCurrentSubtitleIndex),
    ROW("native_setUnLockPin", "(I)I", OrvMediaClient_setUnLockPin),
};
// clang-format on

#undef ROW

constexpr int kNativeMethodCount = sizeof(kNativeMethods) / sizeof(kNativeMethods[0]);

}  // namespace

int register_OrvMediaClient(JNIEnv* env) {
    return AndroidRuntime::registerNativeMethods(env, kPlayerClassPath, kNativeMethods,
                                                 kNativeMethodCount);
}

}  // namespace android
