// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.view.Surface;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.Executor;

/** The part of {@link OrvMediaPlayer} that plays media. */
abstract sealed class Playback extends DataSources implements AutoCloseable permits OrvMediaPlayer {
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
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException after release
     */
    public void addListener(PlayerListener listener) {
        states.requireAlive("addListener()");
        events().listeners.add(Arguments.require(listener, "the listener"));
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
     * Chooses where the picture goes. Every state. Waits for a {@link #prepare()} that blocks on
     * another thread.
     *
     * @param surface a surface that is not released; null for no picture
     * @throws IllegalArgumentException when the surface was released or nobody consumes it; the
     *     picture stays where it was
     * @throws IllegalStateException after release
     */
    public void setSurface(Surface surface) {
        run("setSurface()", () -> bindSurface(surface));
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
     * @throws MediaException when the engine refuses at once, or reset or release came between
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
     * COMPLETED stays. A player that has just come to its end becomes COMPLETED.
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
     * then IDLE, and ERROR until that is done. Ends a {@link #prepare()} that blocks on another
     * thread. A listener call that is running on another thread is waited for, at most 100 ms, and
     * so is a {@link MediaStreamSource} whose methods are running.
     *
     * @throws MediaException when the engine fails; the state stays ERROR then
     * @throws IllegalStateException after release
     */
    public void reset() throws IOException {
        int epoch = states.beginReset("reset()");
        try {
            peer.native_reset();
        } catch (IOException e) {
            throw new MediaException("reset() failed", MediaException.STATUS_UNKNOWN, e);
        } catch (IllegalStateException e) {
            throw refusal("reset()", e);
        } finally {
            forgetMedia();
        }
        states.move(epoch, EnumSet.of(PlayerState.ERROR), PlayerState.IDLE);
    }

    /**
     * Gives up everything that the player holds. Listeners are told nothing more: a call that is
     * running on another thread is waited for, at most 100 ms, and so is a {@link
     * MediaStreamSource} whose methods are running. State: every one; then RELEASED. A second call
     * does nothing.
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
        return ask("isPlaying()",
                () -> getState() == PlayerState.STARTED && peer.native_isPlaying());
    }

    /**
     * Where the media stands. Every state.
     *
     * @return milliseconds; 0 before it is prepared and after it failed
     * @throws IllegalStateException after release
     */
    public int getCurrentPosition() {
        return ofMedia("getCurrentPosition()", peer::native_getCurrentPosition);
    }

    /**
     * How long the media is. Every state.
     *
     * @return milliseconds; 0 before it is prepared, or when unknown
     * @throws IllegalStateException after release
     */
    public int getDuration() {
        return ofMedia("getDuration()", peer::native_getDuration);
    }

    /**
     * The picture's width. Every state.
     *
     * @return pixels; 0 before it is known
     * @throws IllegalStateException after release
     */
    public int getVideoWidth() {
        return ask("getVideoWidth()", peer::native_getVideoWidth);
    }

    /**
     * The picture's height. Every state.
     *
     * @return rows; 0 before it is known
     * @throws IllegalStateException after release
     */
    public int getVideoHeight() {
        return ask("getVideoHeight()", peer::native_getVideoHeight);
    }

    /**
     * Begins again at the end, or not. Every state.
     *
     * @param looping true to begin again
     * @throws IllegalStateException after release, or when the engine refuses
     */
    public void setLooping(boolean looping) {
        run("setLooping()", () -> peer.native_setLooping(looping));
    }

    /**
     * Whether the player begins again at the end. Every state.
     *
     * @return what was last set
     * @throws IllegalStateException after release
     */
    public boolean isLooping() {
        return ask("isLooping()", peer::native_isLooping);
    }

    /** What the engine says of its media; 0 when there are none. */
    private int ofMedia(String call, EngineValue value) {
        states.requireAlive(call);
        try {
            return hasMedia() ? value.get() : 0;
        } catch (IOException | IllegalStateException e) {
            return 0; // They failed or went just now; the watcher tells.
        }
    }

    private interface EngineValue {
        int get() throws IOException;
    }
}
