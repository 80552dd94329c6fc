// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.graphics.Bitmap;
import android.os.Parcel;
import android.view.Surface;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.internal.PlayerUnits;
import com.quintora.mmp.internal.media.EngineDivxNavigation;
import com.quintora.mmp.internal.media.FourCharacters;
import com.quintora.mmp.internal.natives.NativeLibrary;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.lang.ref.WeakReference;
import java.util.List;
import java.util.Map;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.Executor;
import org.jetbrains.annotations.Nullable;

/**
 * The {@link MediaPlayer} that plays, by the platform's engine.
 *
 * <p>A player holds native resources until it is released: use try-with-resources, or {@link
 * #release()}. One that is dropped without that is freed by the garbage collector some time later,
 * with a warning in the log that says where it was made, unless its data source is a {@link
 * MediaStreamSource}: the native half keeps hold of such a player.
 *
 * <p>This class is also what the native half knows: it registers the native methods, reads and
 * writes the fields and calls the callbacks below by their names and signatures.
 */
public final class OrvMediaPlayer implements MediaPlayer {
    static {
        NativeLibrary.load();
        native_init();
    }

    // Null in a stand-in for a player that was collected, of which nothing is called.
    final @Nullable PlayerUnits units;
    private final @Nullable ForgottenPlayer forgotten;

    /**
     * A player whose listeners are called on a daemon thread of its own, which starts with the
     * first event. Players without media cost next to nothing.
     *
     * @throws RuntimeException when the native half has no memory
     * @throws UnsatisfiedLinkError when the native library cannot be found or loaded
     */
    public OrvMediaPlayer() {
        this(null);
    }

    /**
     * A player whose listeners are called by an executor, one call after the other.
     *
     * @param executor such as {@code SwingUtilities::invokeLater}; null for a thread of the
     *     player's own
     * @throws RuntimeException when the native half has no memory
     * @throws UnsatisfiedLinkError when the native library cannot be found or loaded
     */
    public OrvMediaPlayer(@Nullable Executor executor) {
        NativeCalls natives = new NativeCalls(this);
        units = new PlayerUnits(this, natives, executor);
        native_setup(new WeakReference<>(this));
        forgotten = ForgottenPlayer.watch(this, units);
        rememberHeld();
    }

    /** Stands in for a player that was collected: what the native half held for it. */
    OrvMediaPlayer(long nativeContext, long nativeSurfaceTexture) {
        units = null;
        forgotten = null;
        mNativeContext = nativeContext;
        mNativeSurfaceTexture = nativeSurfaceTexture;
    }

    void finalizeNatively() {
        native_finalize();
    }

    void rememberHeld() {
        forgotten.setHeld(mNativeContext, mNativeSurfaceTexture);
    }

    // What the engine alone knows, beyond the interface.

    /**
     * Titles, chapters and playlists of DivX media.
     *
     * @return the same object always
     */
    public DivxNavigation divx() {
        return units.divx;
    }

    /**
     * Calls whose meaning is the engine's and the platform's.
     *
     * @return the same object always
     */
    public EngineCommands engine() {
        return units.engine;
    }

    // The interface, by the units.

    @Override public void addListener(PlayerListener listener) {
        units.events.addListener(listener);
    }
    @Override public void removeListener(PlayerListener listener) {
        units.events.removeListener(listener);
    }
    @Override public PlayerState getState() { return units.states.state(); }
    @Override public void setDataSource(String pathOrUrl) throws IOException {
        units.sources.set(pathOrUrl);
    }
    @Override public void setDataSource(String url, Map<String, String> headers)
            throws IOException {
        units.sources.set(url, headers);
    }
    @Override public void setDataSource(FileDescriptor fd, long offset, long length)
            throws IOException {
        units.sources.set(fd, offset, length);
    }
    @Override public void setDataSource(MediaStreamSource source) throws IOException {
        units.sources.set(source);
    }
    @Override public void setPcmFormat(PcmMediaInfo format) { units.sources.setPcmFormat(format); }
    @Override public void setSurface(@Nullable Surface surface) { units.surface.set(surface); }
    @Override public CompletableFuture<Void> prepareAsync() throws IOException {
        return units.preparation.prepareAsync();
    }
    @Override public void prepareAndWait() throws IOException {
        units.preparation.prepareAndWait();
    }
    @Override public void start() { units.playback.start(); }
    @Override public void pause() { units.playback.pause(); }
    @Override public void stop() { units.playback.stop(); }
    @Override public CompletableFuture<Void> reset() { return units.lifetime.reset(); }
    @Override public void resetAndWait() throws IOException { units.lifetime.resetAndWait(); }
    @Override public CompletableFuture<Void> release() { return units.lifetime.release(); }
    @Override public void close() { units.lifetime.close(); }
    @Override public CompletableFuture<Boolean> seekTo(int millis) {
        return units.seeking.seekTo(millis);
    }
    @Override public void seekToAndWait(int millis) { units.seeking.seekToAndWait(millis); }
    @Override public boolean isPlaying() { return units.playback.isPlaying(); }
    @Override public int getCurrentPosition() { return units.playback.position(); }
    @Override public int getDuration() { return units.playback.duration(); }
    @Override public int getBufferedPercent() { return units.playback.bufferedPercent(); }
    @Override public int getVideoWidth() { return units.playback.videoWidth(); }
    @Override public int getVideoHeight() { return units.playback.videoHeight(); }
    @Override public void setLooping(boolean looping) { units.playback.setLooping(looping); }
    @Override public boolean isLooping() { return units.playback.isLooping(); }
    @Override public Tracks tracks() { return units.tracks; }
    @Override public Subtitles subtitles() { return units.subtitles; }
    @Override public Pictures pictures() { return units.pictures; }
    @Override public TrickPlay trickPlay() { return units.trickPlay; }
    @Override public AudioOutput audio() { return units.audio; }

