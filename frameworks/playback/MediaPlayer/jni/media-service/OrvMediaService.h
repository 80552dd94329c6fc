// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <media/MediaPlayerInterface.h>
#include <media/MediaTrack.h>
#include <orvtarn/TarnPlayer.h>
#include <stdint.h>
#include <utils/KeyedVector.h>
#include <utils/Mutex.h>
#include <utils/RefBase.h>
#include <utils/SortedVector.h>
#include <utils/String8.h>

#include "jni/media-service/OrvMediaServiceListener.h"
#include "os/Export.h"
#include "os/Relaxed.h"

class IOrvStreamSource;

namespace android {

class IGraphicBufferProducer;
struct IStreamSource;
class Parcel;

// The native service of one Java player. It owns one engine player, guards
// every call against a missing one, keeps the settings that the engine does
// not keep, and is the first stop of the engine's events.
//
// Any thread may call any operation; no lock is taken on the way to the engine,
// and a call blocks as long as the engine's does. Statuses are 0 or a negative
// error (NO_INIT without an engine player); bools are true for success, and
// some operations answer true without an engine player, as their definitions
// say. Times are milliseconds.
class ORV_EXPORT OrvMediaService : public virtual RefBase {
public:
    // Handed to the engine player. The engine's events end here.
    class ORV_EXPORT Listener : public MediaPlayerBase::Listener {
    public:
        void notify(int msg, int ext1, int ext2, const Parcel* obj) override;
    };

    OrvMediaService();
    virtual ~OrvMediaService();

    // The player must not be null. Replaces an earlier one. NO_ERROR.
    status_t attachPlayer(const sp<TarnPlayer>& player);
    bool isPlayerExists();
    void disconnect();
    // Null for none. NO_ERROR.
    status_t setListener(const sp<OrvMediaServiceListener>& listener);

    // Logs the event and passes it to the listener, on the calling thread.
    void notify(int msg, int ext1, int ext2, const Parcel* obj);
    // For the platform, when the media server is gone.
    void died();

    status_t setDataSource(const char* url, const KeyedVector<String8, String8>* headers);
    status_t setDataSource(int fd, int64_t offset, int64_t length);
    status_t setDataSource(IStreamSource* source);
    status_t setDataSource(IOrvStreamSource* source);

    status_t setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer);
    status_t prepare();
    status_t prepareAsync();
    status_t start();
    status_t stop();
    status_t pause();
    status_t reset();
    status_t release();
    bool isPlaying();  // true without a player
    // The engine always gets mode 0.
    status_t seekTo(int msec, MediaTrack::ReadOptions::SeekMode mode);
    status_t getCurrentPosition(int* msec);
    // Stores what the engine answered even when it failed.
    status_t getDuration(int* msec);
    status_t getVideoWidth(int* w);
    status_t getVideoHeight(int* h);
    status_t setLooping(int loop);
    bool isLooping();
    status_t setVolume(float left, float right);

    // Kept here; the engine does not get it.
    status_t setAudioStreamType(int type);
    status_t setAudioSessionId(int id);  // BAD_VALUE for a negative id
    int getAudioSessionId();
    status_t setAuxEffectSendLevel(float level);
    status_t attachAuxEffect(int effectId);

    status_t setParameter(int key, const Parcel& request);
    status_t getParameter(int key, Parcel* reply);
    status_t invoke(const Parcel& request, Parcel* reply);

    // Reads an allow set and a block set of metadata types, each a count of 0
    // to 64 and that many 32-bit codes. On a failure both stay as they were.
    status_t setMetadataFilter(const Parcel& filter);
    // Writes -1 for the caller's return code and the engine's records under
    // the platform's metadata header.
    status_t getMetadata(bool update_only, bool apply_filter, Parcel* reply);
    bool shouldDropMetadata(int code) const;
    void addNewMetadataUpdate(int code);

    status_t setSpeed(int speed);
    bool getSpeed(int& speed);
    bool canDoSeek(int speed);
    bool canDoTrick(int speed);
    bool step(int amount);
    bool setTS(uint16_t ts);
    status_t getCurrentBytePosition(int* pos);
    bool seekToPosition(long pos);
    int getBufferPercent();
    int setABRepeat(int type);
    status_t setPlayerRole(E_Orv_Player_Role_Type role);
    status_t setUnLockPin(int pin);
    bool ServiceSendCliCommand(unsigned char* cmd, int len);

