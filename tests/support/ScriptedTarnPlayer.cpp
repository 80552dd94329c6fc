// SPDX-License-Identifier: Apache-2.0
// android::TarnPlayer as the test program defines it: every operation is
// written down and answered by its ScriptedEngine.
#include <binder/Parcel.h>
#include <gui/IGraphicBufferProducer.h>
#include <stdlib.h>
#include <string.h>

#include <sstream>

#include "ScriptedEngine.h"

using orvtest::ScriptedEngine;

namespace android {
namespace {

// How arguments stand in a recorded call.
std::string text(bool value) { return value ? "true" : "false"; }
std::string text(const char* value) { return value == nullptr ? "null" : value; }
std::string text(const void* value) { return orvtest::pointerText(value); }

template <class Number>
std::string text(Number value) {
    std::ostringstream out;
    out << value;
    return out.str();
}

std::string text(const KeyedVector<String8, String8>* headers) {
    if (headers == nullptr) return "null";
    std::string out = "{";
    for (size_t i = 0; i < headers->size(); i++) {
        if (i != 0) out += ", ";
        out += std::string(headers->keyAt(i).c_str()) + ": " + headers->valueAt(i).c_str();
    }
    return out + "}";
}

std::string text(const SortedVector<int>& ids) {
    std::string out = "{";
    for (size_t i = 0; i < ids.size(); i++) out += (i == 0 ? "" : ", ") + std::to_string(ids[i]);
    return out + "}";
}

// The words from the parcel's position to its end.
std::string text(const Parcel& parcel) {
    std::string out = "[";
    const size_t begin = parcel.dataPosition();
    int32_t word = 0;
    while (parcel.readInt32(&word) == NO_ERROR) {
        out += (out.size() == 1 ? "" : ", ") + std::to_string(word);
    }
    parcel.setDataPosition(begin);
    return out + "]";
}

std::string join() { return ""; }

template <class First, class... Rest>
std::string join(const First& first, const Rest&... rest) {
    return text(first) + ((", " + text(rest)) + ... + "");
}

std::string attributeText(int type, const void* attr) {
    if (attr == nullptr) return "null";
    if (type == E_SUBTITLE_ATTR_TYPE_FONT_INFO) {
        const auto* font = static_cast<const Subtitle_FontInfo*>(attr);
        return join(font->mFontSizeType, int{font->mCustomSize});
    }
    if (type == E_SUBTITLE_ATTR_TYPE_TIME_OFFSET || type == E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET) {
        const auto* offset = static_cast<const Subtitle_TimeOffset*>(attr);
        return join(offset->mTimeOffsetType, offset->mOffsetValue);
    }
    // Read as bytes, so that the channels' order in memory is what is recorded.
    const auto* channels = static_cast<const uint8_t*>(attr);
    return join(int{channels[0]}, int{channels[1]}, int{channels[2]}, int{channels[3]});
}

template <class Record>
bool handOut(const std::map<int, Record>& records, int index, Record& out) {
    const auto record = records.find(index);
    if (record == records.end()) return false;
    out = record->second;
    return true;
}

template <class Record>
bool handOut(const std::optional<Record>& record, Record& out) {
    if (record.has_value()) out = *record;
    return record.has_value();
}

}  // namespace

class TarnPlayer::Engine {
public:
    explicit Engine(std::shared_ptr<ScriptedEngine> engine) : script(std::move(engine)) {}
    ~Engine() { script->playerGone(); }

    template <class... Arguments>
    status_t status(const char* operation, const Arguments&... arguments) {
        return script->call(operation, join(arguments...), NO_ERROR);
    }
    template <class... Arguments>
    bool flag(const char* operation, const Arguments&... arguments) {
        return script->call(operation, join(arguments...), true) != 0;
    }
    // For an operation whose success depends on whether it had a record.
    template <class... Arguments>
    bool recordFlag(bool found, const char* operation, const Arguments&... arguments) {
        return script->call(operation, join(arguments...), found) != 0;
    }
    status_t valueStatus(const char* operation, int* out) {
        script->writeOut(operation, out);
        return status(operation);
    }
    bool valueFlag(const char* operation, int& out) {
        script->writeOut(operation, &out);
        return flag(operation);
    }
    template <class... Arguments>
    status_t replyStatus(const char* operation, Parcel* reply, const Arguments&... arguments) {
        script->writeReply(operation, reply);
        return status(operation, arguments...);
    }

