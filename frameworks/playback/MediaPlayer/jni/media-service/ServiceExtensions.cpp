// SPDX-License-Identifier: Apache-2.0
// The television player's extras: speed, positions, tracks, subtitles,
// pictures, PCM.

#include "jni/media-service/OrvMediaService.h"
#include "jni/media-service/ServiceLog.h"

namespace android {

status_t OrvMediaService::setSpeed(int speed) {
    ALOGI("OrvMediaService::setSpeed(%d)", speed);
    if (!hasPlayer(__func__)) return UNKNOWN_ERROR;
    mSpeed = speed;
    return mPlayer->setSpeed(speed);
}

bool OrvMediaService::getSpeed(int& speed) {
    logEntry(__func__);
    return forward(__func__, true, &TarnPlayer::getSpeed, speed);
}

bool OrvMediaService::canDoSeek(int speed) {
    ALOGI("OrvMediaService::canDoSeek(%d)", speed);
    return forward(__func__, true, &TarnPlayer::canDoSeek, speed);
}

bool OrvMediaService::canDoTrick(int speed) {
    ALOGI("OrvMediaService::canDoTrick(%d)", speed);
    return forward(__func__, true, &TarnPlayer::canDoTrick, speed);
}

bool OrvMediaService::step(int amount) {
    ALOGI("OrvMediaService::step in");
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::step(): amount = %d", amount);
        return true;
    }
    return mPlayer->step(amount);
}

bool OrvMediaService::setTS(uint16_t ts) {
    ALOGI("OrvMediaService::setTS(%d)", ts);
    return forward(__func__, true, &TarnPlayer::setTS, ts);
}

status_t OrvMediaService::getCurrentBytePosition(int* pos) {
    return forward(__func__, NO_INIT, &TarnPlayer::getCurrentBytePosition, pos);
}

bool OrvMediaService::seekToPosition(long pos) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::seekToPosition,
                   static_cast<unsigned long long>(pos));
}

int OrvMediaService::getBufferPercent() {
    logEntry(__func__);
    return forward(__func__, 0, &TarnPlayer::getBufferPercent);
}

int OrvMediaService::setABRepeat(int type) {
    ALOGI("OrvMediaService::setABRepeat type (%d)", type);
    return mPlayer->setABRepeat(type);  // unguarded: callers attach a player first
}

status_t OrvMediaService::setPlayerRole(E_Orv_Player_Role_Type role) {
    logEntry(__func__);
    if (mPlayer == nullptr) {
        // No status of its own: whatever the log answers.
        return __android_log_print(ANDROID_LOG_ERROR, LOG_TAG,
                                   "OrvMediaService::setPlayerRole(): NO_INIT");
    }
    return mPlayer->setPlayerRole(role);
}

status_t OrvMediaService::setUnLockPin(int pin) {
    ALOGI("OrvMediaService::setUnLockPin(): occur");
    return forward(__func__, NO_INIT, &TarnPlayer::setUnLockPin, pin);
}

bool OrvMediaService::ServiceSendCliCommand(unsigned char* cmd, int) {
    ALOGI("OrvMediaService::mString(%s)", reinterpret_cast<const char*>(cmd));
    return true;
}

bool OrvMediaService::getVideoCodecInfo(VideoCodecInfo& info) {
    logEntry(__func__);
    if (!hasPlayer(__func__)) return false;
    return mPlayer->getVideoCodecInfo(info);
}

bool OrvMediaService::getVideoCodecInfo(int index, VideoCodecInfo& info) {
    logEntry(__func__);
    if (!hasPlayer(__func__)) return false;
    return mPlayer->getVideoCodecInfo(index, info);
}

bool OrvMediaService::getAudioTrackInfo(bool flag, int index, AudioTrackInfo& info) {
    ALOGI("OrvMediaService::getAudioTrackInfo(%d)", flag);
    return forward(__func__, false, &TarnPlayer::getAudioTrackInfo, flag, index, info);
}

bool OrvMediaService::getSubtitleTrackInfo(int index, SubtitleTrackInfo& info) {
    ALOGI("OrvMediaService::getSubtitleTrackInfo(%d)", index);
    return forward(__func__, false, &TarnPlayer::getSubtitleTrackInfo, index, info);
}

bool OrvMediaService::getVideoTrackCount(int& count) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::getVideoTrackCount, count);
}

bool OrvMediaService::getAudioTrackCount(int& count) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::getAudioTrackCount, count);
}

