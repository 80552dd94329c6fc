// SPDX-License-Identifier: Apache-2.0
#include "NativeMethods.h"

#include <string.h>

#include <unordered_map>

namespace orvtrace {

// One row a line, however long.
// clang-format off
const NativeMethod kNativeMethods[] = {
    {"setDataSource", Trail::kPair, "OrvMediaClient_setDataSource", "OrvMediaClient_setDataSource"},
    {"setDataSourceAndHeaders", Trail::kPair, "OrvMediaClient_setDataSourceAndHeaders", "OrvMediaClient_setDataSourceAndHeaders"},
    {"setDataSourceFD", Trail::kPair, "OrvMediaClient_setDataSourceFD", "OrvMediaClient_setDataSourceFD"},
    {"setVideoSurface", Trail::kPair, "OrvMediaClient_setVideoSurface", "OrvMediaClient_setVideoSurface"},
    {"prepare", Trail::kPair, "OrvMediaClient_prepare", "OrvMediaClient_prepare"},
    {"prepareAsync", Trail::kPair, "OrvMediaClient_prepareAsync", "OrvMediaClient_prepareAsync"},
    {"start", Trail::kPair, "OrvMediaClient_start", "OrvMediaClient_start"},
    {"stop", Trail::kPair, "OrvMediaClient_stop", "OrvMediaClient_stop"},
    {"getVideoWidth", Trail::kPair, "OrvMediaClient_getVideoWidth", "OrvMediaClient_getVideoWidth"},
    {"getVideoHeight", Trail::kPair, "OrvMediaClient_getVideoHeight", "OrvMediaClient_getVideoHeight"},
    {"seekTo", Trail::kPair, "OrvMediaClient_seekTo", "OrvMediaClient_seekTo"},
    {"pause", Trail::kPair, "OrvMediaClient_pause", "OrvMediaClient_pause"},
    {"isPlaying", Trail::kPair, "OrvMediaClient_isPlaying", "OrvMediaClient_isPlaying"},
    {"getCurrentPosition", Trail::kNone, nullptr, nullptr},
    {"getDuration", Trail::kPair, "OrvMediaClient_getDuration", "OrvMediaClient_getDuration"},
    {"release", Trail::kPair, "OrvMediaClient_release", "OrvMediaClient_release"},
    {"reset", Trail::kPair, "OrvMediaClient_reset", "OrvMediaClient_reset"},
    {"setAudioStreamType", Trail::kPair, "OrvMediaClient_setAudioStreamType", "OrvMediaClient_setAudioStreamType"},
    {"setLooping", Trail::kPair, "OrvMediaClient_setLooping", "OrvMediaClient_setLooping"},
    {"isLooping", Trail::kOccur, "OrvMediaClient_isLooping", nullptr},
    {"setVolume", Trail::kPair, "OrvMediaClient_setVolume", "OrvMediaClient_setVolume"},
    {"getFrameAt", Trail::kOccur, "OrvMediaClient_getFrameAt", nullptr},
    {"invoke", Trail::kOccur, "OrvMediaClient_invoke", nullptr},
    {"setMetadataFilter", Trail::kOccur, "OrvMediaClient_setMetadataFilter", nullptr},
    {"getMetadata", Trail::kOccur, "OrvMediaClient_getMetadata", nullptr},
    {"init", Trail::kPair, "OrvMediaClient_init", "OrvMediaClient_init"},
    {"setup", Trail::kPair, "OrvMediaClient_setup", "OrvMediaClient_setup"},
    {"finalize", Trail::kPair, "OrvMediaClient_finalize", "OrvMediaClient_finalize"},
    {"get_audio_session_id", Trail::kNone, nullptr, nullptr},
    {"set_audio_session_id", Trail::kPair, "OrvMediaClient_set_audio_session_id", "OrvMediaClient_set_audio_session_id"},
    {"setAuxEffectSendLevel", Trail::kPair, "OrvMediaClient_setAuxEffectSendLevel", "OrvMediaClient_setAuxEffectSendLevel"},
    {"attachAuxEffect", Trail::kPair, "OrvMediaClient_attachAuxEffect", "OrvMediaClient_attachAuxEffect"},
    {"setParameter", Trail::kEnter, "OrvMediaClient_setParameter", nullptr},
    {"getParameter", Trail::kPair, "OrvMediaClient_getParameter", "OrvMediaClient_getParameter"},
    {"setAudioTrack", Trail::kPair, "OrvMediaClient_setAudioTrack", "OrvMediaClient_setAudioTrack"},
    {"getVideoCodecInfo", Trail::kPair, "OrvMediaClient_getVideoCodecInfo", "OrvMediaClient_getVideoCodecInfo"},
    {"setPlayMode", Trail::kPair, "OrvMediaClient_setPlayMode", "OrvMediaClient_setPlayModeEx"},
    {"getPlayMode", Trail::kPair, "OrvMediaClient_getPlayMode", "OrvMediaClient_getPlayMode"},
    {"getBufferingTime", Trail::kNone, nullptr, nullptr},
    {"onSubtitleTrack", Trail::kPair, "OrvMediaClient_onSubtitleTrack", "OrvMediaClient_onSubtitleTrack"},
    {"offSubtitleTrack", Trail::kPair, "OrvMediaClient_offSubtitleTrack", "OrvMediaClient_offSubtitleTrack"},
    {"deselectTrack", Trail::kPair, "OrvMediaClient_deselectTrack", "OrvMediaClient_deselectTrack"},
    {"selectTrack", Trail::kPair, "OrvMediaClient_selectTrack", "OrvMediaClient_selectTrack"},
    {"getSubtitleTrackInfo", Trail::kPair, "OrvMediaClient_getSubtitleTrackInfo", "OrvMediaClient_getSubtitleTrackInfo"},
    {"getAllSubtitleTrackInfo", Trail::kPair, "OrvMediaClient_getAllSubtitleTrackInfo", "OrvMediaClient_getAllSubtitleTrackInfo"},
    {"getAllAudioTrackInfo", Trail::kPair, "OrvMediaClient_getAllAudioTrackInfo", "OrvMediaClient_getAllAudioTrackInfo"},
    {"getAllVideoTrackInfo", Trail::kPair, "OrvMediaClient_getAllVideoTrackInfo", "OrvMediaClient_getAllVideoTrackInfo"},
    {"setSubtitleDataSource", Trail::kPair, "OrvMediaClient_setSubtitleDataSource", "OrvMediaClient_setSubtitleDataSource"},
    {"setSubtitleDataSourceEx", Trail::kPair, "OrvMediaClient_setSubtitleDataSourceEx", "OrvMediaClient_setSubtitleDataSourceEx"},
    {"addTimedTextSource", Trail::kPair, "OrvMediaClient_addTimedTextSource", "OrvMediaClient_addTimedTextSource"},
    {"setSubtitleAttr", Trail::kPair, "setSubtitleAttr", "setSubtitleAttr"},
    {"getThumbnailInfo", Trail::kPair, "OrvMediaClient_getThumbnailInfo", "nativeGetThumbNailInfo"},
    {"step", Trail::kPair, "OrvMediaClient_step", "OrvMediaClient_step"},
    {"getEmbeddedPicture", Trail::kPair, "getEmbeddedPicture", "getEmbeddedPicture"},
    {"setPcmMediaInfo", Trail::kPair, "nativeSetPcmMediaInfo", "nativeSetPcmMediaInfo"},
    {"setPcmFlag", Trail::kEnter, "_setPcmFlag", nullptr},
    {"setDataSourceByInputStream", Trail::kPair, "OrvMediaClient_setDataSourceByInputStream", "OrvMediaClient_setDataSourceByInputStream"},
    {"seekToPosition", Trail::kOccur, "OrvMediaClient_seekToPosition", nullptr},
    {"canDoSeek", Trail::kOccur, "OrvMediaClient_canDoSeek", nullptr},
    {"canDoTrick", Trail::kOccur, "OrvMediaClient_canDoTrick", nullptr},
    {"setTS", Trail::kPair, "OrvMediaClient_setTS", "OrvMediaClient_setTS"},
    {"getCurrentBytePosition", Trail::kNone, nullptr, nullptr},
    {"setPlayerRole", Trail::kOccur, "OrvMediaClient_setPlayerRole", nullptr},
    {"getMetaDataInfo", Trail::kPair, "OrvMediaClient_getMetaDataInfo", "OrvMediaClient_getMetaDataInfo"},
    {"setABRepeat", Trail::kPair, "OrvMediaClient_setABRepeat", "OrvMediaClient_setABRepeat"},
    {"QTVDEC_SendCliCommand", Trail::kPair, "OrvMediaClient_QTVDEC_SendCliCommand", "OrvMediaClient_QTVDEC_SendCliCommand"},
    {"getDivxTitleInfo", Trail::kPair, "OrvMediaClient_getDivxTitleInfo", "OrvMediaClient_getDivxTitleInfo"},
    {"getDivxChapInfo", Trail::kPair, "OrvMediaClient_getDivxChapInfo", "OrvMediaClient_getDivxChapInfo"},
    {"getDivxPlayListInfo", Trail::kPair, "OrvMediaClient_getDivxChapInfo", "OrvMediaClient_getDivxPlayListInfo"},
    {"getDivxPositionInfo", Trail::kPair, "OrvMediaClient_getDivxPositionInfo", "OrvMediaClient_getDivxPositionInfo"},
    {"getDivxDisplayInfo", Trail::kPair, "OrvMediaClient_getDivxDisplayInfo", "OrvMediaClient_getDivxDisplayInfo"},
    {"getDivxLastMemoryFilePosition", Trail::kPair, "OrvMediaClient_getDivxLastMemoryFilePosition", "OrvMediaClient_getDivxLastMemoryFilePosition"},
    {"getDivxTitleNum", Trail::kPair, "OrvMediaClient_getDivxTitleNum", "OrvMediaClient_getDivxTitleNum"},
    {"getDivxLastMemoryFileID", Trail::kPair, "OrvMediaClient_getDivxLastMemoryFileID", "OrvMediaClient_getDivxLastMemoryFileID"},
    {"setDivxTitleInfo", Trail::kPair, "OrvMediaClient_setDivxTitleInfo", "OrvMediaClient_setDivxTitleInfo"},
    {"setDivxChapInfo", Trail::kPair, "OrvMediaClient_setDivxChapInfo", "OrvMediaClient_setDivxChapInfo"},
    {"setDivxPlayListInfo", Trail::kPair, "OrvMediaClient_setDivxPlayListInfo", "OrvMediaClient_setDivxPlayListInfo"},
    {"setDivxBtnInfo", Trail::kPair, "OrvMediaClient_setDivxBtnInfo", "OrvMediaClient_setDivxBtnInfo"},
    {"setDivxLastMemoryFilePosition", Trail::kPair, "OrvMediaClient_setDivxLastMemoryFilePosition", "OrvMediaClient_setDivxLastMemoryFilePosition"},
    {"setDivxFilePosition", Trail::kPair, "OrvMediaClient_setDivxFilePosition", "OrvMediaClient_setDivxFilePosition"},
    {"getCurrentAudioIndex", Trail::kPair, "OrvMediaClient_getCurrentAudioIndex", "OrvMediaClient_getCurrentAudioIndex"},
    {"getCurrentSubtitleIndex", Trail::kPair, "OrvMediaClient_getCurrentSubtitleIndex", "OrvMediaClient_getCurrentSubtitleIndex"},
    {"setUnLockPin", Trail::kPair, "OrvMediaClient_setUnLockPin", "OrvMediaClient_setUnLockPin"},
};
// clang-format on

const size_t kNativeMethodCount = sizeof(kNativeMethods) / sizeof(kNativeMethods[0]);

namespace {

using Names = std::unordered_map<std::string_view, const NativeMethod*>;

// Of two methods with one name the first, which it belongs to.
Names namesOf(const char* NativeMethod::* member) {
    Names names;
    for (const NativeMethod& method : kNativeMethods) {
        if (method.*member != nullptr) names.emplace(method.*member, &method);
    }
    return names;
}

const NativeMethod* find(const Names& names, std::string_view name) {
    const auto found = names.find(name);
    return found == names.end() ? nullptr : found->second;
}

bool isNamed(const NativeMethod& method, const char* name) {
    return strcmp(method.name, name) == 0;
}

}  // namespace

const NativeMethod* findEntered(std::string_view name) {
    static const Names names = namesOf(&NativeMethod::enter);
    return find(names, name);
}

const NativeMethod* findLeft(std::string_view name) {
    static const Names names = namesOf(&NativeMethod::leave);
    return find(names, name);
}

bool mayBe(const NativeMethod& entered, const NativeMethod& left) {
    return entered.trail == Trail::kPair && left.trail == Trail::kPair &&
           strcmp(entered.enter, left.enter) == 0;
}

bool calls(const NativeMethod& outer, const NativeMethod& inner) {
    return (isNamed(outer, "setDataSource") && isNamed(inner, "setDataSourceAndHeaders")) ||
           (isNamed(outer, "finalize") && isNamed(inner, "release"));
}

}  // namespace orvtrace