    const std::shared_ptr<ScriptedEngine> script;
};

TarnPlayer::TarnPlayer(int decoder) : mEngine(new Engine(ScriptedEngine::make(this, decoder))) {}
TarnPlayer::~TarnPlayer() = default;

void TarnPlayer::configPlayer(bool ssif) { mEngine->status("configPlayer", ssif); }

status_t TarnPlayer::setDataSource(const char* url, const KeyedVector<String8, String8>* headers) {
    return mEngine->status("setDataSource", url, headers);
}
status_t TarnPlayer::setDataSource(IOrvStreamSource* source) {
    if (mEngine->script->takeStream) mEngine->script->takeStream(source);
    return mEngine->status("setDataSource", static_cast<const void*>(source));
}
status_t TarnPlayer::setDataSource(int fd, int64_t offset, int64_t length) {
    return mEngine->status("setDataSource", fd, offset, length);
}

status_t TarnPlayer::setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) {
    return mEngine->status("setVideoSurfaceTexture",
                           static_cast<const void*>(bufferProducer.get()));
}
status_t TarnPlayer::prepare() { return mEngine->status("prepare"); }
status_t TarnPlayer::prepareAsync() { return mEngine->status("prepareAsync"); }
status_t TarnPlayer::start() { return mEngine->status("start"); }
status_t TarnPlayer::stop() { return mEngine->status("stop"); }
status_t TarnPlayer::pause() { return mEngine->status("pause"); }
bool TarnPlayer::isPlaying() { return mEngine->flag("isPlaying"); }
status_t TarnPlayer::seekTo(int msec, int mode) { return mEngine->status("seekTo", msec, mode); }
status_t TarnPlayer::getCurrentPosition(int* msec) {
    return mEngine->valueStatus("getCurrentPosition", msec);
}
status_t TarnPlayer::getDuration(int* msec) { return mEngine->valueStatus("getDuration", msec); }
status_t TarnPlayer::reset() { return mEngine->status("reset"); }
status_t TarnPlayer::setLooping(int loop) { return mEngine->status("setLooping", loop); }
status_t TarnPlayer::setParameter(int key, const Parcel& request) {
    return mEngine->status("setParameter", key, request);
}
status_t TarnPlayer::getParameter(int key, Parcel* reply) {
    return mEngine->replyStatus("getParameter", reply, key);
}
status_t TarnPlayer::invoke(const Parcel& request, Parcel* reply) {
    return mEngine->replyStatus("invoke", reply, request);
}
status_t TarnPlayer::getMetadata(const SortedVector<int>& ids, Parcel* records) {
    return mEngine->replyStatus("getMetadata", records, ids);
}
status_t TarnPlayer::setVolume(float left, float right) {
    return mEngine->status("setVolume", left, right);
}
status_t TarnPlayer::release() { return mEngine->status("release"); }

status_t TarnPlayer::getVideoWidth(int* w) { return mEngine->valueStatus("getVideoWidth", w); }
status_t TarnPlayer::getVideoHeight(int* h) { return mEngine->valueStatus("getVideoHeight", h); }
status_t TarnPlayer::getCurrentBytePosition(int* pos) {
    return mEngine->valueStatus("getCurrentBytePosition", pos);
}

bool TarnPlayer::canDoSeek(int speed) { return mEngine->flag("canDoSeek", speed); }
bool TarnPlayer::canDoTrick(int speed) { return mEngine->flag("canDoTrick", speed); }
bool TarnPlayer::setTS(unsigned short ts) { return mEngine->flag("setTS", ts); }
bool TarnPlayer::step(int amount) { return mEngine->flag("step", amount); }
status_t TarnPlayer::setSpeed(int speed) { return mEngine->status("setSpeed", speed); }
bool TarnPlayer::getSpeed(int& speed) { return mEngine->valueFlag("getSpeed", speed); }
int TarnPlayer::setABRepeat(int type) { return mEngine->status("setABRepeat", type); }
bool TarnPlayer::seekToPosition(unsigned long long pos) {
    return mEngine->flag("seekToPosition", pos);
}
int TarnPlayer::getBufferPercent() { return mEngine->status("getBufferPercent"); }

bool TarnPlayer::getThumbnailInfo(_Media_Thumbnail_Info_T* thumbnail) {
    ScriptedEngine& script = *mEngine->script;
    if (thumbnail == nullptr) return mEngine->flag("getThumbnailInfo", "null");
    script.keep(script.receivedThumbnails, *thumbnail);
    if (script.drawThumbnail) script.drawThumbnail(thumbnail);
    return mEngine->flag("getThumbnailInfo", thumbnail->u4BufferSize, thumbnail->i4CanvasColormode,
                         thumbnail->i4Width, thumbnail->i4Height);
}

