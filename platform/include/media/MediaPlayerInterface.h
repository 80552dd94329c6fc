// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>
#include <utils/Mutex.h>
#include <utils/RefBase.h>
#include <utils/SortedVector.h>

namespace android {

class IGraphicBufferProducer;
class Parcel;

// Message codes a player sends to its listener.
enum media_event_type {
    MEDIA_NOP = 0,
    MEDIA_PREPARED = 1,
    MEDIA_PLAYBACK_COMPLETE = 2,
    MEDIA_BUFFERING_UPDATE = 3,
    MEDIA_SEEK_COMPLETE = 4,
    MEDIA_SET_VIDEO_SIZE = 5,
    MEDIA_TIMED_TEXT = 99,
    MEDIA_ERROR = 100,
    MEDIA_INFO = 200,
};

// First argument of MEDIA_ERROR.
enum media_error_type {
    MEDIA_ERROR_UNKNOWN = 1,
    MEDIA_ERROR_SERVER_DIED = 100,
};

// First argument of MEDIA_INFO.
enum media_info_type {
    MEDIA_INFO_UNKNOWN = 1,
    MEDIA_INFO_RENDERING_START = 3,
    MEDIA_INFO_VIDEO_TRACK_LAGGING = 700,
    MEDIA_INFO_BUFFERING_START = 701,
    MEDIA_INFO_BUFFERING_END = 702,
    MEDIA_INFO_NOT_SEEKABLE = 801,
};

// The base of every playback engine. Times are milliseconds, volumes linear
// gains from 0 to 1. The virtual operations stand in the order of their slots:
// engines are separate libraries, so the order is an ABI.
class MediaPlayerBase : public RefBase {
public:
    // Receives the engine's events, on a thread of the engine.
    class Listener : public RefBase {
    public:
        virtual void notify(int msg, int ext1, int ext2, const Parcel* obj) = 0;
    };

    virtual status_t setDataSource(int fd, int64_t offset, int64_t length) = 0;
    virtual status_t setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) = 0;
    virtual status_t prepare() = 0;
    virtual status_t prepareAsync() = 0;
    virtual status_t start() = 0;
    virtual status_t stop() = 0;
    virtual status_t pause() = 0;
    virtual bool isPlaying() = 0;
    virtual status_t seekTo(int msec, int mode) = 0;
    virtual status_t getCurrentPosition(int* msec) = 0;
    virtual status_t getDuration(int* msec) = 0;
    virtual status_t reset() = 0;
    virtual status_t setLooping(int loop) = 0;
    virtual status_t setParameter(int key, const Parcel& request) = 0;
    virtual status_t getParameter(int key, Parcel* reply) = 0;
    virtual status_t invoke(const Parcel& request, Parcel* reply) = 0;
    virtual status_t getMetadata(const SortedVector<int>& ids, Parcel* records) = 0;
    virtual status_t setVolume(float left, float right) = 0;
    virtual status_t release() = 0;

    // Installs the receiver of this player's events; null for none. When it
    // returns, a delivery to the earlier listener may still be under way.
    void setNotifyCallback(const sp<Listener>& listener) {
        Mutex::Autolock lock(mNotifyLock);
        mListener = listener;
    }

protected:
    // Delivers one event on the calling thread, outside the notify lock, so
    // that a listener may install another one.
    void sendEvent(int msg, int ext1 = 0, int ext2 = 0, const Parcel* obj = nullptr) {
        sp<Listener> listener;
        {
            Mutex::Autolock lock(mNotifyLock);
            listener = mListener;
        }
        if (listener != nullptr) listener->notify(msg, ext1, ext2, obj);
    }

private:
    Mutex mNotifyLock;
    sp<Listener> mListener;
};

}  // namespace android
