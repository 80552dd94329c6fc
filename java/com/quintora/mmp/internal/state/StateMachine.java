// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.state;

import com.quintora.mmp.PlayerState;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.locks.ReentrantLock;

/**
 * A player's state, and the lock under which it changes together with the engine. Each reset begins
 * an epoch: what was begun in one epoch must not act in a later one, so every move names the epoch
 * that it belongs to. Thread-safe.
 */
public final class StateMachine {
    public static final Set<PlayerState> WITH_MEDIA = EnumSet.of(
            PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED, PlayerState.COMPLETED);

    /**
     * Held over the engine calls that change whether the player runs, together with the change of
     * state that they mean. Never held while a listener is called.
     */
    public final ReentrantLock commands = new ReentrantLock();

    private PlayerState state = PlayerState.IDLE;
    private int epoch;

    public synchronized PlayerState state() {
        return state;
    }

    public synchronized int epoch() {
        return epoch;
    }

    public synchronized boolean isCurrent(int epoch) {
        return this.epoch == epoch;
    }

    public synchronized boolean isStill(int epoch, PlayerState state) {
        return this.epoch == epoch && this.state == state;
    }

    /** Moves if the epoch still runs and the state is one of those, and returns whether it did. */
    public synchronized boolean move(int epoch, Set<PlayerState> from, PlayerState to) {
        if (this.epoch != epoch || !from.contains(state)) {
            return false;
        }
        state = to;
        return true;
    }

    /** Ends the epoch, whatever the state, and returns that state. */
    public synchronized PlayerState endEpoch(PlayerState to) {
        PlayerState was = state;
        if (was != PlayerState.RELEASED) {
            epoch++;
            state = to;
        }
        return was;
    }

    /**
     * Begins the next epoch with a reset: in ERROR, where nothing else is possible, until a move to
     * IDLE says that it is done.
     */
    public synchronized int beginReset(String call) {
        requireAlive(call);
        state = PlayerState.ERROR;
        return ++epoch;
    }

    /** The running epoch, or an exception when the state is none of those. */
    public synchronized int require(String call, Set<PlayerState> allowed) {
        if (!allowed.contains(state)) {
            throw new IllegalStateException(refusal(call, allowed));
        }
        return epoch;
    }

    /** As require, and moves on. */
    public synchronized int enter(String call, Set<PlayerState> allowed, PlayerState to) {
        require(call, allowed);
        state = to;
        return epoch;
    }

    /** An exception once the player is released. */
    public synchronized int requireAlive(String call) {
        if (state == PlayerState.RELEASED) {
            throw new IllegalStateException(refusal(call, Set.of()));
        }
        return epoch;
    }

    public synchronized boolean hasMedia() {
        return WITH_MEDIA.contains(state);
    }

    private String refusal(String call, Set<PlayerState> allowed) {
        if (state == PlayerState.RELEASED) {
            return call + " was called after the player was released";
        }
        return call + " was called in the state " + state + "; it is for " + allowed;
    }
}
