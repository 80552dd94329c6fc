// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.graphics.Bitmap;
import android.os.Parcel;
import android.view.Surface;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.lang.ref.WeakReference;
import java.util.List;
import java.util.concurrent.Executor;

/**
 * Plays audio and video.
 *
 * <pre>{@code
 * try (OrvMediaPlayer player = new OrvMediaPlayer()) {
 *     player.addListener(listener);
 *     player.setDataSource("/media/film.mkv");
 *     player.setSurface(surface);
 *     player.prepare();
 *     player.start();
 *     ...
 * }
 * }</pre>
 *
 * <p>A player stands in one {@link PlayerState}; each method says in which it may be called and
 * throws {@link IllegalStateException} with a sentence otherwise, in every case after {@link
 * #release()}. Any thread may call any method at any time, also from inside a {@link
 * PlayerListener}. Methods do not block unless they say so, but those that change whether the
 * player runs wait for one another. Where null is not said to be possible it is refused with an
 * {@link IllegalArgumentException}.
 *
 * <p>Times are in milliseconds, sizes in pixels, positions in bytes where the name says so.
 *
 * <p>A player holds native resources until it is released. One that is dropped without that is
 * released by the garbage collector some time later, unless its data source is a {@link
 * MediaStreamSource}.
 *
 * <p>This class is also what the native half knows: it registers the native methods, reads and
 * writes the fields and calls the callbacks below by their names and signatures.
 */
public final class OrvMediaPlayer extends Playback {
    static {
        NativeLibrary.load();
        native_init();
    }

    private final Tracks tracks = new Tracks(this);
    private final Subtitles subtitles = new Subtitles(this);
    private final Pictures pictures = new Pictures(this);
    private final TrickPlay trickPlay = new TrickPlay(this);
    private final AudioOutput audio = new AudioOutput(this);
    private final DivxNavigation divx = new DivxNavigation(this);
    private final EngineCommands engine = new EngineCommands(this);

    /**
     * A player whose listeners are called on a daemon thread of its own, which starts with the
     * first event. Players without media cost next to nothing.
     *
     * @throws RuntimeException when the native half has no memory
     * @throws UnsatisfiedLinkError when the native library is not on java.library.path
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
     * @throws UnsatisfiedLinkError when the native library is not on java.library.path
     */
    public OrvMediaPlayer(Executor executor) {
        super(executor);
        native_setup(new WeakReference<>(this));
    }

    /**
     * The media's tracks, chapters and metadata.
     *
     * @return the same object always
     */
    public Tracks tracks() {
        return tracks;
    }

    /**
     * Subtitles on the picture.
     *
     * @return the same object always
     */
    public Subtitles subtitles() {
        return subtitles;
    }

    /**
     * Thumbnails and embedded pictures.
     *
     * @return the same object always
     */
    public Pictures pictures() {
        return pictures;
    }

    /**
     * Speeds, single steps, repeated sections and byte positions.
     *
     * @return the same object always
     */
    public TrickPlay trickPlay() {
        return trickPlay;
    }

    /**
     * Volume, session and effects of the sound.
     *
     * @return the same object always
     */
    public AudioOutput audio() {
        return audio;
    }

    /**
     * Titles, chapters and playlists of DivX media.
     *
     * @return the same object always
     */
    public DivxNavigation divx() {
        return divx;
    }

    /**
     * What is the engine's own affair.
     *
     * @return the same object always
     */
    public EngineCommands engine() {
        return engine;
    }

    @Override
    @SuppressWarnings("deprecation") // The native half's finalize needs the object itself.
    protected void finalize() {
        abandon();
        native_finalize();
    }

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
            player.events().fromNative(what, arg1, arg2, (byte[]) payload);
        }
    }

    private int readStream(int length) {
        return stream().read(length);
    }

    private long seekStream(int type, long offset) {
        return stream().seek(type, offset);
    }

    private long seekStreamEx(int type, long offset) {
        return stream().seek(type, offset);
    }

    private long timeSeekStream(long first, long second) {
        return stream().seekTime(first, second);
    }

    private int getSeekType() {
        return stream().seekType();
    }

    private void cancelRead() {
        stream().cancel();
    }

    private void closeStream() {
        stream().close();
    }

    private void setVideoCodecInfo(
            int codec, int width, int height, int frameRate, int bitRate, int flags) {
        tracks.addVideo(0, codec, width, height, frameRate, bitRate, flags);
    }

    private void setAllVideoCodecInfo(
            int count, int index, int codec, int width, int height, int frameRate, int bitRate,
            int flags) {
        tracks.addVideo(index, codec, width, height, frameRate, bitRate, flags);
    }

    private void setSubtitleTrackInfo(int trackId, int codec, String text, int flags) {
        tracks.addSubtitle(0, trackId, codec, text, flags);
    }

    private void setAllSubtitleTrackInfo(
            int count, int index, int trackId, int codec, String text, int flags) {
        tracks.addSubtitle(index, trackId, codec, text, flags);
    }

    private void setAllAudioTrackInfo(
            int count, int index, int codec, int channels, int sampleRate, int bitRate,
            int bitsPerSample, int trackId, String title, String codecName, String channelLayout,
            String profile, int flags, String comment, String encoder, String handler,
            String language) {
        tracks.addAudio(new AudioTrack(
                index, FourCharacters.text(codec), channels, sampleRate, bitRate, bitsPerSample,
                trackId, title, codecName, channelLayout, profile, new TrackFlags(flags), comment,
                encoder, handler, language));
    }

    private void setMetaDataInfo(
            int duration, int bitRate, int year, int trackNumber, String title, String artist,
            String album, String genre, int chapterCount, String composer, String container,
            String comment) {
        tracks.setMetadata(new MediaMetadata(
                duration, bitRate, year, trackNumber, title, artist, album, genre, chapterCount,
                composer, container, comment));
    }

    private void setDivxTitleInfoPrm(int title, int playlistCount, int chapterCount) {
        divx.receive(new DivxNavigation.TitleInfo(title, playlistCount, chapterCount));
    }

    private void setDivxChapInfoPrm(int title, int playlist, int chapter, int start) {
        divx.receive(new DivxNavigation.ChapterInfo(title, playlist, chapter, start));
    }

    private void setDivxPlayListInfoPrm(int title, int playlist, int chapter, int start) {
        divx.receive(new DivxNavigation.ChapterInfo(title, playlist, chapter, start));
    }

    private void setDivxPositionInfoPrm(int title, int playlist, int chapter) {
        divx.receive(new DivxNavigation.PositionInfo(title, playlist, chapter));
    }

    private void setDivxDisplayInfoPrm(
            int value1, int value2, int value3, int value4, int value5, String text1, int value6,
            String text2, int value7) {
        divx.receive(new DivxNavigation.DisplayInfo(
                List.of(value1, value2, value3, value4, value5, value6, value7), text1, text2));
    }

    private void setDivxLastMemoryFilePositionPrm(
            long clipId, int title, int playlist, int chapter, int audio, int subtitle,
            long audioPts, long audioFramePosition, long iPts, long pts, long iFramePosition,
            long framePosition, int temporalReference, int decodingOrder, long stc,
            long framePositionDisplayed, int timestamp) {
        divx.receive(DivxNavigation.lastMemory(
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
