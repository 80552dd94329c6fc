// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.graphics.Bitmap;
import android.os.Parcel;
import android.view.Surface;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.SharedFields;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.io.FileDescriptor;
import java.io.IOException;

/** Hands a player's native methods and fields, which stand in its class, to its units. */
final class NativeCalls implements NativePlayer, SharedFields {
    private final OrvMediaPlayer player;

    NativeCalls(OrvMediaPlayer player) {
        this.player = player;
    }

    @Override
    public void describeStream(long size, boolean seekable, boolean mayStall, long durationMillis) {
        player.mStreamSize = size;
        player.mStreamCurPos = 0;
        player.mStreamSeekable = seekable;
        player.mStallingSupport = mayStall;
        player.mStreamDuration = durationMillis;
        player.mDataSourceType = 0;
    }

    @Override
    public byte[] streamBuffer(int length) {
        if (player.mStreamReadBuffer == null || player.mStreamReadBuffer.length < length) {
            player.mStreamReadBuffer = new byte[length];
        }
        return player.mStreamReadBuffer;
    }

    @Override
    public void dropStreamBuffer() {
        player.mStreamReadBuffer = null;
    }

    @Override
    public void setStreamPosition(long position) {
        player.mStreamCurPos = position;
    }

    @Override
    public void forgetSurface() {
        player.mNativeSurfaceTexture = 0;
        player.rememberHeld();
    }

    @Override public void setDataSource(String path) throws IOException {
        player.native_setDataSource(path);
    }
    @Override public void setDataSource(
            String path, String[] keys, String[] values) throws IOException {
        player.native_setDataSource(path, keys, values);
    }
    @Override public void setDataSource(
            FileDescriptor fd, long offset, long length) throws IOException {
        player.native_setDataSource(fd, offset, length);
    }
    @Override
    public void setVideoSurface(Surface surface) {
        player.native_setVideoSurface(surface);
        player.rememberHeld();
    }

    @Override public void prepare() throws IOException { player.native_prepare(); }
    @Override public void prepareAsync() throws IOException { player.native_prepareAsync(); }
    @Override public void start() { player.native_start(); }
    @Override public void stop() { player.native_stop(); }
    @Override public int getVideoWidth() { return player.native_getVideoWidth(); }
    @Override public int getVideoHeight() { return player.native_getVideoHeight(); }
    @Override public void seekTo(int millis) { player.native_seekTo(millis); }
    @Override public void pause() throws IOException { player.native_pause(); }
    @Override public boolean isPlaying() { return player.native_isPlaying(); }
    @Override public int getCurrentPosition() throws IOException {
        return player.native_getCurrentPosition();
    }
    @Override public int getDuration() { return player.native_getDuration(); }
    @Override
    public void release() {
        try {
            player.native_release();
        } finally {
            player.rememberHeld();
        }
    }

