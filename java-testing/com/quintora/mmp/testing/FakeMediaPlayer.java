// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static com.quintora.mmp.testing.FakeState.requireValue;

import android.view.Surface;
import com.quintora.mmp.AudioOutput;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.Pictures;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Subtitles;
import com.quintora.mmp.Tracks;
import com.quintora.mmp.TrickPlay;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.time.Duration;
import java.util.Map;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.Executor;
import org.jetbrains.annotations.Nullable;

/**
 * A {@link MediaPlayer} for the tests of programs: it has the states, events, refusals and sentences
 * of the real one, but plays {@link FakeMedia}, whatever the data source, and stands still until the
 * test lets time pass by {@link #advance}.
 *
 * <pre>{@code
 * FakeMediaPlayer player = new FakeMediaPlayer();
 * MyScreen screen = new MyScreen(player);
 * screen.play("/media/film.mkv");
 * player.control().advance(Duration.ofSeconds(10));
 * assertEquals("The end", screen.title());
 * }</pre>
 *
 * <p>Nothing blocks, and no thread is started: what takes its time with the real player is done when
 * the call returns, unless the test holds it back ({@link FakeMediaBuilder#openingTime}, {@link
 * FakeControl#holdSeeks}). Every time is a key frame. Sound and picture go nowhere.
 *
 * <p><b>Threads.</b> Any thread may call any method at any time. Listeners are called by the
 * executor; without one by the calling thread, before the method returns, but from inside a listener
 * after that one.
 */
public final class FakeMediaPlayer implements MediaPlayer {
    private final FakeSession session;
    private final FakeSources sources;
    private final FakePreparation preparation;
    private final FakeSeeking seeking;
    private final FakeTables tables;
    private final FakeTracks tracks;
    private final FakeSubtitles subtitles;
    private final FakePictures pictures;
    private final FakeTrickPlay trickPlay;
    private final FakeAudioOutput audio;
    private final FakeControl control;

    /** A player of {@link FakeMedia#any()} that calls its listeners on the calling thread. */
    public FakeMediaPlayer() {
        this(FakeMedia.any());
    }

    /**
     * A player that calls its listeners on the calling thread.
     *
     * @param media what it plays
     */
    public FakeMediaPlayer(FakeMedia media) {
        this(media, Runnable::run);
    }

    /**
     * A player.
     *
     * @param media what it plays
     * @param executor calls the listeners, one call after the other
     * @throws IllegalArgumentException when one of them is null
     */
    public FakeMediaPlayer(FakeMedia media, Executor executor) {
        FakeEvents events = new FakeEvents(this, requireValue(executor, "the executor"));
        session = new FakeSession(this, events, requireValue(media, "the media"));
        sources = new FakeSources(session);
        preparation = new FakePreparation(session, sources);
        seeking = new FakeSeeking(session);
        tables = new FakeTables(session);
        tracks = new FakeTracks(session, tables);
        subtitles = new FakeSubtitles(session, tables);
        pictures = new FakePictures(session);
        trickPlay = new FakeTrickPlay(session);
        audio = new FakeAudioOutput(session.guard, session.state);
        control = new FakeControl(session, sources, preparation, seeking, subtitles);
    }

    /**
     * The test's side: the clock, failures to order, and what the program has set.
     *
     * @return the same object always
     */
    public FakeControl control() {
        return control;
    }

    /**
     * Lets time pass; as {@link FakeControl#advance}.
     *
     * @param time how much
     * @throws IllegalArgumentException when it is negative
     */
    public void advance(Duration time) {
        control.advance(time);
    }

    @Override public void addListener(PlayerListener listener) {
        alive("addListener()", () -> {
            session.events.addListener(requireValue(listener, "the listener"));
            return null;
        });
    }
    @Override public void removeListener(PlayerListener listener) {
        session.events.removeListener(listener);
    }
    @Override public PlayerState getState() { return session.guard.ask(session.state::get); }

    @Override public void setDataSource(String s) throws IOException { sources.set(s); }
    @Override public void setDataSource(String url, Map<String, String> headers)
            throws IOException { sources.set(url, headers); }
    @Override public void setDataSource(FileDescriptor fd, long offset, long length)
            throws IOException { sources.set(fd, offset, length); }
    @Override public void setDataSource(MediaStreamSource s) throws IOException { sources.set(s); }
    @Override public void setPcmFormat(PcmMediaInfo format) { sources.setPcmFormat(format); }
    @Override public void setSurface(@Nullable Surface surface) {
        alive("setSurface()", () -> {
            control.setSurface(surface);
            return null;
        });
    }

    @Override public CompletableFuture<Void> prepareAsync() { return preparation.prepareAsync(); }
    @Override public void prepareAndWait() throws IOException { preparation.prepareAndWait(); }
    @Override public void start() { session.guard.run(session::start); }
    @Override public void pause() { session.guard.run(session::pause); }
    @Override public void stop() { session.guard.run(session::stop); }
    @Override public CompletableFuture<Boolean> seekTo(int ms) { return seeking.seekTo(ms); }
    @Override public void seekToAndWait(int millis) { seeking.seekToAndWait(millis); }

    @Override public CompletableFuture<Void> reset() {
        reset("reset()");
        return CompletableFuture.completedFuture(null);
    }
    @Override public void resetAndWait() { reset("resetAndWait()"); }
    @Override public CompletableFuture<Void> release() {
        close();
        return CompletableFuture.completedFuture(null);
    }
    @Override public void close() {
        session.guard.run(() -> {
            if (!session.state.is(PlayerState.RELEASED)) {
                forget(PlayerState.RELEASED, "was called after the player was released");
                session.events.removeAllListeners();
            }
        });
    }

    @Override public boolean isPlaying() { return alive("isPlaying()", session::isPlaying); }
    @Override public int getCurrentPosition() {
        return alive("getCurrentPosition()",
                () -> session.opened() == null ? 0 : (int) session.head.position());
    }
    @Override public int getDuration() {
        return alive("getDuration()", () -> {
            FakeMedia media = session.opened();
            return media == null ? 0 : (int) media.duration().toMillis();
        });
    }
    @Override public int getBufferedPercent() {
        return alive("getBufferedPercent()", session::bufferedPercent);
    }
    @Override public int getVideoWidth() { return alive("getVideoWidth()", session::videoWidth); }
    @Override public int getVideoHeight() {
        return alive("getVideoHeight()", session::videoHeight);
    }
    @Override public void setLooping(boolean looping) {
        alive("setLooping()", () -> {
            session.requireWorking("setLooping()");
            return session.head.looping = looping;
        });
    }
    @Override public boolean isLooping() {
        return alive("isLooping()", () -> session.head.looping);
    }

    @Override public Tracks tracks() { return tracks; }
    @Override public Subtitles subtitles() { return subtitles; }
    @Override public Pictures pictures() { return pictures; }
    @Override public TrickPlay trickPlay() { return trickPlay; }
    @Override public AudioOutput audio() { return audio; }

    private void reset(String call) {
        session.guard.run(() -> {
            session.state.requireAlive(call);
            forget(PlayerState.IDLE, "was ended by a reset");
        });
    }

    private void forget(PlayerState next, String how) {
        session.state.set(next);
        preparation.abort();
        seeking.abort(how);
        sources.forget();
        tables.forget();
        session.forget();
    }

    private <T> T alive(String call, Guard.Action<T, RuntimeException> question) {
        return session.guard.ask(() -> {
            session.state.requireAlive(call);
            return question.run();
        });
    }
}
