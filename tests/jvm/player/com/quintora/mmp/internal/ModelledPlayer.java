// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import static com.quintora.mmp.PlayerState.COMPLETED;
import static com.quintora.mmp.PlayerState.ERROR;
import static com.quintora.mmp.PlayerState.IDLE;
import static com.quintora.mmp.PlayerState.INITIALIZED;
import static com.quintora.mmp.PlayerState.PAUSED;
import static com.quintora.mmp.PlayerState.PREPARED;
import static com.quintora.mmp.PlayerState.RELEASED;
import static com.quintora.mmp.PlayerState.STARTED;
import static com.quintora.mmp.PlayerState.STOPPED;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Wait;
import java.util.EnumSet;
import java.util.List;
import java.util.Set;
import java.util.function.UnaryOperator;

/** A player over scripted natives, beside a model of the state in which it must be. */
final class ModelledPlayer {
    private static final Set<PlayerState> MEDIA = EnumSet.of(PREPARED, STARTED, PAUSED, COMPLETED);
    private static final Set<PlayerState> ALIVE =
            EnumSet.complementOf(EnumSet.of(RELEASED));

    /** What a test does to a player. */
    interface Action {
        void run() throws Exception;
    }

    /**
     * A call, and its rule.
     *
     * @param natively the native method that it leads to, or none when it is empty
     * @param done the state after success, of that before
     * @param refused the state after the engine's refusal
     */
    record Call(
            String name, String natively, Set<PlayerState> allowed, Action action,
            UnaryOperator<PlayerState> done, UnaryOperator<PlayerState> refused) {}

    private final ScriptedNatives natives = new ScriptedNatives();
    final PlayerUnits units = natives.units();
    private PlayerState state = IDLE;

    // The engine.
    private volatile boolean runs;
    private volatile boolean isAtEnd;

    final List<Call> calls = List.of(
            new Call("setDataSource", "setDataSource", EnumSet.of(IDLE),
                    () -> units.sources.set("film.mkv"), was -> INITIALIZED, was -> was),
            new Call("prepareAndWait", "prepare", EnumSet.of(INITIALIZED, STOPPED),
                    units.preparation::prepareAndWait, was -> PREPARED, was -> ERROR),
            new Call("start", "start", MEDIA,
                    units.playback::start, was -> STARTED, was -> was),
            new Call("pause", "pause", EnumSet.of(STARTED, PAUSED, COMPLETED),
                    units.playback::pause, was -> was == COMPLETED ? was : PAUSED, was -> was),
            new Call("stop", "stop", EnumSet.of(PREPARED, STARTED, PAUSED, COMPLETED, STOPPED),
                    units.playback::stop, was -> STOPPED, was -> was),
            new Call("seekToAndWait", "seekTo", MEDIA, () -> units.seeking.seekToAndWait(5),
                    was -> was == COMPLETED ? PAUSED : was, was -> was),
            new Call("setLooping", "setLooping", ALIVE, () -> units.playback.setLooping(true),
                    was -> was, was -> was),
            new Call("resetAndWait", "reset", ALIVE, units.lifetime::resetAndWait,
                    was -> IDLE, was -> ERROR),
            new Call("isPlaying", "", ALIVE,
                    () -> assertEquals(state == STARTED, units.playback.isPlaying()),
                    was -> was, was -> was),
            new Call("getCurrentPosition", "", ALIVE,
                    () -> assertEquals(MEDIA.contains(state) ? position() : 0,
                            units.playback.position()),
                    was -> was, was -> was),
            new Call("close", "", EnumSet.allOf(PlayerState.class),
                    this::closeRarely, was -> was, was -> was));

    ModelledPlayer() {
        natives.answer("isPlaying", () -> runs);
        natives.answer("getCurrentPosition", this::position);
        natives.answer("getDuration", () -> 10);
        accept();
    }

    /** Makes the call, which the engine refuses when it is asked, and compares. */
    void make(Call call, boolean refuses) throws Exception {
        PlayerState before = state;
        boolean allowed = call.allowed().contains(before);
        boolean asks = !call.natively().isEmpty();
        if (refuses && asks) {
            natives.answer(call.natively(), () -> {
                throw new IllegalStateException("busy");
            });
        }
        long asked = natives.count(call.natively());
        Exception thrown = null;
        try {
            call.action().run();
        } catch (Exception e) {
            thrown = e;
        }
        accept();
        boolean fails = !allowed || refuses && asks;
        if (fails) {
            assertTrue(thrown instanceof IllegalStateException, call.name() + " threw " + thrown);
        } else if (thrown != null) {
            throw thrown;
        }
        if (allowed && !call.name().equals("close")) {
            state = (fails ? call.refused() : call.done()).apply(before);
        }
        assertEquals(asked + (allowed && asks ? 1 : 0), natives.count(call.natively()),
                "how often " + call.name() + " asked the engine");
        assertState();
    }

    /** The media end: the player notices, at the next command at the latest. */
    void reachEnd() {
        if (state == STARTED) {
            isAtEnd = true;
            runs = false;
            state = COMPLETED;
        }
    }

    private void closeRarely() {
        if (units.states.epoch() % 4 == 3) {
            units.lifetime.close();
            state = RELEASED;
        }
    }

    private void assertState() throws Exception {
        if (isAtEnd) {
            Wait.until("the state is " + state, () -> units.states.state() == state);
        }
        assertEquals(state, units.states.state());
        assertFalse(units.states.commands.isHeldByCurrentThread(), "a lock is held");
    }

    private int position() {
        return isAtEnd ? 10 : 1;
    }

    // The engine refuses nothing.
    private void accept() {
        natives.answer("setDataSource", () -> null);
        natives.answer("prepare", () -> move(false));
        natives.answer("start", () -> move(true));
        natives.answer("pause", () -> halt());
        natives.answer("stop", () -> move(false));
        natives.answer("seekTo", () -> move(runs));
        natives.answer("setLooping", () -> null);
        natives.answer("reset", () -> move(false));
    }

    private Object move(boolean running) {
        isAtEnd = false;
        runs = running;
        return null;
    }

    private Object halt() {
        runs = false;
        return null;
    }
}
