// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <media/MediaPlayerInterface.h>
#include <orvtarn/DivxRecords.h>
#include <orvtarn/MetaDataInfo.h>
#include <orvtarn/PcmRecords.h>
#include <orvtarn/PictureRecords.h>
#include <orvtarn/PlayerTypes.h>
#include <orvtarn/SubtitleRecords.h>
#include <orvtarn/TrackRecords.h>
#include <utils/KeyedVector.h>
#include <utils/String8.h>

#include <memory>

class IOrvStreamSource;

namespace android {

// One playback engine. Any thread may call any operation at any time; none
// calls the listener on the caller's thread. Statuses are 0 or a negative
// error, bools are true for success.
//
// Programs without an event channel follow a player by asking for its position
// (see getCurrentPosition), which tells every state apart.
class TarnPlayer : public MediaPlayerBase {
public:
    // -1 makes a player that is not bound to a hardware decoder.
    explicit TarnPlayer(int decoder);

    // Before the data source: whether it is a stereoscopic stream file.
    void configPlayer(bool ssif);

    // A path or URL; headers may be null. Checks what can be checked without
    // opening: NAME_NOT_FOUND, PERMISSION_DENIED, BAD_VALUE (a directory or an
    // empty name). INVALID_OPERATION when a source is set already.
    status_t setDataSource(const char* url, const KeyedVector<String8, String8>* headers);
    // The source is not deleted by the player. It must live until the next
    // reset or release has returned.
    status_t setDataSource(IOrvStreamSource* source);
    // Reads length bytes from offset. The descriptor is duplicated. BAD_VALUE
    // for a negative offset or length or a descriptor that is not open.
    status_t setDataSource(int fd, int64_t offset, int64_t length) override;

    status_t setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) override;
    // Blocks until the media is ready, or ends with the cause: ORV_ERROR_IO,
    // ORV_ERROR_MALFORMED, ORV_ERROR_UNSUPPORTED or TIMED_OUT.
    status_t prepare() override;
    status_t prepareAsync() override;
    status_t start() override;
    status_t stop() override;
    status_t pause() override;
    bool isPlaying() override;
    // Blocks until the new position is shown, for a limited time.
    status_t seekTo(int msec, int mode) override;
    // INVALID_OPERATION before the media is prepared; the error that ended it
    // in the error state; otherwise 0 and the position. At the end of the
    // media the position is the duration and isPlaying is false.
    status_t getCurrentPosition(int* msec) override;
    status_t getDuration(int* msec) override;
    status_t reset() override;
    status_t setLooping(int loop) override;
    status_t setParameter(int key, const Parcel& request) override;
    status_t getParameter(int key, Parcel* reply) override;
    status_t invoke(const Parcel& request, Parcel* reply) override;
    status_t getMetadata(const SortedVector<int>& ids, Parcel* records) override;
    status_t setVolume(float left, float right) override;
    status_t release() override;

    status_t getVideoWidth(int* w);
    status_t getVideoHeight(int* h);
    status_t getCurrentBytePosition(int* pos);  // low 32 bits

    // Whether a seek is possible at that speed, and whether that speed is.
    bool canDoSeek(int speed);
    bool canDoTrick(int speed);
    bool setTS(unsigned short ts);
    bool step(int amount);  // frames, negative for back
    status_t setSpeed(int speed);
    bool getSpeed(int& speed);
    int setABRepeat(int type);                    // non-zero for success
    bool seekToPosition(unsigned long long pos);  // bytes
    int getBufferPercent();

    bool getThumbnailInfo(_Media_Thumbnail_Info_T* thumbnail);
    MediaAlbumArt* extractAlbumArt();
    bool getMetaDataInfo(MetaDataInfo& info);

    bool getVideoCodecInfo(VideoCodecInfo& info);
    bool getVideoCodecInfo(int index, VideoCodecInfo& info);
    bool getVideoTrackCount(int& count);
    bool getAudioTrackCount(int& count);
    // flag: also fill the descriptive texts, which may need the decoder.
    bool getAudioTrackInfo(bool flag, int index, AudioTrackInfo& info);
    bool selectAudioTrack(int index);
    // Non-zero when the index is known: callers take 0 for a failure.
    status_t getCurrentAudioIndex(int* index);

    bool getSubtitleTrackCount(int& count);
    bool getSubtitleTrackInfo(int index, SubtitleTrackInfo& info);
    status_t getCurrentSubtitleIndex(int* index);  // as getCurrentAudioIndex; -1 for none
    bool onSubtitleTrack(int index);
    bool offSubtitleTrack();
    // Track numbers over all kinds: video, then audio, then subtitle tracks.
    bool selectTrack(int index);
    bool deselectTrack(int index);
    bool addTimedTextSource(const char* path);
    bool setSubtitleDataSource(const char* url);
    bool setSubtitleDataSourceEx(const char* sub, const char* idx);
    // Stages one record of the type's kind until flushSubtitleAttr.
    bool setSubtitleAttr(int type, void* attr);
    bool flushSubtitleAttr();

    status_t setPlayerRole(E_Orv_Player_Role_Type role);
    status_t setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T* info);
    void setPcmFlag();
    status_t setUnLockPin(int pin);

protected:
    ~TarnPlayer() override;

private:
    class Engine;
    std::unique_ptr<Engine> mEngine;
};

}  // namespace android