    @Override public void reset() throws IOException { player.native_reset(); }
    @Override public void setAudioStreamType(int type) throws IOException {
        player.native_setAudioStreamType(type);
    }
    @Override public void setLooping(boolean looping) throws IOException {
        player.native_setLooping(looping);
    }
    @Override public boolean isLooping() { return player.native_isLooping(); }
    @Override public void setVolume(float left, float right) throws IOException {
        player.native_setVolume(left, right);
    }
    @Override public Bitmap getFrameAt(int millis) { return player.native_getFrameAt(millis); }
    @Override public int invoke(Parcel request, Parcel reply) {
        return player.native_invoke(request, reply);
    }
    @Override public int setMetadataFilter(Parcel filter) {
        return player.native_setMetadataFilter(filter);
    }
    @Override public boolean getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply) {
        return player.native_getMetadata(updateOnly, applyFilter, reply);
    }
    @Override public int getAudioSessionId() { return player.native_getAudioSessionId(); }
    @Override public void setAudioSessionId(int id) throws IOException {
        player.native_setAudioSessionId(id);
    }
    @Override public void setAuxEffectSendLevel(float level) throws IOException {
        player.native_setAuxEffectSendLevel(level);
    }
    @Override public void attachAuxEffect(int id) throws IOException {
        player.native_attachAuxEffect(id);
    }
    @Override public boolean setParameter(int key, Parcel value) {
        return player.native_setParameter(key, value);
    }
    @Override public void getParameter(int key, Parcel reply) {
        player.native_getParameter(key, reply);
    }
    @Override public boolean setAudioTrack(int index) { return player.native_setAudioTrack(index); }
    @Override public boolean getVideoCodecInfo() { return player.native_getVideoCodecInfo(); }
    @Override public int setPlayMode(int speed) { return player.native_setPlayMode(speed); }
    @Override public int getPlayMode() { return player.native_getPlayMode(); }
    @Override public int getBufferPercent() { return player.native_getBufferPercent(); }
    @Override public void onSubtitleTrack(int index) { player.native_onSubtitleTrack(index); }
    @Override public void offSubtitleTrack() { player.native_offSubtitleTrack(); }
    @Override public void deselectTrack(int number) { player.native_deselectTrack(number); }
    @Override public void selectTrack(int number) { player.native_selectTrack(number); }
    @Override public boolean getSubtitleTrackInfo(int index) {
        return player.native_getSubtitleTrackInfo(index);
    }
    @Override public int getAllSubtitleTrackInfo() {
        return player.native_getAllSubtitleTrackInfo();
    }
    @Override public int getAllAudioTrackInfo(boolean withTexts) {
        return player.native_getAllAudioTrackInfo(withTexts);
    }
    @Override public int getAllVideoTrackInfo() { return player.native_getAllVideoTrackInfo(); }
    @Override public void setSubtitleDataSource(String path) {
        player.native_setSubtitleDataSource(path);
    }
    @Override public void setSubtitleDataSourceEx(String subPath, String idxPath) {
        player.native_setSubtitleDataSourceEx(subPath, idxPath);
    }
    @Override public int addTimedTextSource(String path) {
        return player.native_addTimedTextSource(path);
    }
    @Override public void setSubtitleAttr(SubtitleAttr attr) {
        player.native_setSubtitleAttr(attr);
    }
    @Override public byte[] getThumbnailInfo(ThumbnailInfo request) {
        return player.native_getThumbnailInfo(request);
    }
    @Override public void step(int frames) { player.native_step(frames); }
    @Override public byte[] getEmbeddedPicture(int type) {
        return player.native_getEmbeddedPicture(type);
    }
    @Override public void setPcmMediaInfo(PcmMediaInfo info) {
        player.native_setPcmMediaInfo(info);
    }
    @Override public void setPcmFlag() { player.native_setPcmFlag(); }
    @Override public void setDataSourceByInputStream() {
        player.native_setDataSourceByInputStream();
    }
    @Override public void seekToPosition(long bytes) { player.native_seekToPosition(bytes); }
    @Override public boolean canDoSeek(int speed) { return player.native_canDoSeek(speed); }
    @Override public boolean canDoTrick(int speed) { return player.native_canDoTrick(speed); }
    @Override public boolean setTS(int setting) { return player.native_setTS(setting); }
    @Override public int getCurrentBytePosition() throws IOException {
        return player.native_getCurrentBytePosition();
    }
    @Override public void setPlayerRole(int role) { player.native_setPlayerRole(role); }
    @Override public boolean getMetaDataInfo() { return player.native_getMetaDataInfo(); }
    @Override public int setABRepeat(int type) { return player.native_setABRepeat(type); }
    @Override public int QTVDECSendCliCommand(String command, int argument) {
        return player.native_QTVDECSendCliCommand(command, argument);
    }
    @Override public boolean getDivxTitleInfo(int title) {
        return player.native_getDivxTitleInfo(title);
    }
    @Override public boolean getDivxChapInfo(int title, int playlist, int chapter) {
        return player.native_getDivxChapInfo(title, playlist, chapter);
    }
    @Override public boolean getDivxPlayListInfo(int title, int playlist) {
        return player.native_getDivxPlayListInfo(title, playlist);
    }
    @Override public boolean getDivxPositionInfo() { return player.native_getDivxPositionInfo(); }
    @Override public boolean getDivxDisplayInfo(
            int value1, int value2, int value3, int value4, int value5) {
        return player.native_getDivxDisplayInfo(value1, value2, value3, value4, value5);
    }
    @Override public boolean getDivxLastMemoryFilePosition() {
        return player.native_getDivxLastMemoryFilePosition();
    }
    @Override public int getDivxTitleNum() { return player.native_getDivxTitleNum(); }
    @Override public int getDivxLastMemoryFileID() {
        return player.native_getDivxLastMemoryFileID();
    }
    @Override public int setDivxTitleInfo(int value1, int value2, int value3) {
        return player.native_setDivxTitleInfo(value1, value2, value3);
    }
    @Override public int setDivxChapInfo(int value1, int value2, int value3, int value4) {
        return player.native_setDivxChapInfo(value1, value2, value3, value4);
    }
    @Override public int setDivxPlayListInfo(int value1, int value2, int value3, int value4) {
        return player.native_setDivxPlayListInfo(value1, value2, value3, value4);
    }
    @Override public int setDivxBtnInfo(int value1, int value2) {
        return player.native_setDivxBtnInfo(value1, value2);
    }
    @Override public int setDivxLastMemoryFilePosition(DivxLastMemoryFilePosition position) {
        return player.native_setDivxLastMemoryFilePosition(position);
    }
    @Override public int setDivxFilePosition(int value1, int value2) {
        return player.native_setDivxFilePosition(value1, value2);
    }
    @Override public int getCurrentAudioIndex() { return player.native_getCurrentAudioIndex(); }
    @Override public int getCurrentSubtitleIndex() {
        return player.native_getCurrentSubtitleIndex();
    }
    @Override public int setUnLockPin(int pin) { return player.native_setUnLockPin(pin); }
}
