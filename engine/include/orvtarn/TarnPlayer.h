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

// One playback engine. Any thread may call any operation at any time, but for
// those that the player waits for: a source must not stop, reset or release the
// player from inside its own operations, and a surface must not call the player
// at all from inside its own. None calls the listener on the caller's thread.
// Statuses are 0 or a negative error, bools are true for success.
//
// A player is idle, initialized (setDataSource), preparing, prepared, started,
// paused, stopped, completed, in error or released. An operation that its state
// does not allow is INVALID_OPERATION or false, and every failure logs one line.
// getCurrentPosition, which is asked again and again, alone does not. An operation
// that an engine does not offer is refused so in every state. reset
// leads back to idle from everywhere but released, and ends what other
// threads are waiting for, as stop and release do; what they waited for is then
// INVALID_OPERATION. Surface, volume, looping, role and parameters outlast a
// reset; speed, repeated section, subtitle files and look do not.
//
// Programs without an event channel follow a player by asking for its position
// (see getCurrentPosition), which distinguishes all states. Events go to the
// listener on a thread of the engine's own, on which it may call the player.
// Media that are ready are one MEDIA_PREPARED, each seek that was done is one
// MEDIA_SEEK_COMPLETE, the end is one MEDIA_PLAYBACK_COMPLETE and what ends the
// media otherwise one MEDIA_ERROR. The picture's size is MEDIA_SET_VIDEO_SIZE,
// before the media are ready and whenever it changes.
class TarnPlayer : public MediaPlayerBase {
public:
    // decoder: the number of the hardware decoder to use, -1 for any. This engine
    // chooses by itself, whatever the number: a decoder of the machine's that
    // copies its pictures back, or software where there is none.
    // A new player has neither threads nor an mpv: both come with the first data
    // source, parameter or look of subtitles, which takes some milliseconds, sets
    // the process's LC_NUMERIC to "C", and fails with INVALID_OPERATION where mpv
    // cannot start, as without memory: the player is then as a released one. They
    // stay until release.
    explicit TarnPlayer(int decoder);

    // Before the data source: whether it is a stereoscopic stream file. On the
    // desktop such a file plays its flat picture either way.
    void configPlayer(bool ssif);

    // A path or URL; headers may be null. Of a playlist the first entry is the
    // media. Checks what can be checked without opening: NAME_NOT_FOUND,
    // PERMISSION_DENIED, BAD_VALUE (a directory or an empty name),
    // ORV_ERROR_SCHEME.
    // INVALID_OPERATION when a source is set already.
    status_t setDataSource(const char* url, const KeyedVector<String8, String8>* headers);
    // The player takes the source over, also when it refuses it, which deletes it at
    // once. The next reset or release end a read that blocks with cancelRead, make the
    // source invalid, close it and delete it, on the thread that they are called on. A
    // source that says that it can seek is asked to go to its start and its end at
    // once, for lengths of more than 32 bits.
    status_t setDataSource(IOrvStreamSource* source);
    // Reads length bytes from offset. The descriptor is duplicated, its own
    // position is not used. BAD_VALUE for a negative offset or length or a
    // descriptor that is not an open file's.
    status_t setDataSource(int fd, int64_t offset, int64_t length) override;