bool OrvMediaService::getSubtitleTrackCount(int& count) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::getSubtitleTrackCount, count);
}

status_t OrvMediaService::getCurrentAudioIndex(int* index) {
    ALOGI("OrvMediaService::getCurrentAudioIndex(): occur");
    return forward(__func__, NO_INIT, &TarnPlayer::getCurrentAudioIndex, index);
}

status_t OrvMediaService::getCurrentSubtitleIndex(int* index) {
    ALOGI("OrvMediaService::getCurrentSubtitleIndex(): occur");
    return forward(__func__, NO_INIT, &TarnPlayer::getCurrentSubtitleIndex, index);
}

bool OrvMediaService::setAudioTrack(int index) {
    ALOGI("OrvMediaService::setAudioTrack(%d)", index);
    return forward(__func__, false, &TarnPlayer::selectAudioTrack, index);
}

bool OrvMediaService::selectTrack(int index) {
    // Both lines carry another name than the operation's.
    ALOGI("OrvMediaService::setSubtitleTrack(%d)", index);
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setSubtitleTrack(): NO_INIT");
        return false;
    }
    return mPlayer->selectTrack(index);
}

bool OrvMediaService::deselectTrack(int index) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::deselectTrack, index);
}

bool OrvMediaService::onSubtitleTrack(int index) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::onSubtitleTrack, index);
}

bool OrvMediaService::offSubtitleTrack() {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::offSubtitleTrack);
}

bool OrvMediaService::addTimedTextSource(const char* path) {
    ALOGI("OrvMediaService::addTimedTextSource path (%s)", path);
    ALOGI("OrvMediaService::addTimedTextSource path Test %s %d\n",
          "proprietary_tv/open/frameworks/playback/MediaPlayer/jni/media-service/OrvMediaService",
          931);
    return mPlayer->addTimedTextSource(path);  // unguarded: callers attach a player first
}

bool OrvMediaService::setSubtitleDataSource(const char* url) {
    logEntry(__func__);
    ALOGI("OrvMediaService::setSubtitleDataSource(): url=%s", url);  // also a null one
    if (url == nullptr) {
        ALOGE("OrvMediaService::setSubtitleDataSource(): url==null, return directly!!!!");
        return false;
    }
    return forward(__func__, false, &TarnPlayer::setSubtitleDataSource, url);
}

bool OrvMediaService::setSubtitleDataSourceEx(const char* url, const char* extra) {
    ALOGI("OrvMediaService::setSubtitleDataSource(): occur");
    return forward(__func__, false, &TarnPlayer::setSubtitleDataSourceEx, url, extra);
}

bool OrvMediaService::setSubtitleAttr(E_Subtitle_Attr_Type type, void* attr) {
    logEntry(__func__);
    if (attr == nullptr) {
        ALOGE("OrvMediaService::setSubtitleAttr(): parameter error");
        return false;
    }
    return forward(__func__, false, &TarnPlayer::setSubtitleAttr, type, attr);
}

bool OrvMediaService::flushSubtitleAttr() {
    ALOGI("OrvMediaService::flushSubtltAttr()");
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::flushSubtltAttr(): NO_INIT");
        return false;
    }
    return mPlayer->flushSubtitleAttr();
}

bool OrvMediaService::getThumbnailInfo(_Media_Thumbnail_Info_T* thumbnail) {
    ALOGI("OrvMediaService::getthumbnailinfo in");
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::getthumbnailinfo(): pThumbnaiInfo");
        return true;
    }
    return mPlayer->getThumbnailInfo(thumbnail);
}

MediaAlbumArt* OrvMediaService::extractAlbumArt() {
    logEntry(__func__);
    return forward(__func__, nullptr, &TarnPlayer::extractAlbumArt);
}

bool OrvMediaService::getMetaDataInfo(MetaDataInfo& info) {
    logEntry(__func__);
    return forward(__func__, false, &TarnPlayer::getMetaDataInfo, info);
}

bool OrvMediaService::setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T* info) {
    logEntry(__func__);
    if (!hasPlayer(__func__)) return false;
    return mPlayer->setPCMMediaInfo(info) == 0;  // a status becomes success
}

void OrvMediaService::setPcmFlag() {
    // Both lines carry another name than the operation's.
    ALOGI("OrvMediaService::ifMP3Media()");
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setPCMMediaInfo(): NO_INIT");
        return;
    }
    mPlayer->setPcmFlag();
}

}  // namespace android
