// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.lang.ref.WeakReference;
import java.util.OptionalInt;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.ScheduledThreadPoolExecutor;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicInteger;

/**
 * Looks at a player from time to time and tells what happened: the engine's own events do not come
 * through. Runs on a daemon thread of its own, which starts with the first look and does not keep
 * the player from being collected.
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

    private static final AtomicInteger NUMBER = new AtomicInteger();

    private final WeakReference<OrvMediaPlayer> watched;
    private final ScheduledThreadPoolExecutor thread;
    private final AtomicInteger round = new AtomicInteger();
    private volatile int preparingEpoch = -1;

    // Used on the watching thread only.
    private int looks;
    private int lastPosition;
    private int lastPercent;

    Watcher(WeakReference<OrvMediaPlayer> watched) {
        this.watched = watched;
        thread = new ScheduledThreadPoolExecutor(1, Watcher::newThread);
        thread.setExecuteExistingDelayedTasksAfterShutdownPolicy(false);
    }

    /** Runs something on the watching thread, after what was given before; not once stopped. */
    void execute(Runnable action) {
        try {
            thread.execute(action);
        } catch (RejectedExecutionException e) {
            // The player was released: nobody is to be told.
        }
    }

    /** Looks for the end of an asynchronous prepare. */
    void watchPreparing(int epoch) {
        preparingEpoch = epoch;
        wake();
    }

    /** Looks at once, and from then on as often as the player's state needs. */
    void wake() {
        int mine = round.incrementAndGet();
        execute(() -> {
            looks = 0;
            look(mine);
        });
    }

    void stop() {
        thread.shutdown();
    }

    private static Thread newThread(Runnable work) {
        Thread thread = new Thread(work, "OrvMediaPlayer-" + NUMBER.incrementAndGet());
        thread.setDaemon(true);
        return thread;
    }

    private void look(int mine) {
        OrvMediaPlayer player = watched.get();
        if (player == null || mine != round.get()) {
            return; // Collected, or a later wake looks instead.
        }
        int delay = observe(player);
        if (delay != NO_MORE) {
            later(mine, delay);
        }
    }

    private void later(int mine, int delay) {
        try {
            thread.schedule(() -> look(mine), delay, TimeUnit.MILLISECONDS);
        } catch (RejectedExecutionException e) {
            // The player was released meanwhile.
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
