// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.base.Turns;
import java.lang.ref.WeakReference;
import java.util.concurrent.Future;
import org.jetbrains.annotations.Nullable;

/**
 * Has a player looked at from time to time, on the threads that all players share, one look after
 * the other, and only while the player has media. Does not keep the player from being collected.
 */
public final class Watcher {
    private final Turns turns = new Turns(PlayerThreads::run);
    private final WeakReference<PlayerObserver> observer;
    // Counted in turns: rounds begin in the order in which they are numbered, or an earlier
    // one would end the looks of a later one.
    private int round;
    private volatile int preparingEpoch = -1;
    private volatile @Nullable Future<?> nextLook;

    /** The observer is held by the player alone. */
    public Watcher(PlayerObserver observer) {
        this.observer = new WeakReference<>(observer);
    }

    /** Runs something between the looks, after what was given before; not once stopped. */
    void execute(Runnable action) {
        turns.execute(action);
    }

    /** Looks for the end of an asynchronous prepare. */
    public void watchPreparing(int epoch) {
        preparingEpoch = epoch;
        wake();
    }

    /** Looks at once, and from then on as often as the player's state needs. */
    public void wake() {
        turns.execute(() -> {
            int mine = ++round;
            PlayerObserver looking = observer.get();
            if (looking != null) {
                looking.begin();
            }
            cancelNext();
            look(mine);
        });
    }

    public void stop() {
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
        PlayerObserver looking = observer.get();
        if (looking == null || mine != round) {
            return; // Collected, or a later wake looks instead.
        }
        int delay = looking.look(preparingEpoch);
        if (delay == PlayerObserver.ANEW) {
            wake();
        } else if (delay != PlayerObserver.NO_MORE) {
            nextLook = PlayerThreads.later(() -> turns.execute(() -> look(mine)), delay);
        }
    }
}
