// SPDX-License-Identifier: Apache-2.0
#pragma once

// The native methods of the Java player class in their order: Java name, JNI
// signature, native function. Only native_init is static.
#define ORV_NATIVE_METHODS(X)                                                                      \
    X("native_setDataSource", "(Ljava/lang/String;)V", OrvMediaClient_setDataSource)               \
    X("native_setDataSource", "(Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V",       \
      OrvMediaClient_setDataSourceAndHeaders)                                                      \
    X("native_setDataSource", "(Ljava/io/FileDescriptor;JJ)V", OrvMediaClient_setDataSourceFD)     \
    X("native_setVideoSurface", "(Landroid/view/Surface;)V", OrvMediaClient_setVideoSurface)       \
    X("native_prepare", "()V", OrvMediaClient_prepare)                                             \
    X("native_prepareAsync", "()V", OrvMediaClient_prepareAsync)                                   \
    X("native_start", "()V", OrvMediaClient_start)                                                 \
    X("native_stop", "()V", OrvMediaClient_stop)                                                   \
    X("native_getVideoWidth", "()I", OrvMediaClient_getVideoWidth)                                 \
    X("native_getVideoHeight", "()I", OrvMediaClient_getVideoHeight)                               \
    X("native_seekTo", "(I)V", OrvMediaClient_seekTo)                                              \
    X("native_pause", "()V", OrvMediaClient_pause)                                                 \
    X("native_isPlaying", "()Z", OrvMediaClient_isPlaying)                                         \
    X("native_getCurrentPosition", "()I", OrvMediaClient_getCurrentPosition)                       \
    X("native_getDuration", "()I", OrvMediaClient_getDuration)                                     \
    X("native_release", "()V", OrvMediaClient_release)                                             \
    X("native_reset", "()V", OrvMediaClient_reset)                                                 \
    X("native_setAudioStreamType", "(I)V", OrvMediaClient_setAudioStreamType)                      \
    X("native_setLooping", "(Z)V", OrvMediaClient_setLooping)                                      \
    X("native_isLooping", "()Z", OrvMediaClient_isLooping)                                         \
    X("native_setVolume", "(FF)V", OrvMediaClient_setVolume)                                       \
    X("native_getFrameAt", "(I)Landroid/graphics/Bitmap;", OrvMediaClient_getFrameAt)              \
    X("native_invoke", "(Landroid/os/Parcel;Landroid/os/Parcel;)I", OrvMediaClient_invoke)         \
    X("native_setMetadataFilter", "(Landroid/os/Parcel;)I", OrvMediaClient_setMetadataFilter)      \
    X("native_getMetadata", "(ZZLandroid/os/Parcel;)Z", OrvMediaClient_getMetadata)                \
    X("native_init", "()V", OrvMediaClient_init)                                                   \
    X("native_setup", "(Ljava/lang/Object;)V", OrvMediaClient_setup)                               \
    X("native_finalize", "()V", OrvMediaClient_finalize)                                           \
    X("native_getAudioSessionId", "()I", OrvMediaClient_get_audio_session_id)                      \
    X("native_setAudioSessionId", "(I)V", OrvMediaClient_set_audio_session_id)                     \
    X("native_setAuxEffectSendLevel", "(F)V", OrvMediaClient_setAuxEffectSendLevel)                \
    X("native_attachAuxEffect", "(I)V", OrvMediaClient_attachAuxEffect)                            \
    X("native_setParameter", "(ILandroid/os/Parcel;)Z", OrvMediaClient_setParameter)               \
    X("native_getParameter", "(ILandroid/os/Parcel;)V", OrvMediaClient_getParameter)               \
    X("native_setAudioTrack", "(I)Z", OrvMediaClient_setAudioTrack)                                \
    X("native_getVideoCodecInfo", "()Z", OrvMediaClient_getVideoCodecInfo)                         \
    X("native_setPlayMode", "(I)I", OrvMediaClient_setPlayMode)                                    \
    X("native_getPlayMode", "()I", OrvMediaClient_getPlayMode)                                     \
    X("native_getBufferPercent", "()I", OrvMediaClient_getBufferingTime)                           \
    X("native_onSubtitleTrack", "(I)V", OrvMediaClient_onSubtitleTrack)                            \
    X("native_offSubtitleTrack", "()V", OrvMediaClient_offSubtitleTrack)                           \
    X("native_deselectTrack", "(I)V", OrvMediaClient_deselectTrack)                                \
    X("native_selectTrack", "(I)V", OrvMediaClient_selectTrack)                                    \
    X("native_getSubtitleTrackInfo", "(I)Z", OrvMediaClient_getSubtitleTrackInfo)                  \
    X("native_getAllSubtitleTrackInfo", "()I", OrvMediaClient_getAllSubtitleTrackInfo)             \
    X("native_getAllAudioTrackInfo", "(Z)I", OrvMediaClient_getAllAudioTrackInfo)                  \
    X("native_getAllVideoTrackInfo", "()I", OrvMediaClient_getAllVideoTrackInfo)                   \
    X("native_setSubtitleDataSource", "(Ljava/lang/String;)V",                                     \
      OrvMediaClient_setSubtitleDataSource)                                                        \
    X("native_setSubtitleDataSourceEx", "(Ljava/lang/String;Ljava/lang/String;)V",                 \
      OrvMediaClient_setSubtitleDataSourceEx)                                                      \
    X("native_addTimedTextSource", "(Ljava/lang/String;)I", OrvMediaClient_addTimedTextSource)     \
    X("native_setSubtitleAttr", "(Lcom/quintora/SubtitleAttr;)V", OrvMediaClient_setSubtitleAttr)  \
    X("native_getThumbnailInfo", "(Lcom/quintora/mmp/util/ThumbnailInfo;)[B",                      \
      OrvMediaClient_getThumbnailInfo)                                                             \
    X("native_step", "(I)V", OrvMediaClient_step)                                                  \
    X("native_getEmbeddedPicture", "(I)[B", OrvMediaClient_getEmbeddedPicture)                     \
    X("native_setPcmMediaInfo", "(Lcom/quintora/mmp/util/PcmMediaInfo;)V",                         \
      OrvMediaClient_setPcmMediaInfo)                                                              \
    X("native_setPcmFlag", "()V", OrvMediaClient_setPcmFlag)                                       \
    X("native_setDataSourceByInputStream", "()V", OrvMediaClient_setDataSourceByInputStream)       \
    X("native_seekToPosition", "(J)V", OrvMediaClient_seekToPosition)                              \
    X("native_canDoSeek", "(I)Z", OrvMediaClient_canDoSeek)                                        \
    X("native_canDoTrick", "(I)Z", OrvMediaClient_canDoTrick)                                      \
    X("native_setTS", "(I)Z", OrvMediaClient_setTS)                                                \
    X("native_getCurrentBytePosition", "()I", OrvMediaClient_getCurrentBytePosition)               \
    X("native_setPlayerRole", "(I)V", OrvMediaClient_setPlayerRole)                                \
    X("native_getMetaDataInfo", "()Z", OrvMediaClient_getMetaDataInfo)                             \
    X("native_setABRepeat", "(I)I", OrvMediaClient_setABRepeat)                                    \
    X("native_QTVDECSendCliCommand", "(Ljava/lang/String;I)I",                                     \
      OrvMediaClient_QTVDEC_SendCliCommand)                                                        \
    X("native_getDivxTitleInfo", "(I)Z", OrvMediaClient_getDivxTitleInfo)                          \
    X("native_getDivxChapInfo", "(III)Z", OrvMediaClient_getDivxChapInfo)                          \
    X("native_getDivxPlayListInfo", "(II)Z", OrvMediaClient_getDivxPlayListInfo)                   \
    X("native_getDivxPositionInfo", "()Z", OrvMediaClient_getDivxPositionInfo)                     \
    X("native_getDivxDisplayInfo", "(IIIII)Z", OrvMediaClient_getDivxDisplayInfo)                  \
    X("native_getDivxLastMemoryFilePosition", "()Z", OrvMediaClient_getDivxLastMemoryFilePosition) \
    X("native_getDivxTitleNum", "()I", OrvMediaClient_getDivxTitleNum)                             \
    X("native_getDivxLastMemoryFileID", "()I", OrvMediaClient_getDivxLastMemoryFileID)             \
    X("native_setDivxTitleInfo", "(III)I", OrvMediaClient_setDivxTitleInfo)                        \
    X("native_setDivxChapInfo", "(IIII)I", OrvMediaClient_setDivxChapInfo)                         \
    X("native_setDivxPlayListInfo", "(IIII)I", OrvMediaClient_setDivxPlayListInfo)                 \
    X("native_setDivxBtnInfo", "(II)I", OrvMediaClient_setDivxBtnInfo)                             \
    X("native_setDivxLastMemoryFilePosition",                                                      \
      "(Lcom/quintora/mmp/util/DivxLastMemoryFilePosition;)I",                                     \
      OrvMediaClient_setDivxLastMemoryFilePosition)                                                \
    X("native_setDivxFilePosition", "(II)I", OrvMediaClient_setDivxFilePosition)                   \
    X("native_getCurrentAudioIndex", "()I", OrvMediaClient_getCurrentAudioIndex)                   \
    X("native_getCurrentSubtitleIndex", "()I", OrvMediaClient_getCurrentSubtitleIndex)             \
    X("native_setUnLockPin", "(I)I", OrvMediaClient_setUnLockPin)