    // Fields that the native half reads and writes, all of them 0, null or false at first.

    private long mNativeContext;
    long mNativeSurfaceTexture;
    byte[] mStreamReadBuffer;
    long mStreamSize;
    long mStreamCurPos;
    boolean mStreamSeekable;
    int mDataSourceType;
    boolean mStallingSupport;
    long mStreamDuration;

    // Callbacks, on the native half's threads.

    private static void postEventFromNative(
            Object weakPlayer, int what, int arg1, int arg2, Object payload) {
        if (weakPlayer instanceof WeakReference<?> reference
                && reference.get() instanceof OrvMediaPlayer player) {
            player.units.nativeEvents.receive(what, arg1, arg2, (byte[]) payload);
        }
    }

    private int readStream(int length) {
        return units.source.stream().read(length);
    }

    private long seekStream(int type, long offset) {
        return units.source.stream().seek(type, offset);
    }

    private long seekStreamEx(int type, long offset) {
        return units.source.stream().seek(type, offset);
    }

    private long timeSeekStream(long first, long second) {
        return units.source.stream().seekTime(first, second);
    }

    private int getSeekType() {
        return units.source.stream().seekType();
    }

    private void cancelRead() {
        units.source.stream().cancel();
    }

    private void closeStream() {
        units.source.stream().close();
    }

    private void setVideoCodecInfo(
            int codec, int width, int height, int frameRate, int bitRate, int flags) {
        units.tables.addVideo(0, codec, width, height, frameRate, bitRate, flags);
    }

    private void setAllVideoCodecInfo(
            int count, int index, int codec, int width, int height, int frameRate, int bitRate,
            int flags) {
        units.tables.addVideo(index, codec, width, height, frameRate, bitRate, flags);
    }

    private void setSubtitleTrackInfo(int trackId, int codec, String text, int flags) {
        units.tables.addSubtitle(0, trackId, codec, text, flags);
    }

    private void setAllSubtitleTrackInfo(
            int count, int index, int trackId, int codec, String text, int flags) {
        units.tables.addSubtitle(index, trackId, codec, text, flags);
    }

    private void setAllAudioTrackInfo(
            int count, int index, int codec, int channels, int sampleRate, int bitRate,
            int bitsPerSample, int trackId, String title, String codecName, String channelLayout,
            String profile, int flags, String comment, String encoder, String handler,
            String language) {
        units.tables.addAudio(new AudioTrack(
                index, FourCharacters.text(codec), channels, sampleRate, bitRate, bitsPerSample,
                trackId, title, codecName, channelLayout, profile, new TrackFlags(flags), comment,
                encoder, handler, language));
    }

    private void setMetaDataInfo(
            int duration, int bitRate, int year, int trackNumber, String title, String artist,
            String album, String genre, int chapterCount, String composer, String container,
            String comment) {
        units.tables.setMetadata(new MediaMetadata(
                duration, bitRate, year, trackNumber, title, artist, album, genre, chapterCount,
                composer, container, comment));
    }

    private void setDivxTitleInfoPrm(int title, int playlistCount, int chapterCount) {
        units.divx.receive(new DivxNavigation.TitleInfo(title, playlistCount, chapterCount));
    }

    private void setDivxChapInfoPrm(int title, int playlist, int chapter, int start) {
        units.divx.receive(new DivxNavigation.ChapterInfo(title, playlist, chapter, start));
    }

    private void setDivxPlayListInfoPrm(int title, int playlist, int chapter, int start) {
        units.divx.receive(new DivxNavigation.ChapterInfo(title, playlist, chapter, start));
    }

    private void setDivxPositionInfoPrm(int title, int playlist, int chapter) {
        units.divx.receive(new DivxNavigation.PositionInfo(title, playlist, chapter));
    }

    private void setDivxDisplayInfoPrm(
            int value1, int value2, int value3, int value4, int value5, String text1, int value6,
            String text2, int value7) {
        units.divx.receive(new DivxNavigation.DisplayInfo(
                List.of(value1, value2, value3, value4, value5, value6, value7), text1, text2));
    }