    // Any time; null for none. No frame goes to the earlier surface afterwards,
    // and the new one gets the picture of now, paused or not.
    status_t setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) override;
    // Blocks until the media is ready, or ends with the cause: one of the
    // statuses of orvtarn/PlayerTypes.h or TIMED_OUT (30 seconds).
    // Ready means that the first frame is on the surface.
    status_t prepare() override;
    status_t prepareAsync() override;
    // After the end of the media plays them again: INVALID_OPERATION when they
    // cannot seek. At the end without having played, completes at once.
    status_t start() override;
    // The media can be prepared again, but for a source that cannot seek and has
    // been read from. They then play at the normal speed, without a repeated
    // section, and with the tracks that were chosen at first.
    status_t stop() override;
    status_t pause() override;
    // True from start to pause, stop, the end or an error, but for the times
    // in which playback waits for data: so a started player that does not play
    // and is not at its end is buffering.
    bool isPlaying() override;
    // Blocks until the new position is shown; TIMED_OUT after ten seconds, which
    // other threads' seeks before it count towards. mode: a
    // MediaTrack::ReadOptions::SeekMode; BAD_VALUE for others. Times outside of
    // the media are their start and end. INVALID_OPERATION for media that
    // cannot seek. After the end of the media leads to paused.
    status_t seekTo(int msec, int mode) override;
    // INVALID_OPERATION before the media is prepared; the error that ended it
    // in the error state; otherwise 0 and the position. At the end of the
    // media the position is the duration and isPlaying is false.
    status_t getCurrentPosition(int* msec) override;
    // 0 when unknown. Until reset, when stopped.
    status_t getDuration(int* msec) override;
    // Waits for a release under way, which leaves it INVALID_OPERATION.
    status_t reset() override;
    // Media that cannot seek end all the same.
    status_t setLooping(int loop) override;
    // For the keys and methods of orvtarn/Parameters.h.
    status_t setParameter(int key, const Parcel& request) override;
    status_t getParameter(int key, Parcel* reply) override;
    status_t invoke(const Parcel& request, Parcel* reply) override;
    // Appends media::Metadata records without a header: those of the ids that
    // have a value, or all for an empty set or id 0.
    status_t getMetadata(const SortedVector<int>& ids, Parcel* records) override;
    // Linear gains from 0 to 1; BAD_VALUE for what is no number.
    status_t setVolume(float left, float right) override;
    // For good. May be called again, and by the listener. A second call returns
    // when the first is done, but for the listener's, which that waits for.
    status_t release() override;

    // Pixels as the picture is meant to be seen; 0 without a picture.
    status_t getVideoWidth(int* w);
    status_t getVideoHeight(int* h);
    // Where the frame of now lies in the media, in bytes, low 32 bits. For media
    // that are not files, how far they have been read.
    status_t getCurrentBytePosition(int* pos);

    // Whether a seek is possible at that speed (0: paused), and whether that
    // speed is. Media that cannot seek do not play backward.
    bool canDoSeek(int speed);
    bool canDoTrick(int speed);
    // False without such a setting, as on the desktop.
    bool setTS(unsigned short ts);
    // Frames, negative for back. Pauses, and blocks until the last one is shown.
    // False without a picture and for a frame before the first or past the last.
    bool step(int amount);
    // Thousandths, from 250 to 32000 forward or backward; BAD_VALUE otherwise.
    // Does not start playback. Above 16 times the speed frames are left out,
    // backward above 8 times only key frames are shown. Media that play
    // backward to their start go on forward at the normal speed.
    status_t setSpeed(int speed);
    bool getSpeed(int& speed);
    // An E_Orv_AB_Repeat_Type; non-zero for success.
    int setABRepeat(int type);
    // To the frame that the byte belongs to, exactly. False outside of the
    // media and where formats do not know their frames' places.
    bool seekToPosition(unsigned long long pos);
    // Percent of the duration that is there to be played.
    int getBufferPercent();

    // What the media say beyond playback is read from the source once more, when
    // first asked for: pictures, metadata, track and chapter records. That blocks
    // for ten seconds at most, unless a stream source's own read blocks longer.
    // Sources that cannot be read twice (pipes, streams that do not seek) have no
    // pictures and chapters; the rest is then what playback has found.
    //
    // The picture of the current position, of the video track that is shown.
    // Blocks while it is decoded, too.
    bool getThumbnailInfo(_Media_Thumbnail_Info_T* thumbnail);
    // The caller frees it; null without a picture.
    MediaAlbumArt* extractAlbumArt();
    bool getMetaDataInfo(MetaDataInfo& info);

    // Of the video track that is shown. Tracks are known once the media are
    // prepared; indices are positions in the table of their kind, false outside.
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
    // No subtitle is on before one of these turns it on.
    bool onSubtitleTrack(int index);
    bool offSubtitleTrack();
    // Track numbers over all kinds: video, then audio, then subtitle tracks.
    bool selectTrack(int index);
    // False for tracks that are not selected, and for the only track that plays.
    bool deselectTrack(int index);
    // Files in SubRip, ASS and other formats, as further tracks behind the
    // media's own. The first leaves its tracks off, the others turn their first
    // one on. Blocks until the file is opened, for one of a server for ten seconds
    // at most; false for what is no such file. Before prepare only the name is
    // checked: the file is opened with the media, which go without one that is
    // none and do not wait for a server. Files stay until reset: each prepare
    // opens all of them, in their order, and the last that was turned on is on.
    bool addTimedTextSource(const char* path);
    bool setSubtitleDataSource(const char* url);
    // A VobSub pair; the files may have different names and places. Any number.
    bool setSubtitleDataSourceEx(const char* sub, const char* idx);
    // Stages one record of the type's kind until flushSubtitleAttr. False for
    // types and values that orvtarn/SubtitleRecords.h does not have.
    bool setSubtitleAttr(int type, void* attr);
    bool flushSubtitleAttr();

    status_t setPlayerRole(E_Orv_Player_Role_Type role);
    // Until reset, the media are raw samples of that description. Before
    // prepare; BAD_VALUE for values that orvtarn/PcmRecords.h does not have.
    status_t setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T* info);
    // The media are raw samples: without a description two channels of signed
    // little-endian 16 bits at 44100 Hz.
    void setPcmFlag();
    // BAD_VALUE for what is no PIN of four digits. The desktop locks nothing.
    status_t setUnLockPin(int pin);

protected:
    ~TarnPlayer() override;

private:
    class Engine;
    std::unique_ptr<Engine> mEngine;
};

}  // namespace android
