// SPDX-License-Identifier: Apache-2.0
#define LOG_TAG "TarnPlayer"
#include <log/log.h>
#include <orvtarn/TarnPlayer.h>

namespace android {
namespace {

// For operations that the engine does not carry out yet.
status_t notYet(const char* operation) {
    ALOGE("%s: not available yet", operation);
    return INVALID_OPERATION;
}

}  // namespace

class TarnPlayer::Engine {};

TarnPlayer::TarnPlayer(int) : mEngine(new Engine) {}
TarnPlayer::~TarnPlayer() {}
status_t TarnPlayer::release() { return NO_ERROR; }
void TarnPlayer::configPlayer(bool) {}
void TarnPlayer::setPcmFlag() {}
int TarnPlayer::setABRepeat(int) { return notYet(__func__) == NO_ERROR; }
int TarnPlayer::getBufferPercent() { return 0; }
MediaAlbumArt* TarnPlayer::extractAlbumArt() {
    notYet(__func__);
    return nullptr;
}
status_t TarnPlayer::setDataSource(const char*, const KeyedVector<String8, String8>*) {
    return notYet(__func__);
}
status_t TarnPlayer::setDataSource(IOrvStreamSource*) { return notYet(__func__); }
status_t TarnPlayer::setDataSource(int, int64_t, int64_t) { return notYet(__func__); }
status_t TarnPlayer::setVideoSurfaceTexture(const sp<IGraphicBufferProducer>&) {
    return notYet(__func__);
}
status_t TarnPlayer::prepare() { return notYet(__func__); }
status_t TarnPlayer::prepareAsync() { return notYet(__func__); }
status_t TarnPlayer::start() { return notYet(__func__); }
status_t TarnPlayer::stop() { return notYet(__func__); }
status_t TarnPlayer::pause() { return notYet(__func__); }
bool TarnPlayer::isPlaying() { return notYet(__func__) == NO_ERROR; }
status_t TarnPlayer::seekTo(int, int) { return notYet(__func__); }
status_t TarnPlayer::getCurrentPosition(int*) { return notYet(__func__); }
status_t TarnPlayer::getDuration(int*) { return notYet(__func__); }
status_t TarnPlayer::reset() { return notYet(__func__); }
status_t TarnPlayer::setLooping(int) { return notYet(__func__); }
status_t TarnPlayer::setParameter(int, const Parcel&) { return notYet(__func__); }
status_t TarnPlayer::getParameter(int, Parcel*) { return notYet(__func__); }
status_t TarnPlayer::invoke(const Parcel&, Parcel*) { return notYet(__func__); }
status_t TarnPlayer::getMetadata(const SortedVector<int>&, Parcel*) { return notYet(__func__); }
status_t TarnPlayer::setVolume(float, float) { return notYet(__func__); }
status_t TarnPlayer::getVideoWidth(int*) { return notYet(__func__); }
status_t TarnPlayer::getVideoHeight(int*) { return notYet(__func__); }
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
