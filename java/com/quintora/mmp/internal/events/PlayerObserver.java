// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.state.StateMachine;
import java.io.IOException;
import java.util.OptionalInt;

/**
 * Looks at a player and reports what happened since the last look: the engine's own events do not
 * come through. Used by one thread at a time.
 */
public final class PlayerObserver {
    /** No look is needed until the player's state changes. */
    static final int NO_MORE = -1;

    /** A prepare has ended well: look anew. */
    static final int ANEW = -2;

    // Milliseconds between looks.
    private static final int PREPARING_FIRST = 20;
    private static final int PREPARING_LATER = 100;
    private static final int PLAYING = 50;
    private static final int RESTING = 500;
    private static final int RESTING_LONG = 5000;

    // Every how many looks at a playing player the slow values are asked for.
    private static final int SLOW_EVERY = 10;

    private final NativePlayer natives;
    private final StateMachine states;
    private final Events events;
    private final EndOfMedia end;
    private int looks;
    private int lastPosition;
    private int lastPercent;

    public PlayerObserver(
            NativePlayer natives, StateMachine states, Events events, EndOfMedia end) {
        this.natives = natives;
        this.states = states;
        this.events = events;
        this.end = end;
    }

    /** Begins a round of looks. */
    void begin() {
        looks = 0;
    }

    /**
     * Looks once.
     *
     * @param preparing the epoch of an asynchronous prepare, others report for themselves
     * @return milliseconds until the next look, NO_MORE or ANEW
     */
    int look(int preparing) {
        if (!states.commands.tryLock()) {
            return PREPARING_FIRST; // A command changes the state just now.
        }
        try {
            int epoch = states.epoch();
            looks++;
            return switch (states.state()) {
                case PREPARING -> epoch == preparing ? lookPreparing(epoch) : NO_MORE;
                case STARTED -> lookPlaying(epoch);
                case PREPARED, PAUSED, COMPLETED -> lookResting(epoch);
                default -> NO_MORE;
            };
        } catch (IllegalStateException e) {
            return PLAYING; // The media failed or went just now, which the next look finds.
        } finally {
            states.commands.unlock();
            events.flush();
        }
    }

    private int lookPreparing(int epoch) {
        try {
            natives.getCurrentPosition();
            return events.prepared(epoch) ? ANEW : NO_MORE;
        } catch (IllegalStateException e) {
            return looks < SLOW_EVERY ? PREPARING_FIRST : PREPARING_LATER;
        } catch (IOException | SecurityException e) {
            events.failed(epoch, e);
            return NO_MORE;
        }
    }

    private int lookPlaying(int epoch) {
        OptionalInt position = position(epoch);
        if (position.isEmpty()) {
            return PLAYING; // The next look finds another state.
        }
        compare(epoch, position.getAsInt());
        lastPosition = position.getAsInt();
        if (looks % SLOW_EVERY == 1) {
            lookSlow(epoch);
        }
        return PLAYING;
    }

    /** The position, which says whether the media failed; empty when they did or are gone. */
    private OptionalInt position(int epoch) {
        try {
            return OptionalInt.of(natives.getCurrentPosition());
        } catch (IllegalStateException e) {
            return OptionalInt.empty(); // Being reset just now.
        } catch (IOException | SecurityException e) {
            events.failed(epoch, e);
            return OptionalInt.empty();
        }
    }

    private void compare(int epoch, int position) {
        if (looks == 1 || events.seeking()) {
            return; // Where it was before is another round's, or left by a seek: no movement.
        }
        if (position == lastPosition) {
            lookStanding(epoch);
        } else {
            events.info(epoch, PlaybackInfo.of(PlaybackInfo.Kind.BUFFERING_ENDED));
            events.info(epoch, PlaybackInfo.of(PlaybackInfo.Kind.RENDERING_STARTED));
        }
    }

    private void lookStanding(int epoch) {
        if (natives.isPlaying()) {
            return;
        }
        if (end.isReached()) {
            events.completed(epoch);
        } else {
            events.info(epoch, PlaybackInfo.of(PlaybackInfo.Kind.BUFFERING_STARTED));
        }
    }

    private int lookResting(int epoch) {
        int before = lastPercent;
        if (position(epoch).isPresent()) {
            lookSlow(epoch);
        }
        return lastPercent == before ? RESTING_LONG : RESTING;
    }

    private void lookSlow(int epoch) {
        lastPercent = natives.getBufferPercent();
        events.buffering(epoch, lastPercent);
        events.videoSize(epoch, natives.getVideoWidth(), natives.getVideoHeight());
    }
}