MediaAlbumArt* TarnPlayer::extractAlbumArt() {
    mEngine->status("extractAlbumArt");
    const auto& bytes = mEngine->script->albumArt;
    if (!bytes.has_value()) return nullptr;
    auto* art = static_cast<MediaAlbumArt*>(malloc(sizeof(MediaAlbumArt) + bytes->size()));
    art->mSize = static_cast<uint32_t>(bytes->size());
    std::copy(bytes->begin(), bytes->end(), art->data());
    return art;
}

bool TarnPlayer::getMetaDataInfo(MetaDataInfo& info) {
    mEngine->script->keep(mEngine->script->receivedMetaDataInfos, info);
    const bool found = handOut(mEngine->script->metaDataInfo, info);
    return mEngine->recordFlag(found, "getMetaDataInfo");
}

bool TarnPlayer::getVideoCodecInfo(VideoCodecInfo& info) {
    const bool found = handOut(mEngine->script->currentVideoCodec, info);
    return mEngine->recordFlag(found, "getVideoCodecInfo");
}
bool TarnPlayer::getVideoCodecInfo(int index, VideoCodecInfo& info) {
    const bool found = handOut(mEngine->script->videoCodecs, index, info);
    return mEngine->recordFlag(found, "getVideoCodecInfo", index);
}
bool TarnPlayer::getVideoTrackCount(int& count) {
    return mEngine->valueFlag("getVideoTrackCount", count);
}
bool TarnPlayer::getAudioTrackCount(int& count) {
    return mEngine->valueFlag("getAudioTrackCount", count);
}
bool TarnPlayer::getAudioTrackInfo(bool flag, int index, AudioTrackInfo& info) {
    mEngine->script->keep(mEngine->script->receivedAudioTracks, info);
    const bool found = handOut(mEngine->script->audioTracks, index, info);
    return mEngine->recordFlag(found, "getAudioTrackInfo", flag, index);
}
bool TarnPlayer::selectAudioTrack(int index) { return mEngine->flag("selectAudioTrack", index); }
status_t TarnPlayer::getCurrentAudioIndex(int* index) {
    return mEngine->valueStatus("getCurrentAudioIndex", index);
}

bool TarnPlayer::getSubtitleTrackCount(int& count) {
    return mEngine->valueFlag("getSubtitleTrackCount", count);
}
bool TarnPlayer::getSubtitleTrackInfo(int index, SubtitleTrackInfo& info) {
    mEngine->script->keep(mEngine->script->receivedSubtitleTracks, info);
    const bool found = handOut(mEngine->script->subtitleTracks, index, info);
    return mEngine->recordFlag(found, "getSubtitleTrackInfo", index);
}
status_t TarnPlayer::getCurrentSubtitleIndex(int* index) {
    return mEngine->valueStatus("getCurrentSubtitleIndex", index);
}
bool TarnPlayer::onSubtitleTrack(int index) { return mEngine->flag("onSubtitleTrack", index); }
bool TarnPlayer::offSubtitleTrack() { return mEngine->flag("offSubtitleTrack"); }
bool TarnPlayer::selectTrack(int index) { return mEngine->flag("selectTrack", index); }
bool TarnPlayer::deselectTrack(int index) { return mEngine->flag("deselectTrack", index); }
bool TarnPlayer::addTimedTextSource(const char* path) {
    return mEngine->flag("addTimedTextSource", path);
}
bool TarnPlayer::setSubtitleDataSource(const char* url) {
    return mEngine->flag("setSubtitleDataSource", url);
}
bool TarnPlayer::setSubtitleDataSourceEx(const char* sub, const char* idx) {
    return mEngine->flag("setSubtitleDataSourceEx", sub, idx);
}
bool TarnPlayer::setSubtitleAttr(int type, void* attr) {
    return mEngine->flag("setSubtitleAttr", type, attributeText(type, attr).c_str());
}
bool TarnPlayer::flushSubtitleAttr() { return mEngine->flag("flushSubtitleAttr"); }

status_t TarnPlayer::setPlayerRole(E_Orv_Player_Role_Type role) {
    return mEngine->status("setPlayerRole", int{role});
}
status_t TarnPlayer::setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T* info) {
    if (info != nullptr) mEngine->script->keep(mEngine->script->receivedPcmInfos, *info);
    return mEngine->status("setPCMMediaInfo");
}
void TarnPlayer::setPcmFlag() { mEngine->status("setPcmFlag"); }
status_t TarnPlayer::setUnLockPin(int pin) { return mEngine->status("setUnLockPin", pin); }

}  // namespace android
