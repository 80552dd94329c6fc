// SPDX-License-Identifier: Apache-2.0
// The service's life, its wiring, its events and its guard.

#include "jni/media-service/OrvMediaService.h"

#include "jni/media-service/ServiceLog.h"

namespace android {

os::Relaxed<bool> OrvMediaService::sServiceFlag;
os::Relaxed<uint64_t> OrvMediaService::sNotifyCookie;

OrvMediaService::OrvMediaService()
    : mStreamType(3),  // music
      mAudioSessionId(0),
      mLoop(false),
      mSpeed(0) {
    ALOGI("OrvMediaService::OrvMediaService()");
    mEngineListener = new Listener();
    sServiceFlag = true;
}

OrvMediaService::~OrvMediaService() {
    ALOGI("OrvMediaService::~OrvMediaService()");
    sServiceFlag = false;
    if (mPlayer != nullptr) {
        ALOGI("setNotifyCallback");
        mPlayer->setNotifyCallback(nullptr);
    }
    mPlayer.clear();
}

status_t OrvMediaService::attachPlayer(const sp<TarnPlayer>& player) {
    ALOGI("OrvMediaService::attachPlayer(player)");
    mPlayer = player;
    sNotifyCookie = reinterpret_cast<uintptr_t>(this);
    mPlayer->setNotifyCallback(mEngineListener);
    return NO_ERROR;
}

bool OrvMediaService::isPlayerExists() { return mPlayer != nullptr; }

void OrvMediaService::disconnect() { logEntry(__func__); }

status_t OrvMediaService::setListener(const sp<OrvMediaServiceListener>& listener) {
    logEntry(__func__);
    mListener = listener;
    sNotifyCookie = listener != nullptr ? reinterpret_cast<uintptr_t>(this) : 0;
    return NO_ERROR;
}

bool OrvMediaService::hasPlayer(const char* operation) {
    if (mPlayer != nullptr) return true;
    ALOGE("OrvMediaService::%s(): NO_INIT", operation);
    return false;
}

void OrvMediaService::Listener::notify(int, int, int, const Parcel*) {}

namespace {

void logEvent(const OrvMediaService* service, int msg, int ext1, int ext2) {
    switch (msg) {
        case MEDIA_NOP:
            break;
        case MEDIA_PREPARED:
            ALOGI("MEDIA_PREPARED, this=%p, prepared", service);
            break;
        case MEDIA_PLAYBACK_COMPLETE:
            ALOGI("MEDIA_PLAYBACK_COMPLETE, this=%p, playback complete", service);
            break;
        case MEDIA_BUFFERING_UPDATE:
            ALOGI(" MEDIA_BUFFERING_UPDATE, this=%p, buffering %d", service, ext1);
            break;
        case MEDIA_SEEK_COMPLETE:
            ALOGI(" MEDIA_SEEK_COMPLETE, this=%p, Received seek complete", service);
            break;
        case MEDIA_SET_VIDEO_SIZE:
            ALOGI(" MEDIA_SET_VIDEO_SIZE, this=%p, New video size %d x %d", service, ext1, ext2);
            break;
        case MEDIA_TIMED_TEXT:
            ALOGI(" MEDIA_TIMED_TEXT, this=%p, Received timed text message", service);
            break;
        case MEDIA_ERROR:
            ALOGE("MEDIA_ERROR, this=%p, error (%d, %d)", service, ext1, ext2);
            break;
        case MEDIA_INFO:
            // A lagging video track would flood the log.
            if (ext1 != MEDIA_INFO_VIDEO_TRACK_LAGGING) {
                ALOGW(" MEDIA_INFO, this=%p, info/warning (%d, %d)", service, ext1, ext2);
            }
            break;
        default:
            ALOGI(" default, this=%p, unrecognized message: (%d, %d, %d)", service, msg, ext1,
                  ext2);
            break;
    }
}

}  // namespace

void OrvMediaService::notify(int msg, int ext1, int ext2, const Parcel* obj) {
    logEvent(this, msg, ext1, ext2);
    sp<OrvMediaServiceListener> listener = mListener;
    if (listener == nullptr) return;
    ALOGI(" this=%p, callback application", this);
    listener->notify(msg, ext1, ext2, obj);
    ALOGI(" this=%p, back from callback", this);
}

void OrvMediaService::died() {
    ALOGI("OrvMediaService::died(): died");
    if (sNotifyCookie == 0) {
        ALOGD("OrvMediaService Issue Handle. Line:%d", 1192);
        return;
    }
    notify(MEDIA_ERROR, MEDIA_ERROR_SERVER_DIED, 0, nullptr);
}

}  // namespace android
