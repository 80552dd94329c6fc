// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.view.Surface;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Map;
import java.util.Objects;
import java.util.Set;
import java.util.concurrent.Executor;

/** The part of {@link OrvMediaPlayer} that opens and plays media. */
abstract sealed class Playback extends PlayerCore implements AutoCloseable permits OrvMediaPlayer {
    private static final Set<PlayerState> CAN_PREPARE =
            EnumSet.of(PlayerState.INITIALIZED, PlayerState.STOPPED);
    private static final Set<PlayerState> RUNNING =
            EnumSet.of(PlayerState.STARTED, PlayerState.PAUSED);
    private static final Set<PlayerState> CAN_PAUSE =
            EnumSet.of(PlayerState.STARTED, PlayerState.PAUSED, PlayerState.COMPLETED);
    private static final Set<PlayerState> CAN_STOP =
            EnumSet.of(PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED,
                    PlayerState.COMPLETED, PlayerState.STOPPED);

    Playback(Executor executor) {
        super(executor);
    }

    /**
     * Adds someone to tell what happens. Allowed in every state.
     *
     * @param listener who is told from now on; adding one twice tells it twice
     */
    public void addListener(PlayerListener listener) {
        states.requireAlive("addListener()");
        events().listeners.add(Objects.requireNonNull(listener, "listener"));
    }

    /**
     * Takes a listener off. Allowed in every state, also after release.
     *
     * @param listener who is not told any more; unknown ones are ignored
     */
    public void removeListener(PlayerListener listener) {
        events().listeners.remove(listener);
    }

    /**
     * Where the player stands. Allowed in every state, also after release.
     *
     * @return the state
     */
    public PlayerState getState() {
        return states.state();
    }

    /**
     * Plays a file or a URL next. State: IDLE; then INITIALIZED.
     *
     * @param pathOrUrl a file's path, or a URL such as {@code http://host/film.mp4}
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when it is a file that is not there, or a directory
     * @throws SecurityException when the file must not be read
     * @throws IllegalStateException in another state
     */
    public void setDataSource(String pathOrUrl) throws IOException {
        initialize(pathOrUrl, () -> peer.native_setDataSource(required(pathOrUrl)));
    }

    /**
     * Plays a URL next, with headers in every request for it. State: IDLE; then INITIALIZED.
     *
     * @param url the URL
     * @param headers names and values, none of them null
     * @throws IllegalArgumentException when the URL, a name or a value is null
     * @throws IOException as {@link #setDataSource(String)}
     * @throws IllegalStateException in another state
     */
    public void setDataSource(String url, Map<String, String> headers) throws IOException {
        headers.forEach((name, value) -> {
            if (name == null || value == null) {
                throw new IllegalArgumentException("a header's name or value is null: " + name);
            }
        });
        String[] names = headers.keySet().toArray(String[]::new);
        String[] values = headers.values().toArray(String[]::new);
        initialize(url, () -> peer.native_setDataSource(required(url), names, values));
    }

    /**
     * Plays an open file next. State: IDLE; then INITIALIZED.
     *
     * @param fd an open descriptor; the player keeps one of its own
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when it is not open
     * @throws IllegalStateException in another state
     */
    public void setDataSource(FileDescriptor fd) throws IOException {
        setDataSource(fd, 0, Long.MAX_VALUE);
    }

    /**
     * Plays a part of an open file next. State: IDLE; then INITIALIZED.
     *
     * @param fd an open descriptor; the player keeps one of its own
     * @param offset where the media begins, in bytes
     * @param length how long it is, in bytes; more than there is means up to the end
     * @throws IllegalArgumentException when the descriptor is null
     * @throws MediaException when it is not open, or the offset or length is negative
     * @throws IllegalStateException in another state
     */
    public void setDataSource(FileDescriptor fd, long offset, long length) throws IOException {
        if (fd == null) {
            throw new IllegalArgumentException("the descriptor is null");
        }
        initialize("the descriptor", () -> peer.native_setDataSource(fd, offset, length));
    }