    private void setDivxLastMemoryFilePositionPrm(
            long clipId, int title, int playlist, int chapter, int audio, int subtitle,
            long audioPts, long audioFramePosition, long iPts, long pts, long iFramePosition,
            long framePosition, int temporalReference, int decodingOrder, long stc,
            long framePositionDisplayed, int timestamp) {
        units.divx.receive(EngineDivxNavigation.lastMemory(
                new int[] {title, playlist, chapter, audio, subtitle, temporalReference,
                    decodingOrder, timestamp},
                new long[] {clipId, audioPts, audioFramePosition, iPts, pts, iFramePosition,
                    framePosition, stc, framePositionDisplayed}));
    }

    // The native methods, in the order in which the native half registers them.

    native void native_setDataSource(String path) throws IOException;
    native void native_setDataSource(String path, String[] keys, String[] values)
            throws IOException;
    native void native_setDataSource(FileDescriptor fd, long offset, long length)
            throws IOException;
    native void native_setVideoSurface(Surface surface);
    native void native_prepare() throws IOException;
    native void native_prepareAsync() throws IOException;
    native void native_start();
    native void native_stop();
    native int native_getVideoWidth();
    native int native_getVideoHeight();
    native void native_seekTo(int millis);
    native void native_pause() throws IOException;
    native boolean native_isPlaying();
    native int native_getCurrentPosition() throws IOException;
    native int native_getDuration();
    native void native_release();
    native void native_reset() throws IOException;
    native void native_setAudioStreamType(int type) throws IOException;
    native void native_setLooping(boolean looping) throws IOException;
    native boolean native_isLooping();
    native void native_setVolume(float left, float right) throws IOException;
    native Bitmap native_getFrameAt(int millis);
    native int native_invoke(Parcel request, Parcel reply);
    native int native_setMetadataFilter(Parcel filter);
    native boolean native_getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply);
    static native void native_init();
    native void native_setup(Object weakPlayer);
    native void native_finalize();
    native int native_getAudioSessionId();
    native void native_setAudioSessionId(int id) throws IOException;
    native void native_setAuxEffectSendLevel(float level) throws IOException;
    native void native_attachAuxEffect(int id) throws IOException;
    native boolean native_setParameter(int key, Parcel value);
    native void native_getParameter(int key, Parcel reply);
    native boolean native_setAudioTrack(int index);
    native boolean native_getVideoCodecInfo();
    native int native_setPlayMode(int speed);
    native int native_getPlayMode();
    native int native_getBufferPercent();
    native void native_onSubtitleTrack(int index);
    native void native_offSubtitleTrack();
    native void native_deselectTrack(int number);
    native void native_selectTrack(int number);
    native boolean native_getSubtitleTrackInfo(int index);
    native int native_getAllSubtitleTrackInfo();
    native int native_getAllAudioTrackInfo(boolean withTexts);
    native int native_getAllVideoTrackInfo();
    native void native_setSubtitleDataSource(String path);
    native void native_setSubtitleDataSourceEx(String subPath, String idxPath);
    native int native_addTimedTextSource(String path);
    native void native_setSubtitleAttr(SubtitleAttr attr);
    native byte[] native_getThumbnailInfo(ThumbnailInfo request);
    native void native_step(int frames);
    native byte[] native_getEmbeddedPicture(int type);
    native void native_setPcmMediaInfo(PcmMediaInfo info);
    native void native_setPcmFlag();
    native void native_setDataSourceByInputStream();
    native void native_seekToPosition(long bytes);
    native boolean native_canDoSeek(int speed);
    native boolean native_canDoTrick(int speed);
    native boolean native_setTS(int setting);
    native int native_getCurrentBytePosition() throws IOException;
    native void native_setPlayerRole(int role);
    native boolean native_getMetaDataInfo();
    native int native_setABRepeat(int type);
    native int native_QTVDECSendCliCommand(String command, int argument);
    native boolean native_getDivxTitleInfo(int title);
    native boolean native_getDivxChapInfo(int title, int playlist, int chapter);
    native boolean native_getDivxPlayListInfo(int title, int playlist);
    native boolean native_getDivxPositionInfo();
    native boolean native_getDivxDisplayInfo(
            int value1, int value2, int value3, int value4, int value5);
    native boolean native_getDivxLastMemoryFilePosition();
    native int native_getDivxTitleNum();
    native int native_getDivxLastMemoryFileID();
    native int native_setDivxTitleInfo(int value1, int value2, int value3);
    native int native_setDivxChapInfo(int value1, int value2, int value3, int value4);
    native int native_setDivxPlayListInfo(int value1, int value2, int value3, int value4);
    native int native_setDivxBtnInfo(int value1, int value2);
    native int native_setDivxLastMemoryFilePosition(DivxLastMemoryFilePosition position);
    native int native_setDivxFilePosition(int value1, int value2);
    native int native_getCurrentAudioIndex();
    native int native_getCurrentSubtitleIndex();
    native int native_setUnLockPin(int pin);
}
