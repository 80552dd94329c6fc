// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.lang.ref.WeakReference;
import java.util.OptionalInt;
import java.util.concurrent.Future;
import java.util.concurrent.atomic.AtomicInteger;

/**
 * Looks at a player from time to time and tells what happened: the engine's own events do not come
 * through. Runs on the threads that all players share, one look after the other, and only while
 * the player has media. Does not keep the player from being collected.
 */
final class Watcher {
    // Milliseconds between looks.
    private static final int PREPARING_FIRST = 20;
    private static final int PREPARING_LATER = 100;
    private static final int PLAYING = 50;
    private static final int RESTING = 500;
    private static final int RESTING_LONG = 5000;
    private static final int NO_MORE = -1;

    // Every how many looks at a playing player the slow values are asked for.
    private static final int SLOW_EVERY = 10;

    private final WeakReference<OrvMediaPlayer> watched;
    private final Turns turns = new Turns(PlayerThreads::run);
    private final AtomicInteger round = new AtomicInteger();
    private volatile int preparingEpoch = -1;
    private volatile Future<?> nextLook;

    // Used in a turn only.
    private int looks;
    private int lastPosition;
    private int lastPercent;

    Watcher(WeakReference<OrvMediaPlayer> watched) {
        this.watched = watched;
    }

    /** Runs something between the looks, after what was given before; not once stopped. */
    void execute(Runnable action) {
        turns.execute(action);
    }

    /** Looks for the end of an asynchronous prepare. */
    void watchPreparing(int epoch) {
        preparingEpoch = epoch;
        wake();
    }

    /** Looks at once, and from then on as often as the player's state needs. */
    void wake() {
        int mine = round.incrementAndGet();
        turns.execute(() -> {
            looks = 0;
            cancelNext();
            look(mine);
        });
    }

    void stop() {
        turns.stop();
        cancelNext();
    }

    private void cancelNext() {
        Future<?> next = nextLook;
        if (next != null) {
            next.cancel(false);
        }
    }

    private void look(int mine) {
        OrvMediaPlayer player = watched.get();
        if (player == null || mine != round.get()) {
            return; // Collected, or a later wake looks instead.
        }
        int delay = observe(player);
        if (delay != NO_MORE) {
            nextLook = PlayerThreads.later(() -> turns.execute(() -> look(mine)), delay);
        }
    }

    private int observe(OrvMediaPlayer player) {
        if (!player.commands.tryLock()) {
            return PREPARING_FIRST; // A command changes the state just now.
        }
        try {
            int epoch = player.states.epoch();
            looks++;
            return switch (player.states.state()) {
                case PREPARING -> observePreparing(player, epoch);
                case STARTED -> observePlaying(player, epoch);
                case PREPARED, PAUSED, COMPLETED -> observeResting(player, epoch);
                default -> NO_MORE;
            };
        } catch (IllegalStateException e) {
            return PLAYING; // The media failed or went just now, which the next look finds.
        } finally {
            player.commands.unlock();
            player.events().flush();
        }
    }

    private int observePreparing(OrvMediaPlayer player, int epoch) {
        if (epoch != preparingEpoch) {
            return NO_MORE; // A blocking prepare tells for itself.
        }
        try {
            player.native_getCurrentPosition();
            player.events().prepared(epoch);
            return NO_MORE; // That woke a round of its own.
        } catch (IllegalStateException e) {
            return looks < SLOW_EVERY ? PREPARING_FIRST : PREPARING_LATER;
        } catch (IOException | SecurityException e) {
            player.events().failed(epoch, e);
            return NO_MORE;
        }
    }

    private int observePlaying(OrvMediaPlayer player, int epoch) {
        OptionalInt position = position(player, epoch);
        if (position.isEmpty()) {
            return PLAYING; // The next look finds another state.
        }
        compare(player, epoch, position.getAsInt());
        lastPosition = position.getAsInt();
        if (looks % SLOW_EVERY == 1) {
            observeSlow(player, epoch);
        }
        return PLAYING;
    }

    /** The position, which tells whether the media failed; empty when they did or are gone. */
    private OptionalInt position(OrvMediaPlayer player, int epoch) {
        try {
            return OptionalInt.of(player.native_getCurrentPosition());
        } catch (IllegalStateException e) {
            return OptionalInt.empty(); // Being reset just now.
        } catch (IOException | SecurityException e) {
            player.events().failed(epoch, e);
            return OptionalInt.empty();
        }
    }

    private void compare(OrvMediaPlayer player, int epoch, int position) {
        if (looks == 1 || player.events().seeking()) {
            return; // Where it was before is another round's, or left by a seek: no movement.
        }
        if (position == lastPosition) {
            observeStanding(player, epoch);
        } else {
            observeMoving(player, epoch);
        }
    }

    private void observeStanding(OrvMediaPlayer player, int epoch) {
        if (player.native_isPlaying()) {
            return;
        }
        if (player.atEnd()) {
            player.events().completed(epoch);
        } else {
            player.events().info(epoch, PlayerListener.INFO_BUFFERING_STARTED, 0);
        }
    }

    private void observeMoving(OrvMediaPlayer player, int epoch) {
        player.events().info(epoch, PlayerListener.INFO_BUFFERING_ENDED, 0);
        player.events().info(epoch, PlayerListener.INFO_RENDERING_STARTED, 0);
    }

    private int observeResting(OrvMediaPlayer player, int epoch) {
        int before = lastPercent;
        if (position(player, epoch).isPresent()) {
            observeSlow(player, epoch);
        }
        return lastPercent == before ? RESTING_LONG : RESTING;
    }

    private void observeSlow(OrvMediaPlayer player, int epoch) {
        lastPercent = player.native_getBufferPercent();
        player.events().buffering(epoch, lastPercent);
        player.events().videoSize(
                epoch, player.native_getVideoWidth(), player.native_getVideoHeight());
    }
}
