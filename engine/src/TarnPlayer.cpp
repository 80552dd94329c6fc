// SPDX-License-Identifier: Apache-2.0
#include <orvtarn/TarnPlayer.h>
#include <stream/IOrvStreamSource.h>

#include <memory>
#include <utility>

#include "Engine.h"

// Every operation passes the engine's gate and goes to the unit that knows it.

namespace android {
namespace {

constexpr int kLargestPin = 9999;

orvtarn::RequestHeaders pairsOf(const KeyedVector<String8, String8>* headers) {
    orvtarn::RequestHeaders pairs;
    for (size_t i = 0; headers != nullptr && i < headers->size(); i++) {
        pairs.emplace_back(headers->keyAt(i).c_str(), headers->valueAt(i).c_str());
    }
    return pairs;
}

}  // namespace

TarnPlayer::TarnPlayer(int /*decoder*/)
    : mEngine(new Engine([this](int msg, int ext1, int ext2) { sendEvent(msg, ext1, ext2); })) {}

TarnPlayer::~TarnPlayer() = default;

status_t TarnPlayer::release() {
    mEngine->release();
    return NO_ERROR;
}
// Such files hold a flat picture that plays as it is.
void TarnPlayer::configPlayer(bool ssif) {
    if (ssif) ALOGI("configPlayer: a stereoscopic file plays its flat picture");
}

void TarnPlayer::setPcmFlag() {
    mEngine->status(__func__, [&] { return mEngine->loader.setRaw(); });
}

int TarnPlayer::setABRepeat(int type) {
    return mEngine->call(__func__, int{false}, [&] { return int{mEngine->abRepeat.set(type)}; });
}

int TarnPlayer::getBufferPercent() {
    return mEngine->call(__func__, 0, [&] { return mEngine->transport.bufferPercent(); });
}

MediaAlbumArt* TarnPlayer::extractAlbumArt() {
    return mEngine->call(__func__, static_cast<MediaAlbumArt*>(nullptr),
                         [&] { return mEngine->copyAlbumArt(); });
}

status_t TarnPlayer::setDataSource(const char* url, const KeyedVector<String8, String8>* headers) {
    return mEngine->statusWithCore(__func__,
                                   [&] { return mEngine->loader.setUrl(url, pairsOf(headers)); });
}

status_t TarnPlayer::setDataSource(IOrvStreamSource* source) {
    std::unique_ptr<IOrvStreamSource> taken(source);
    return mEngine->statusWithCore(__func__,
                                   [&] { return mEngine->loader.setStream(std::move(taken)); });
}

status_t TarnPlayer::setDataSource(int fd, int64_t offset, int64_t length) {
    return mEngine->statusWithCore(__func__,
                                   [&] { return mEngine->loader.setFd(fd, offset, length); });
}

status_t TarnPlayer::setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) {
    const auto set = [&] {
        mEngine->video.setProducer(bufferProducer);
        return status_t{NO_ERROR};
    };
    return orvtarn::VideoOutput::hasWindow(bufferProducer) ? mEngine->statusWithCore(__func__, set)
                                                           : mEngine->status(__func__, set);
}

status_t TarnPlayer::prepare() {
    return mEngine->status(__func__, [&] { return mEngine->loader.prepare(); });
}

status_t TarnPlayer::prepareAsync() {
    return mEngine->status(__func__, [&] { return mEngine->loader.prepareAsync(); });
}

status_t TarnPlayer::start() {
    return mEngine->status(__func__, [&] { return mEngine->transport.start(); });
}

status_t TarnPlayer::stop() {
    return mEngine->status(__func__, [&] { return mEngine->loader.stop(); });
}

status_t TarnPlayer::pause() {
    return mEngine->status(__func__, [&] { return mEngine->transport.pause(); });
}

bool TarnPlayer::isPlaying() {
    return mEngine->flag(__func__, [&] { return mEngine->transport.isPlaying(); });
}

status_t TarnPlayer::seekTo(int msec, int mode) {
    return mEngine->status(__func__, [&] { return mEngine->seeker.seekTo(msec, mode); });
}

status_t TarnPlayer::getCurrentPosition(int* msec) {
    return mEngine->status(__func__, [&] { return mEngine->transport.getCurrentPosition(msec); });
}

status_t TarnPlayer::getDuration(int* msec) {
    return mEngine->status(__func__, [&] { return mEngine->transport.getDuration(msec); });
}

status_t TarnPlayer::reset() {
    const status_t status = mEngine->status(__func__, [&] {
        mEngine->loader.reset();
        return status_t{NO_ERROR};
    });
    // Callers give the source up when this returns.
    if (status != NO_ERROR) mEngine->awaitReleased();
    return status;
}

status_t TarnPlayer::setLooping(int loop) {
    return mEngine->status(__func__, [&] { return mEngine->transport.setLooping(loop != 0); });
}

status_t TarnPlayer::setParameter(int key, const Parcel& request) {
    return mEngine->statusWithCore(__func__, [&] { return mEngine->parameters.set(key, request); });
}

status_t TarnPlayer::getParameter(int key, Parcel* reply) {
    return mEngine->statusWithCore(__func__, [&] { return mEngine->parameters.get(key, reply); });
}

status_t TarnPlayer::invoke(const Parcel& request, Parcel* reply) {
    return mEngine->status(__func__, [&] { return mEngine->parameters.invoke(request, reply); });
}

status_t TarnPlayer::getMetadata(const SortedVector<int>& ids, Parcel* records) {
    return mEngine->status(__func__, [&] { return mEngine->metaData.write(ids, records); });
}

