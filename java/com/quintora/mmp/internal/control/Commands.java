// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.EngineCall;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.events.EndOfMedia;
import com.quintora.mmp.internal.events.Events;
import com.quintora.mmp.internal.events.Watcher;
import com.quintora.mmp.internal.failure.Failures;
import com.quintora.mmp.internal.state.StateMachine;
import java.io.IOException;
import java.util.Set;
import java.util.function.Supplier;

/** Calls the engine in the states that allow it, and keeps the state in step. Thread-safe. */
public final class Commands {
    final StateMachine states;
    final Events events;
    final Watcher watcher;
    private final NativePlayer natives;
    private final EndOfMedia end;

    public Commands(
            NativePlayer natives, StateMachine states, Events events, Watcher watcher,
            EndOfMedia end) {
        this.natives = natives;
        this.states = states;
        this.events = events;
        this.watcher = watcher;
        this.end = end;
    }

    /** An exception once the player is released. */
    public void requireAlive(String call) {
        states.requireAlive(call);
    }

    /** The running epoch, or an exception when the player has no prepared media. */
    public int requireMedia(String call) {
        return states.require(call, StateMachine.WITH_MEDIA);
    }

    public boolean hasMedia() {
        return states.hasMedia();
    }

    /** An exception when a reset or release has ended that epoch. */
    void requireCurrent(String call, int epoch) {
        states.requireAlive(call);
        if (!states.isCurrent(epoch)) {
            throw new IllegalStateException(call + " was ended by a reset");
        }
    }

    /** The player runs otherwise than before: looks at it follow that. */
    public void runsOtherwise() {
        watcher.wake();
    }

    /** Runs an engine command whose failure can only mean a state of the engine's. */
    public void run(String call, EngineCall command) {
        states.requireAlive(call);
        try {
            command.run();
        } catch (IOException | IllegalStateException e) {
            throw refusal(call, e);
        }
    }

    /** Asks the engine something that it can answer in every state. */
    public <T> T ask(String call, Supplier<T> question) {
        states.requireAlive(call);
        try {
            return question.get();
        } catch (IllegalStateException e) {
            throw refusal(call, e);
        }
    }

    /** Why the engine did not do something. */
    public IllegalStateException refusal(String call, Exception thrown) {
        states.requireAlive(call);
        watcher.wake(); // The media may have failed, which the watcher finds out.
        return Failures.refused(call, thrown);
    }

    /** Runs a command that is for some states and leads from some to another. */
    void command(
            String call, Set<PlayerState> allowed, Set<PlayerState> moving, PlayerState to,
            EngineCall command) {
        states.commands.lock();
        try {
            noticeEnd();
            int epoch = states.require(call, allowed);
            run(call, command);
            states.move(epoch, moving, to);
        } finally {
            states.commands.unlock();
            events.flush();
        }
    }

    /** Runs a command that leaves the player halted, in part also when it fails. */
    public void halt(String call, EngineCall command) {
        Set<PlayerState> media = StateMachine.WITH_MEDIA;
        states.commands.lock();
        try {
            command(call, media, media, PlayerState.PAUSED, command);
        } catch (IllegalStateException e) {
            followHalt();
            throw e;
        } finally {
            states.commands.unlock();
            events.flush();
        }
    }

    private void followHalt() {
        int epoch = states.epoch();
        boolean completed = states.isStill(epoch, PlayerState.COMPLETED);
        if (!hasMedia() || completed && end.isReached()) {
            return;
        }
        try {
            if (!natives.isPlaying()) {
                natives.pause();
                states.move(epoch, StateMachine.WITH_MEDIA, PlayerState.PAUSED);
            }
        } catch (IOException | IllegalStateException e) {
            // The engine was not halted: it stands where it did.
        }
    }

    /** Reports an end that the engine has reached and no look has found yet. */
    void noticeEnd() {
        int epoch = states.epoch();
        if (states.isStill(epoch, PlayerState.STARTED) && end.isReached()) {
            events.completed(epoch);
        }
    }
}
