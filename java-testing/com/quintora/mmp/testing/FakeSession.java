// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.VideoTrack;
import java.time.Duration;
import java.util.EnumSet;
import java.util.Optional;
import java.util.Set;
import org.jetbrains.annotations.Nullable;

/**
 * The media that a fake player has, where it stands and how it goes on. Used under the guard, but
 * for the guard itself.
 */
final class FakeSession {
    private static final Set<PlayerState> RUNNING =
            EnumSet.of(PlayerState.STARTED, PlayerState.PAUSED);
    private static final Set<PlayerState> CAN_PAUSE =
            EnumSet.of(PlayerState.STARTED, PlayerState.PAUSED, PlayerState.COMPLETED);
    private static final Set<PlayerState> CAN_STOP = EnumSet.of(
            PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED, PlayerState.COMPLETED,
            PlayerState.STOPPED);
    private static final Set<PlayerState> CAN_FAIL = EnumSet.of(
            PlayerState.PREPARING, PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED,
            PlayerState.COMPLETED, PlayerState.STOPPED);
    private static final double NANOS_PER_MILLI = 1e6;

    final MediaPlayer player;
    final FakeState state = new FakeState();
    final FakeEvents events;
    final Guard guard;
    final Playhead head = new Playhead();
    FakeMedia media;
    private boolean buffering;
    private int bufferedPercent;
    private @Nullable FakeMedia opened;

    FakeSession(MediaPlayer player, FakeEvents events, FakeMedia media) {
        this.player = player;
        this.events = events;
        this.media = media;
        guard = new Guard(events);
    }

    @Nullable FakeMedia opened() {
        return state.hasMedia() ? opened : null;
    }

    void open() {
        opened = media;
        head.begin(media.duration().toMillis());
        buffering = false;
        bufferedPercent = media.bufferedPercent();
        state.set(PlayerState.PREPARED);
        events.report(listener -> listener.onPrepared(player));
        events.buffering(bufferedPercent);
        media.picture().ifPresent(track -> events.videoSize(track.width(), track.height()));
    }

    void forget() {
        opened = null;
        buffering = false;
        head.begin(0);
        events.forget();
    }

    void start() {
        state.requireMedia("start()");
        if (state.is(PlayerState.COMPLETED)) {
            head.goTo(0);
        }
        state.set(PlayerState.STARTED);
    }

    void pause() {
        state.require("pause()", CAN_PAUSE);
        if (RUNNING.contains(state.get())) {
            state.set(PlayerState.PAUSED);
        }
    }

    void stop() {
        state.require("stop()", CAN_STOP);
        state.set(PlayerState.STOPPED);
        buffering = false;
    }

    boolean isPlaying() {
        return state.is(PlayerState.STARTED) && !buffering;
    }

    /** Goes there; at the end of the media the player stays what it is until it plays on. */
    void seekTo(double millis) {
        head.goTo(millis);
        if (state.is(PlayerState.COMPLETED)) {
            state.set(PlayerState.PAUSED);
        }
        events.report(listener -> listener.onSeekComplete(player));
    }

    void play(Duration time) {
        if (!isPlaying() || time.isZero()) {
            return;
        }
        events.rendering();
        if (head.play(time.toNanos() / NANOS_PER_MILLI)) {
            complete();
        }
    }

    void finish() {
        state.require("finish()", EnumSet.of(PlayerState.STARTED));
        complete();
    }

    private void complete() {
        events.rendering();
        head.toEnd();
        state.set(PlayerState.COMPLETED);
        events.report(listener -> listener.onCompletion(player));
    }

    void fail(String call, MediaException error) {
        state.require(call, CAN_FAIL);
        state.set(PlayerState.ERROR);
        events.report(listener -> listener.onError(player, error));
    }

    /** As an engine that failed, which takes little but a reset. */
    void requireWorking(String call) {
        if (state.is(PlayerState.ERROR)) {
            throw new IllegalStateException("the engine refused " + call);
        }
    }

    void setBuffering(String call, boolean waits) {
        state.require(call, EnumSet.of(PlayerState.STARTED));
        if (buffering != waits) {
            buffering = waits;
            events.info(waits
                    ? PlaybackInfo.Kind.BUFFERING_STARTED
                    : PlaybackInfo.Kind.BUFFERING_ENDED);
        }
    }

    int videoWidth() {
        return picture().map(VideoTrack::width).orElse(0);
    }

    int videoHeight() {
        return picture().map(VideoTrack::height).orElse(0);
    }

    /** The engine knows its last picture until a reset. */
    private Optional<VideoTrack> picture() {
        return Optional.ofNullable(opened).flatMap(FakeMedia::picture);
    }

    int bufferedPercent() {
        return opened() == null ? 0 : bufferedPercent;
    }

    void setBufferedPercent(int percent) {
        state.requireMedia("setBufferedPercent()");
        bufferedPercent = FakeMedia.requirePercent(percent);
        events.buffering(percent);
    }
}
