// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

// The native methods of com.quintora.mmp.OrvMediaPlayer, by the file that
// defines them. NativeMethodTable.cpp pairs them with their Java names. They
// run on Java threads and block as long as the engine's operation does.

namespace android {

// ClientFields.cpp
void OrvMediaClient_init(JNIEnv* env, jclass clazz);

// PlayerContext.cpp
void OrvMediaClient_setup(JNIEnv* env, jobject thiz, jobject weak_this);
void OrvMediaClient_release(JNIEnv* env, jobject thiz);
void OrvMediaClient_reset(JNIEnv* env, jobject thiz);
void OrvMediaClient_finalize(JNIEnv* env, jobject thiz);

// PlaybackCommands.cpp
void OrvMediaClient_setDataSource(JNIEnv* env, jobject thiz, jstring path);
void OrvMediaClient_setDataSourceAndHeaders(JNIEnv* env, jobject thiz, jstring path,
                                            jobjectArray keys, jobjectArray values);
void OrvMediaClient_setDataSourceFD(JNIEnv* env, jobject thiz, jobject fileDescriptor, jlong offset,
                                    jlong length);
void OrvMediaClient_prepare(JNIEnv* env, jobject thiz);
void OrvMediaClient_prepareAsync(JNIEnv* env, jobject thiz);
void OrvMediaClient_start(JNIEnv* env, jobject thiz);
void OrvMediaClient_stop(JNIEnv* env, jobject thiz);
void OrvMediaClient_pause(JNIEnv* env, jobject thiz);
void OrvMediaClient_seekTo(JNIEnv* env, jobject thiz, jint msec);
jint OrvMediaClient_getVideoWidth(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getVideoHeight(JNIEnv* env, jobject thiz);
jboolean OrvMediaClient_isPlaying(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getCurrentPosition(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getDuration(JNIEnv* env, jobject thiz);
void OrvMediaClient_setAudioStreamType(JNIEnv* env, jobject thiz, jint type);
void OrvMediaClient_setLooping(JNIEnv* env, jobject thiz, jboolean looping);
jboolean OrvMediaClient_isLooping(JNIEnv* env, jobject thiz);
void OrvMediaClient_setVolume(JNIEnv* env, jobject thiz, jfloat left, jfloat right);
jobject OrvMediaClient_getFrameAt(JNIEnv* env, jobject thiz, jint msec);
jint OrvMediaClient_invoke(JNIEnv* env, jobject thiz, jobject request, jobject reply);
jint OrvMediaClient_setMetadataFilter(JNIEnv* env, jobject thiz, jobject filter);
jboolean OrvMediaClient_getMetadata(JNIEnv* env, jobject thiz, jboolean updateOnly,
                                    jboolean applyFilter, jobject reply);
jint OrvMediaClient_get_audio_session_id(JNIEnv* env, jobject thiz);
void OrvMediaClient_set_audio_session_id(JNIEnv* env, jobject thiz, jint id);
void OrvMediaClient_setAuxEffectSendLevel(JNIEnv* env, jobject thiz, jfloat level);
void OrvMediaClient_attachAuxEffect(JNIEnv* env, jobject thiz, jint effectId);
jboolean OrvMediaClient_setParameter(JNIEnv* env, jobject thiz, jint key, jobject request);
void OrvMediaClient_getParameter(JNIEnv* env, jobject thiz, jint key, jobject reply);
jboolean OrvMediaClient_setAudioTrack(JNIEnv* env, jobject thiz, jint track);

// VideoSurface.cpp
void OrvMediaClient_setVideoSurface(JNIEnv* env, jobject thiz, jobject jsurface);

// ExtensionCommands.cpp
jint OrvMediaClient_setPlayMode(JNIEnv* env, jobject thiz, jint speed);
jint OrvMediaClient_getPlayMode(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getBufferingTime(JNIEnv* env, jobject thiz);
void OrvMediaClient_onSubtitleTrack(JNIEnv* env, jobject thiz, jint index);
void OrvMediaClient_offSubtitleTrack(JNIEnv* env, jobject thiz);
void OrvMediaClient_deselectTrack(JNIEnv* env, jobject thiz, jint index);
void OrvMediaClient_selectTrack(JNIEnv* env, jobject thiz, jint index);
void OrvMediaClient_step(JNIEnv* env, jobject thiz, jint amount);
void OrvMediaClient_seekToPosition(JNIEnv* env, jobject thiz, jlong position);
jboolean OrvMediaClient_canDoSeek(JNIEnv* env, jobject thiz, jint speed);
jboolean OrvMediaClient_canDoTrick(JNIEnv* env, jobject thiz, jint speed);
jboolean OrvMediaClient_setTS(JNIEnv* env, jobject thiz, jint ts);
jint OrvMediaClient_getCurrentBytePosition(JNIEnv* env, jobject thiz);
void OrvMediaClient_setPlayerRole(JNIEnv* env, jobject thiz, jint role);
jint OrvMediaClient_setABRepeat(JNIEnv* env, jobject thiz, jint type);
jint OrvMediaClient_QTVDEC_SendCliCommand(JNIEnv* env, jobject thiz, jstring command,
                                          jint argument);
jint OrvMediaClient_getCurrentAudioIndex(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getCurrentSubtitleIndex(JNIEnv* env, jobject thiz);
jint OrvMediaClient_setUnLockPin(JNIEnv* env, jobject thiz, jint pin);

// StreamSource.cpp
void OrvMediaClient_setDataSourceByInputStream(JNIEnv* env, jobject thiz);

// TrackInfo.cpp
jboolean OrvMediaClient_getVideoCodecInfo(JNIEnv* env, jobject thiz);
jboolean OrvMediaClient_getSubtitleTrackInfo(JNIEnv* env, jobject thiz, jint index);
jint OrvMediaClient_getAllSubtitleTrackInfo(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getAllAudioTrackInfo(JNIEnv* env, jobject thiz, jboolean flag);
jint OrvMediaClient_getAllVideoTrackInfo(JNIEnv* env, jobject thiz);

// SubtitleSources.cpp
void OrvMediaClient_setSubtitleDataSource(JNIEnv* env, jobject thiz, jstring url);
void OrvMediaClient_setSubtitleDataSourceEx(JNIEnv* env, jobject thiz, jstring sub, jstring idx);
jint OrvMediaClient_addTimedTextSource(JNIEnv* env, jobject thiz, jstring url);

// SubtitleAttr.cpp
void OrvMediaClient_setSubtitleAttr(JNIEnv* env, jobject thiz, jobject attr);

// Pictures.cpp
jbyteArray OrvMediaClient_getThumbnailInfo(JNIEnv* env, jobject thiz, jobject thumbnailInfo);
jbyteArray OrvMediaClient_getEmbeddedPicture(JNIEnv* env, jobject thiz, jint unused);

// MetaData.cpp
jboolean OrvMediaClient_getMetaDataInfo(JNIEnv* env, jobject thiz);

// PcmMediaInfo.cpp
void OrvMediaClient_setPcmMediaInfo(JNIEnv* env, jobject thiz, jobject pcmMediaInfo);
void OrvMediaClient_setPcmFlag(JNIEnv* env, jobject thiz);

// DivxNavigation.cpp
jboolean OrvMediaClient_getDivxTitleInfo(JNIEnv* env, jobject thiz, jint title);
jboolean OrvMediaClient_getDivxChapInfo(JNIEnv* env, jobject thiz, jint title, jint playlist,
                                        jint chapter);
jboolean OrvMediaClient_getDivxPlayListInfo(JNIEnv* env, jobject thiz, jint title, jint playlist);
jboolean OrvMediaClient_getDivxPositionInfo(JNIEnv* env, jobject thiz);
jboolean OrvMediaClient_getDivxDisplayInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c,
                                           jint d, jint e);
jboolean OrvMediaClient_getDivxLastMemoryFilePosition(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getDivxTitleNum(JNIEnv* env, jobject thiz);
jint OrvMediaClient_getDivxLastMemoryFileID(JNIEnv* env, jobject thiz);
jint OrvMediaClient_setDivxTitleInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c);
jint OrvMediaClient_setDivxChapInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c, jint d);
jint OrvMediaClient_setDivxPlayListInfo(JNIEnv* env, jobject thiz, jint a, jint b, jint c, jint d);
jint OrvMediaClient_setDivxBtnInfo(JNIEnv* env, jobject thiz, jint a, jint b);
jint OrvMediaClient_setDivxFilePosition(JNIEnv* env, jobject thiz, jint a, jint b);

// DivxLastMemory.cpp
jint OrvMediaClient_setDivxLastMemoryFilePosition(JNIEnv* env, jobject thiz, jobject position);

}  // namespace android