    /**
     * Plays bytes that the program produces next. State: IDLE; then INITIALIZED. The source is
     * closed at the next reset or release, or by this call when it throws.
     *
     * @param media where the bytes come from
     * @throws IOException when the source cannot tell its size
     * @throws IllegalStateException in another state
     */
    public void setDataSource(MediaStreamSource media) throws IOException {
        StreamAdapter adapter = new StreamAdapter(Objects.requireNonNull(media, "media"));
        try {
            initialize("the stream source", () -> {
                adapter.describeTo(peer);
                useStream(adapter);
                peer.native_setDataSourceByInputStream();
            });
        } catch (IOException | RuntimeException e) {
            adapter.close();
            useStream(StreamAdapter.none());
            throw e;
        }
    }

    /**
     * Says that the next data source is raw PCM. State: IDLE, before the data source.
     *
     * @param format what the bytes mean
     * @throws IllegalArgumentException naming the value that is out of range
     * @throws IllegalStateException in another state
     */
    public void setPcmFormat(PcmMediaInfo format) {
        format.check();
        states.require("setPcmFormat()", EnumSet.of(PlayerState.IDLE));
        peer.native_setPcmMediaInfo(format);
        peer.native_setPcmFlag();
    }

    /**
     * Chooses where the picture goes. Every state. Waits for a {@link #prepare()} that blocks on
     * another thread.
     *
     * @param surface a surface that is not released; null for no picture
     * @throws IllegalArgumentException when the surface was released or nobody consumes it; the
     *     picture stays where it was
     * @throws IllegalStateException after release
     */
    public void setSurface(Surface surface) {
        states.requireAlive("setSurface()");
        bindSurface(surface);
    }

    /**
     * Opens the media and blocks until it is ready. State: INITIALIZED or STOPPED; then PREPARED,
     * or ERROR when it throws.
     *
     * @throws MediaException when the media cannot be opened or played, or reset or release came
     *     between
     * @throws IllegalStateException in another state
     */
    public void prepare() throws IOException {
        int epoch = states.enter("prepare()", CAN_PREPARE, PlayerState.PREPARING);
        prepareWith(epoch, this::prepareWithSurface);
        events().prepared(epoch);
    }

    /**
     * Begins to open the media. State: INITIALIZED or STOPPED; then PREPARING, and later PREPARED
     * with {@link PlayerListener#onPrepared} or ERROR with {@link PlayerListener#onError}.
     *
     * @throws MediaException when the engine refuses at once
     * @throws IllegalStateException in another state
     */
    public void prepareAsync() throws IOException {
        int epoch = states.enter("prepareAsync()", CAN_PREPARE, PlayerState.PREPARING);
        prepareWith(epoch, peer::native_prepareAsync);
        wakeToPreparing(epoch);
    }

    /**
     * Plays, from the start when the media had come to its end. State: PREPARED, STARTED, PAUSED or
     * COMPLETED; then STARTED.
     *
     * @throws IllegalStateException in another state, or when the engine refuses
     */
    public void start() {
        Set<PlayerState> media = StateMachine.WITH_MEDIA;
        command("start()", media, media, PlayerState.STARTED, peer::native_start);
        wake();
    }

    /**
     * Halts at the present position. State: STARTED, PAUSED or COMPLETED; then PAUSED, but
     * COMPLETED stays.
     *
     * @throws IllegalStateException in another state, or when the engine refuses
     */
    public void pause() {
        command("pause()", CAN_PAUSE, RUNNING, PlayerState.PAUSED, peer::native_pause);
    }

    /**
     * Stops; the player must be prepared again before it can play. State: PREPARED, STARTED,
     * PAUSED, COMPLETED or STOPPED; then STOPPED.
     *
     * @throws IllegalStateException in another state, or when the engine refuses
     */
    public void stop() {
        command("stop()", CAN_STOP, CAN_STOP, PlayerState.STOPPED, peer::native_stop);
    }

