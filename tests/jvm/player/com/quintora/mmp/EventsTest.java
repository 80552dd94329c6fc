// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.internal.state.StateMachine;
import java.util.EnumSet;
import org.junit.jupiter.api.Test;

/** What is made of what the engine does: which event, of which media, before which other. */
class EventsTest extends PlayerFixture {
    @Test
    void nothingHasRunBeforeTheFirstMovement() throws Exception {
        prepare("silent.mkv");
        player.start();
        recorder.await("completion");
        player.resetAndWait();
        prepare("video.mp4");
        player.seekToAndWait(4000);
        recorder.reported.clear();
        // A start after which the engine stands.
        int epoch = player.units.states.epoch();
        player.units.states.move(epoch, StateMachine.WITH_MEDIA, PlayerState.STARTED);
        player.units.watcher.wake();
        recorder.await("info 701 0");
        assertEquals(0, recorder.count("info 3 0"));
        player.native_start();
        recorder.await("info 702 0");
        recorder.await("info 3 0");
    }

    @Test
    void aChangeIsNotSeenBeforeItsCallIsQueued() throws Exception {
        player.setDataSource(Media.path("silent.mkv"));
        int epoch = player.units.states.enter("test", EnumSet.of(PlayerState.INITIALIZED),
                PlayerState.PREPARING);
        Thread reporting = new Thread(() -> player.units.events.prepared(epoch));
        synchronized (player.units.events) {
            reporting.start();
            Wait.until("it waits to queue the call",
                    () -> reporting.getState() == Thread.State.BLOCKED);
            assertEquals(PlayerState.PREPARING, player.getState());
        }
        recorder.await("prepared");
    }

    @Test
    void aSeekOfTheOldMediaEndsNoneOfTheNew() throws Exception {
        int old = player.units.states.epoch();
        player.units.events.seekBegins(old);
        player.resetAndWait();
        player.units.events.seekBegins(old);
        assertFalse(player.units.events.seeking());
        player.units.events.seekBegins(player.units.states.epoch());
        player.units.events.seekEnds(old, false);
        assertTrue(player.units.events.seeking());
    }

    @Test
    void aSeekThatFailsInAnyWayIsOver() throws Exception {
        prepare("silent.mkv");
        assertThrows(AssertionError.class, () -> player.units.seeking.seek("seekTo(1)", () -> {
            throw new AssertionError("no memory");
        }));
        assertFalse(player.units.events.seeking());
        player.seekToAndWait(0);
        recorder.await("seek");
        assertEquals(1, recorder.count("seek"));
    }
}
