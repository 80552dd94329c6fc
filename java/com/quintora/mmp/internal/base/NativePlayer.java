// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import android.graphics.Bitmap;
import android.os.Parcel;
import android.view.Surface;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.io.FileDescriptor;
import java.io.IOException;

/**
 * The native methods of one player, under their names without "native_" and in the order in which
 * the native half registers them. Threads, blocking and failures are those of the native half.
 */
public interface NativePlayer {
    void setDataSource(String path) throws IOException;
    void setDataSource(String path, String[] keys, String[] values) throws IOException;
    void setDataSource(FileDescriptor fd, long offset, long length) throws IOException;
    void setVideoSurface(Surface surface);
    void prepare() throws IOException;
    void prepareAsync() throws IOException;
    void start();
    void stop();
    int getVideoWidth();
    int getVideoHeight();
    void seekTo(int millis);
    void pause() throws IOException;
    boolean isPlaying();
    int getCurrentPosition() throws IOException;
    int getDuration();
    void release();
    void reset() throws IOException;
    void setAudioStreamType(int type) throws IOException;
    void setLooping(boolean looping) throws IOException;
    boolean isLooping();
    void setVolume(float left, float right) throws IOException;
    Bitmap getFrameAt(int millis);
    int invoke(Parcel request, Parcel reply);
    int setMetadataFilter(Parcel filter);
    boolean getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply);
    int getAudioSessionId();
    void setAudioSessionId(int id) throws IOException;
    void setAuxEffectSendLevel(float level) throws IOException;
    void attachAuxEffect(int id) throws IOException;
    boolean setParameter(int key, Parcel value);
    void getParameter(int key, Parcel reply);
    boolean setAudioTrack(int index);
    boolean getVideoCodecInfo();
    int setPlayMode(int speed);
    int getPlayMode();
    int getBufferPercent();
    void onSubtitleTrack(int index);
    void offSubtitleTrack();
    void deselectTrack(int number);
    void selectTrack(int number);
    boolean getSubtitleTrackInfo(int index);
    int getAllSubtitleTrackInfo();
    int getAllAudioTrackInfo(boolean withTexts);
    int getAllVideoTrackInfo();
    void setSubtitleDataSource(String path);
    void setSubtitleDataSourceEx(String subPath, String idxPath);
    int addTimedTextSource(String path);
    void setSubtitleAttr(SubtitleAttr attr);
    byte[] getThumbnailInfo(ThumbnailInfo request);
    void step(int frames);
    byte[] getEmbeddedPicture(int type);
    void setPcmMediaInfo(PcmMediaInfo info);
    void setPcmFlag();
    void setDataSourceByInputStream();
    void seekToPosition(long bytes);
    boolean canDoSeek(int speed);
    boolean canDoTrick(int speed);
    boolean setTS(int setting);
    int getCurrentBytePosition() throws IOException;
    void setPlayerRole(int role);
    boolean getMetaDataInfo();
    int setABRepeat(int type);
    int QTVDECSendCliCommand(String command, int argument);
    boolean getDivxTitleInfo(int title);
    boolean getDivxChapInfo(int title, int playlist, int chapter);
    boolean getDivxPlayListInfo(int title, int playlist);
    boolean getDivxPositionInfo();
    boolean getDivxDisplayInfo(int value1, int value2, int value3, int value4, int value5);
    boolean getDivxLastMemoryFilePosition();
    int getDivxTitleNum();
    int getDivxLastMemoryFileID();
    int setDivxTitleInfo(int value1, int value2, int value3);
    int setDivxChapInfo(int value1, int value2, int value3, int value4);
    int setDivxPlayListInfo(int value1, int value2, int value3, int value4);
    int setDivxBtnInfo(int value1, int value2);
    int setDivxLastMemoryFilePosition(DivxLastMemoryFilePosition position);
    int setDivxFilePosition(int value1, int value2);
    int getCurrentAudioIndex();
    int getCurrentSubtitleIndex();
    int setUnLockPin(int pin);
}