    /**
     * Forgets the media; no listener is told anything more of it. State: every one but RELEASED;
     * then IDLE. Ends a {@link #prepare()} that blocks on another thread. A listener call that is
     * running on another thread is waited for, at most 100 ms.
     *
     * @throws MediaException when the engine fails; the state is ERROR then
     * @throws IllegalStateException after release
     */
    public void reset() throws IOException {
        states.requireAlive("reset()");
        states.endEpoch(PlayerState.IDLE);
        try {
            peer.native_reset();
        } catch (IOException e) {
            states.move(states.epoch(), EnumSet.of(PlayerState.IDLE), PlayerState.ERROR);
            throw new MediaException("reset() failed", MediaException.STATUS_UNKNOWN, e);
        } finally {
            forgetMedia();
        }
    }

    /**
     * Gives up everything that the player holds. Listeners are told nothing more: a call that is
     * running on another thread is waited for, at most 100 ms. State: every one; then RELEASED. A
     * second call does nothing.
     *
     * @throws IllegalStateException when the engine fails; the player is released all the same
     */
    public void release() {
        if (states.endEpoch(PlayerState.RELEASED) == PlayerState.RELEASED) {
            return;
        }
        try {
            releaseWithSurface();
        } catch (IllegalStateException e) {
            throw Failures.refused("release()", e);
        } finally {
            forgetMedia();
            stopWatching();
        }
    }

    /** The same as {@link #release()}. */
    @Override
    public void close() {
        release();
    }

    /**
     * Goes to a key frame at or before a time, and blocks until it is shown, for a limited time.
     * State: PREPARED, STARTED, PAUSED or COMPLETED; COMPLETED becomes PAUSED or STARTED, as the
     * engine goes on.
     *
     * @param millis milliseconds from the start; past the end means the end
     * @throws IllegalArgumentException when it is negative
     * @throws IllegalStateException in another state, or when the engine cannot seek
     */
    public void seekTo(int millis) {
        if (millis < 0) {
            throw new IllegalArgumentException("a position cannot be negative: " + millis);
        }
        seek("seekTo(" + millis + ")", () -> peer.native_seekTo(millis));
    }

    /**
     * Whether the picture and sound run. Every state.
     *
     * @return true while they do
     * @throws IllegalStateException after release
     */
    public boolean isPlaying() {
        states.requireAlive("isPlaying()");
        return getState() == PlayerState.STARTED && peer.native_isPlaying();
    }

    /**
     * Where the media stands. Every state.
     *
     * @return milliseconds; 0 before it is prepared and after it failed
     * @throws IllegalStateException after release
     */
    public int getCurrentPosition() {
        states.requireAlive("getCurrentPosition()");
        if (!hasMedia()) {
            return 0;
        }
        try {
            return peer.native_getCurrentPosition();
        } catch (IOException | IllegalStateException e) {
            return 0; // The media failed or went just now; the watcher tells.
        }
    }

    /**
     * How long the media is. Every state.
     *
     * @return milliseconds; 0 before it is prepared, or when unknown
     * @throws IllegalStateException after release
     */
    public int getDuration() {
        states.requireAlive("getDuration()");
        return hasMedia() ? peer.native_getDuration() : 0;
    }

    /**
     * The picture's width. Every state.
     *
     * @return pixels; 0 before it is known
     * @throws IllegalStateException after release
     */
    public int getVideoWidth() {
        states.requireAlive("getVideoWidth()");
        return peer.native_getVideoWidth();
    }

    /**
     * The picture's height. Every state.
     *
     * @return rows; 0 before it is known
     * @throws IllegalStateException after release
     */
    public int getVideoHeight() {
        states.requireAlive("getVideoHeight()");
        return peer.native_getVideoHeight();
    }

    /**
     * Begins again at the end, or not. Every state.
     *
     * @param looping true to begin again
     * @throws IllegalStateException after release, or when the engine refuses
     */
    public void setLooping(boolean looping) {
        states.requireAlive("setLooping()");
        run("setLooping()", () -> peer.native_setLooping(looping));
    }

    /**
     * Whether the player begins again at the end. Every state.
     *
     * @return what was last set
     * @throws IllegalStateException after release
     */
    public boolean isLooping() {
        states.requireAlive("isLooping()");
        return peer.native_isLooping();
    }

    private static String required(String pathOrUrl) {
        if (pathOrUrl == null) {
            throw new IllegalArgumentException("the path or URL is null");
        }
        return pathOrUrl;
    }
}
