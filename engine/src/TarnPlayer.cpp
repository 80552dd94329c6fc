// SPDX-License-Identifier: Apache-2.0
#include <orvtarn/TarnPlayer.h>

#include "Engine.h"

// Every operation passes the engine's gate and goes to the unit that knows it.

namespace android {
namespace {

// For operations that the engine does not carry out yet.
status_t notYet(const char* operation) {
    ALOGE("%s: not available yet", operation);
    return INVALID_OPERATION;
}

orvtarn::RequestHeaders pairsOf(const KeyedVector<String8, String8>* headers) {
    orvtarn::RequestHeaders pairs;
    for (size_t i = 0; headers != nullptr && i < headers->size(); i++) {
        pairs.emplace_back(headers->keyAt(i).string(), headers->valueAt(i).string());
    }
    return pairs;
}

}  // namespace

TarnPlayer::TarnPlayer(int decoder)
    : mEngine(new Engine(decoder,
                         [this](int msg, int ext1, int ext2) { sendEvent(msg, ext1, ext2); })) {}

TarnPlayer::~TarnPlayer() {}

status_t TarnPlayer::release() {
    mEngine->release();
    return NO_ERROR;
}
void TarnPlayer::configPlayer(bool) {}
void TarnPlayer::setPcmFlag() {}
int TarnPlayer::setABRepeat(int) { return notYet(__func__) == NO_ERROR; }
int TarnPlayer::getBufferPercent() {
    return mEngine->call(__func__, 0, [&] { return mEngine->transport.bufferPercent(); });
}

MediaAlbumArt* TarnPlayer::extractAlbumArt() {
    notYet(__func__);
    return nullptr;
}
status_t TarnPlayer::setDataSource(const char* url, const KeyedVector<String8, String8>* headers) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->loader.setUrl(url, pairsOf(headers)); });
}

status_t TarnPlayer::setDataSource(IOrvStreamSource* source) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->loader.setStream(source); });
}

status_t TarnPlayer::setDataSource(int fd, int64_t offset, int64_t length) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->loader.setFd(fd, offset, length); });
}

status_t TarnPlayer::setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION}, [&] {
        mEngine->video.setProducer(bufferProducer);
        return status_t{NO_ERROR};
    });
}

status_t TarnPlayer::prepare() {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->loader.prepare(); });
}

status_t TarnPlayer::prepareAsync() {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->loader.prepareAsync(); });
}

status_t TarnPlayer::start() {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.start(); });
}

status_t TarnPlayer::stop() {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->loader.stop(); });
}

status_t TarnPlayer::pause() {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.pause(); });
}

bool TarnPlayer::isPlaying() {
    return mEngine->call(__func__, false, [&] { return mEngine->transport.isPlaying(); });
}

status_t TarnPlayer::seekTo(int msec, int mode) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->seeker.seekTo(msec, mode); });
}

status_t TarnPlayer::getCurrentPosition(int* msec) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.getCurrentPosition(msec); });
}

status_t TarnPlayer::getDuration(int* msec) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.getDuration(msec); });
}

status_t TarnPlayer::reset() {
    return mEngine->call(__func__, status_t{INVALID_OPERATION}, [&] {
        mEngine->loader.reset();
        return status_t{NO_ERROR};
    });
}

status_t TarnPlayer::setLooping(int loop) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.setLooping(loop != 0); });
}

status_t TarnPlayer::setParameter(int, const Parcel&) { return notYet(__func__); }
status_t TarnPlayer::getParameter(int, Parcel*) { return notYet(__func__); }
status_t TarnPlayer::invoke(const Parcel&, Parcel*) { return notYet(__func__); }
status_t TarnPlayer::getMetadata(const SortedVector<int>&, Parcel*) { return notYet(__func__); }
status_t TarnPlayer::setVolume(float, float) { return notYet(__func__); }
status_t TarnPlayer::getVideoWidth(int* w) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.getVideoWidth(w); });
}

status_t TarnPlayer::getVideoHeight(int* h) {
    return mEngine->call(__func__, status_t{INVALID_OPERATION},
                         [&] { return mEngine->transport.getVideoHeight(h); });
}

status_t TarnPlayer::getCurrentBytePosition(int*) { return notYet(__func__); }
bool TarnPlayer::canDoSeek(int) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::canDoTrick(int) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::setTS(unsigned short) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::step(int) { return notYet(__func__) == NO_ERROR; }
status_t TarnPlayer::setSpeed(int) { return notYet(__func__); }
bool TarnPlayer::getSpeed(int&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::seekToPosition(unsigned long long) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getThumbnailInfo(_Media_Thumbnail_Info_T*) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getMetaDataInfo(MetaDataInfo&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getVideoCodecInfo(VideoCodecInfo&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getVideoCodecInfo(int, VideoCodecInfo&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getVideoTrackCount(int&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getAudioTrackCount(int&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getAudioTrackInfo(bool, int, AudioTrackInfo&) {
    return notYet(__func__) == NO_ERROR;
}
bool TarnPlayer::selectAudioTrack(int) { return notYet(__func__) == NO_ERROR; }
status_t TarnPlayer::getCurrentAudioIndex(int*) { return notYet(__func__); }
bool TarnPlayer::getSubtitleTrackCount(int&) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::getSubtitleTrackInfo(int, SubtitleTrackInfo&) {
    return notYet(__func__) == NO_ERROR;
}
status_t TarnPlayer::getCurrentSubtitleIndex(int*) { return notYet(__func__); }
bool TarnPlayer::onSubtitleTrack(int) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::offSubtitleTrack() { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::selectTrack(int) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::deselectTrack(int) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::addTimedTextSource(const char*) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::setSubtitleDataSource(const char*) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::setSubtitleDataSourceEx(const char*, const char*) {
    return notYet(__func__) == NO_ERROR;
}
bool TarnPlayer::setSubtitleAttr(int, void*) { return notYet(__func__) == NO_ERROR; }
bool TarnPlayer::flushSubtitleAttr() { return notYet(__func__) == NO_ERROR; }
status_t TarnPlayer::setPlayerRole(E_Orv_Player_Role_Type) { return notYet(__func__); }
status_t TarnPlayer::setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T*) { return notYet(__func__); }
status_t TarnPlayer::setUnLockPin(int) { return notYet(__func__); }

}  // namespace android