    bool getVideoCodecInfo(VideoCodecInfo& info);
    bool getVideoCodecInfo(int index, VideoCodecInfo& info);
    bool getAudioTrackInfo(bool flag, int index, AudioTrackInfo& info);
    bool getSubtitleTrackInfo(int index, SubtitleTrackInfo& info);
    bool getVideoTrackCount(int& count);
    bool getAudioTrackCount(int& count);
    bool getSubtitleTrackCount(int& count);
    status_t getCurrentAudioIndex(int* index);
    status_t getCurrentSubtitleIndex(int* index);
    bool setAudioTrack(int index);
    bool selectTrack(int index);
    bool deselectTrack(int index);
    bool onSubtitleTrack(int index);
    bool offSubtitleTrack();

    bool addTimedTextSource(const char* path);
    bool setSubtitleDataSource(const char* url);
    bool setSubtitleDataSourceEx(const char* url, const char* extra);
    bool setSubtitleAttr(E_Subtitle_Attr_Type type, void* attr);
    bool flushSubtitleAttr();

    bool getThumbnailInfo(_Media_Thumbnail_Info_T* thumbnail);
    // The caller gives the block up with free. Null when there is no picture.
    MediaAlbumArt* extractAlbumArt();
    bool getMetaDataInfo(MetaDataInfo& info);
    bool setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T* info);
    void setPcmFlag();

    // DivX navigation never reaches the engine: with a player every operation
    // fails, and records are left untouched.
    bool getDivxTitleInfo(int title, DivxTitleInfo& info);
    bool getDivxChapInfo(int title, int playlist, int chapter, DivxChapInfo& info);
    bool getDivxPlayListInfo(int title, int playlist, DivxPlayListInfo& info);
    bool getDivxPositionInfo(DivxPositionInfo& info);
    bool getDivxDisplayInfo(int a, int b, int c, int d, int e, DivxDisplayInfo& info);
    bool getDivxLastMemoryFilePosition(DivxLastMemoryFilePosition& position);
    bool getDivxTitleNum(int& count);
    bool getDivxLastMemoryFileID(int& id);
    bool setDivxTitleInfo(int a, int b, int c);
    bool setDivxChapInfo(int a, int b, int c, int d);
    bool setDivxPlayListInfo(int a, int b, int c, int d);
    bool setDivxBtnInfo(int a, int b);
    bool setDivxFilePosition(int a, int b);
    bool setDivxLastMemoryFilePosition(DivxLastMemoryFilePosition position);

private:
    template <typename T>
    struct Identity {
        typedef T type;
    };

    // True with a player; otherwise logs the operation's NO_INIT line.
    bool hasPlayer(const char* operation);

    // The guarded forwarding: without a player the NO_INIT line and noPlayer.
    template <typename Result, typename... Parameters>
    Result forward(const char* operation, typename Identity<Result>::type noPlayer,
                   Result (TarnPlayer::*engineOperation)(Parameters...),
                   typename Identity<Parameters>::type... arguments) {
        if (!hasPlayer(operation)) return noPlayer;
        return (mPlayer.get()->*engineOperation)(arguments...);
    }

    // Set by the constructor and by data sources, cleared by the destructor;
    // nothing reads it.
    static os::Relaxed<bool> sServiceFlag;
    // The service most recently attached or given a listener, of all players.
    static os::Relaxed<uint64_t> sNotifyCookie;

    sp<Listener> mEngineListener;
    os::Relaxed<int32_t> mStreamType;
    os::Relaxed<int32_t> mAudioSessionId;
    sp<TarnPlayer> mPlayer;
    Mutex mLock;  // part of the layout; taken by no operation
    sp<OrvMediaServiceListener> mListener;
    os::Relaxed<bool> mLoop;
    mutable Mutex mMetadataLock;  // guards mMetadataUpdated and the filters' readers
    SortedVector<int> mMetadataAllow;
    SortedVector<int> mMetadataDrop;
    SortedVector<int> mMetadataUpdated;
    os::Relaxed<int32_t> mSpeed;
};

}  // namespace android