status_t TarnPlayer::setVolume(float left, float right) {
    return mEngine->status(__func__, [&] { return mEngine->audio.setVolume(left, right); });
}

status_t TarnPlayer::getVideoWidth(int* w) {
    return mEngine->status(__func__, [&] { return mEngine->transport.getVideoWidth(w); });
}

status_t TarnPlayer::getVideoHeight(int* h) {
    return mEngine->status(__func__, [&] { return mEngine->transport.getVideoHeight(h); });
}

status_t TarnPlayer::getCurrentBytePosition(int* pos) {
    return mEngine->status(__func__, [&] { return mEngine->bytes.get(pos); });
}

bool TarnPlayer::canDoSeek(int speed) {
    return mEngine->flag(__func__, [&] { return mEngine->speed.canSeek(speed); });
}

bool TarnPlayer::canDoTrick(int speed) {
    return mEngine->flag(__func__, [&] { return mEngine->speed.canPlay(speed); });
}

bool TarnPlayer::setTS(unsigned short ts) {
    ALOGE("setTS: %u: transport streams have no such setting here", ts);
    return false;
}

bool TarnPlayer::step(int amount) {
    return mEngine->flag(__func__, [&] { return mEngine->stepper.step(amount); });
}

status_t TarnPlayer::setSpeed(int speed) {
    return mEngine->status(__func__, [&] { return mEngine->speed.set(speed); });
}

bool TarnPlayer::getSpeed(int& speed) {
    return mEngine->flag(__func__, [&] {
        speed = mEngine->speed.get();
        return true;
    });
}

bool TarnPlayer::seekToPosition(unsigned long long pos) {
    return mEngine->flag(__func__, [&] { return mEngine->bytes.seekTo(pos); });
}

bool TarnPlayer::getThumbnailInfo(_Media_Thumbnail_Info_T* thumbnail) {
    return mEngine->flag(__func__, [&] { return mEngine->drawThumbnail(thumbnail); });
}

bool TarnPlayer::getMetaDataInfo(MetaDataInfo& info) {
    return mEngine->flag(__func__, [&] { return mEngine->metaData.get(info); });
}

bool TarnPlayer::getVideoCodecInfo(VideoCodecInfo& info) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.currentVideoInfo(info); });
}

bool TarnPlayer::getVideoCodecInfo(int index, VideoCodecInfo& info) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.videoInfo(index, info); });
}

bool TarnPlayer::getVideoTrackCount(int& count) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.videoCount(count); });
}

bool TarnPlayer::getAudioTrackCount(int& count) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.audioCount(count); });
}

bool TarnPlayer::getAudioTrackInfo(bool flag, int index, AudioTrackInfo& info) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.audioInfo(flag, index, info); });
}

bool TarnPlayer::selectAudioTrack(int index) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.selectAudio(index); });
}

status_t TarnPlayer::getCurrentAudioIndex(int* index) {
    return mEngine->call(__func__, status_t{0},
                         [&] { return status_t{mEngine->tracks.currentAudio(index)}; });
}

bool TarnPlayer::getSubtitleTrackCount(int& count) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.subtitleCount(count); });
}

bool TarnPlayer::getSubtitleTrackInfo(int index, SubtitleTrackInfo& info) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.subtitleInfo(index, info); });
}

status_t TarnPlayer::getCurrentSubtitleIndex(int* index) {
    return mEngine->call(__func__, status_t{0},
                         [&] { return status_t{mEngine->tracks.currentSubtitle(index)}; });
}

bool TarnPlayer::onSubtitleTrack(int index) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.selectSubtitle(index); });
}

bool TarnPlayer::offSubtitleTrack() {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.subtitlesOff(); });
}

bool TarnPlayer::selectTrack(int index) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.select(index); });
}

bool TarnPlayer::deselectTrack(int index) {
    return mEngine->flag(__func__, [&] { return mEngine->tracks.deselect(index); });
}

bool TarnPlayer::addTimedTextSource(const char* path) {
    return mEngine->flag(__func__, [&] {
        return mEngine->subtitles.add("addTimedTextSource", path, false) == NO_ERROR;
    });
}

bool TarnPlayer::setSubtitleDataSource(const char* url) {
    return mEngine->flag(__func__, [&] {
        return mEngine->subtitles.add("setSubtitleDataSource", url, true) == NO_ERROR;
    });
}

bool TarnPlayer::setSubtitleDataSourceEx(const char* sub, const char* idx) {
    return mEngine->flag(__func__,
                         [&] { return mEngine->subtitles.addPair(sub, idx) == NO_ERROR; });
}

bool TarnPlayer::setSubtitleAttr(int type, void* attr) {
    return mEngine->flag(__func__, [&] { return mEngine->subtitles.stage(type, attr); });
}

bool TarnPlayer::flushSubtitleAttr() {
    return mEngine->callWithCore(__func__, false, [&] { return mEngine->subtitles.flush(); });
}

status_t TarnPlayer::setPlayerRole(E_Orv_Player_Role_Type role) {
    return mEngine->status(__func__, [&] { return mEngine->audio.setRole(role); });
}

status_t TarnPlayer::setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T* info) {
    return mEngine->status(__func__, [&] {
        if (info == nullptr) return orvtarn::failed(BAD_VALUE, "setPCMMediaInfo", "null argument");
        return mEngine->loader.setRawFormat("setPCMMediaInfo", *info);
    });
}

status_t TarnPlayer::setUnLockPin(int pin) {
    if (pin < 0 || pin > kLargestPin) {
        return orvtarn::failed(BAD_VALUE, __func__, "a PIN has four digits");
    }
    return orvtarn::failed(INVALID_OPERATION, __func__, "nothing is locked here");
}

}  // namespace android
