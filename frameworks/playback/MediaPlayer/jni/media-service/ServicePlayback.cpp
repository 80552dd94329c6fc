// SPDX-License-Identifier: Apache-2.0
// Data sources and the classic playback operations of the service.

#include <string.h>
#include <strings.h>

#include "jni/media-service/OrvMediaService.h"
#include "jni/media-service/ServiceLog.h"

namespace android {

namespace {

bool isStereoscopicFile(const char* url) {
    const char kSuffix[] = ".ssif";
    const size_t suffixLength = sizeof(kSuffix) - 1;
    const size_t length = strlen(url);
    return url[0] == '/' && length >= suffixLength &&
           strcasecmp(url + length - suffixLength, kSuffix) == 0;
}

}  // namespace

status_t OrvMediaService::setDataSource(const char* url,
                                        const KeyedVector<String8, String8>* headers) {
    if (url == nullptr) {
        ALOGE("OrvMediaService::setDataSource(url, headers): url=null");
        return NO_INIT;
    }
    ALOGI("OrvMediaService::setDataSource(%s)", url);
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setDataSource(url, headers): NO_INIT");
        return NO_INIT;
    }
    mPlayer->configPlayer(false);
    if (isStereoscopicFile(url)) mPlayer->configPlayer(true);
    sServiceFlag = true;
    return mPlayer->setDataSource(url, headers);
}

status_t OrvMediaService::setDataSource(int fd, int64_t offset, int64_t length) {
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setDataSource(fd, offset, length): NO_INIT");
        return NO_INIT;
    }
    sServiceFlag = true;
    return mPlayer->setDataSource(fd, offset, length);
}

status_t OrvMediaService::setDataSource(IStreamSource*) {
    ALOGI("OrvMediaService::setDataSource(): not implement");
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setDataSource(IStreamSource): NO_INIT");
        return NO_INIT;
    }
    sServiceFlag = true;
    return NO_ERROR;
}

status_t OrvMediaService::setDataSource(IOrvStreamSource* source) {
    ALOGI("OrvMediaService::setDataSource(IOrvStreamSource):");
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setDataSource(IOrvStreamSource): NO_INIT");
        return NO_INIT;
    }
    sServiceFlag = true;
    return mPlayer->setDataSource(source);
}

status_t OrvMediaService::setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::setVideoSurfaceTexture, bufferProducer);
}

status_t OrvMediaService::prepare() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::prepare);
}

status_t OrvMediaService::prepareAsync() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::prepareAsync);
}

status_t OrvMediaService::start() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::start);
}

status_t OrvMediaService::stop() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::stop);
}

status_t OrvMediaService::pause() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::pause);
}

status_t OrvMediaService::reset() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::reset);
}

status_t OrvMediaService::release() {
    logEntry(__func__);
    return forward(__func__, NO_INIT, &TarnPlayer::release);
}

bool OrvMediaService::isPlaying() {
    logEntry(__func__);
    return forward(__func__, true, &TarnPlayer::isPlaying);
}

status_t OrvMediaService::seekTo(int msec, MediaTrack::ReadOptions::SeekMode) {
    ALOGI("OrvMediaService::seekTo(%d)", msec);
    return forward(__func__, NO_INIT, &TarnPlayer::seekTo, msec,
                   MediaTrack::ReadOptions::SEEK_PREVIOUS_SYNC);
}

status_t OrvMediaService::getCurrentPosition(int* msec) {
    return forward(__func__, NO_INIT, &TarnPlayer::getCurrentPosition, msec);
}

status_t OrvMediaService::getDuration(int* msec) {
    logEntry(__func__);
    if (!hasPlayer(__func__)) return NO_INIT;
    int duration = 0;
    const status_t status = mPlayer->getDuration(&duration);
    *msec = duration;
    ALOGE("OrvMediaService::getDuration(): %d", duration);  // at error priority, always
    return status;
}

status_t OrvMediaService::getVideoWidth(int* w) {
    ALOGI("OrvMediaService::getVideoWidth(): occur");
    return forward(__func__, NO_INIT, &TarnPlayer::getVideoWidth, w);
}

status_t OrvMediaService::getVideoHeight(int* h) {
    ALOGI("OrvMediaService::getVideoHeight(): occur");
    return forward(__func__, NO_INIT, &TarnPlayer::getVideoHeight, h);
}

status_t OrvMediaService::setLooping(int loop) {
    ALOGI("OrvMediaService::setLooping(%d)", loop);
    mLoop = loop != 0;
    if (mPlayer == nullptr) return NO_ERROR;
    return mPlayer->setLooping(loop);
}

bool OrvMediaService::isLooping() {
    logEntry(__func__);
    if (mPlayer == nullptr) {
        ALOGI("OrvMediaService::isLooping(): no active player");
        return false;
    }
    return mLoop;
}

status_t OrvMediaService::setVolume(float left, float right) {
    ALOGI("OrvMediaService::setVolume(%f, %f)", left, right);
    if (mPlayer == nullptr) {
        ALOGE("setVolume(): NO_INIT");
        return NO_INIT;
    }
    return mPlayer->setVolume(left, right);
}

status_t OrvMediaService::setAudioStreamType(int type) {
    logEntry(__func__);
    if (!hasPlayer(__func__)) return NO_INIT;
    if (mStreamType != type) mStreamType = type;
    return NO_ERROR;
}

status_t OrvMediaService::setAudioSessionId(int id) {
    ALOGI("OrvMediaService::setAudioSessionId(%d), not implement", id);
    if (id < 0) return BAD_VALUE;
    mAudioSessionId = id;
    return NO_ERROR;
}

int OrvMediaService::getAudioSessionId() {
    ALOGI("OrvMediaService::getAudioSessionId(), not implement");
    return mAudioSessionId;
}

status_t OrvMediaService::setAuxEffectSendLevel(float level) {
    ALOGI("OrvMediaService::setAuxEffectSendLevel(%f), not implement", level);
    return NO_ERROR;
}

status_t OrvMediaService::attachAuxEffect(int effectId) {
    ALOGI("OrvMediaService::attachAuxEffect(%d), not implement", effectId);
    return NO_ERROR;
}

status_t OrvMediaService::setParameter(int key, const Parcel& request) {
    ALOGI("OrvMediaService::setParameter(%d)", key);
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::setParameter(int, Parcel): NO_INIT");
        return NO_INIT;
    }
    return mPlayer->setParameter(key, request);
}

status_t OrvMediaService::getParameter(int key, Parcel* reply) {
    ALOGI("OrvMediaService::getParameter(%d)", key);
    if (mPlayer == nullptr) {
        ALOGE("OrvMediaService::getParameter(int, Parcel): NO_INIT");
        return NO_INIT;
    }
    return mPlayer->getParameter(key, reply);
}

}  // namespace android
