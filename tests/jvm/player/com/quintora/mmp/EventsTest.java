// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.EnumSet;
import org.junit.jupiter.api.Test;

/** What is made of what the engine does: which event, of which media, before which other. */
class EventsTest extends PlayerFixture {
    @Test
    void nothingHasRunBeforeTheFirstMovement() throws Exception {
        prepare("silent.mkv");
        player.start();
        recorder.await("completion");
        player.reset();
        prepare("video.mp4");
        player.seekTo(4000);
        recorder.told.clear();
        // A start after which the engine stands.
        player.command("start()", StateMachine.WITH_MEDIA, StateMachine.WITH_MEDIA,
                PlayerState.STARTED, () -> {});
        player.wake();
        recorder.await("info 701 0");
        assertEquals(0, recorder.count("info 3 0"));
        player.native_start();
        recorder.await("info 702 0");
        recorder.await("info 3 0");
    }

    @Test
    void aChangeIsNotSeenBeforeItsCallIsQueued() throws Exception {
        player.setDataSource(Media.path("silent.mkv"));
        int epoch = player.states.enter("test", EnumSet.of(PlayerState.INITIALIZED),
                PlayerState.PREPARING);
        Thread telling = new Thread(() -> player.events().prepared(epoch));
        synchronized (player.events()) {
            telling.start();
            Wait.until("it waits to queue the call",
                    () -> telling.getState() == Thread.State.BLOCKED);
            assertEquals(PlayerState.PREPARING, player.getState());
        }
        recorder.await("prepared");
    }

    @Test
    void aSeekOfTheOldMediaEndsNoneOfTheNew() throws Exception {
        int old = player.states.epoch();
        player.events().seekBegins(old);
        player.reset();
        player.events().seekBegins(old);
        assertFalse(player.events().seeking());
        player.events().seekBegins(player.states.epoch());
        player.events().seekEnds(old, false);
        assertTrue(player.events().seeking());
    }

    @Test
    void aSeekThatFailsInAnyWayIsOver() throws Exception {
        prepare("silent.mkv");
        assertThrows(AssertionError.class, () -> player.seek("seekTo(1)", () -> {
            throw new AssertionError("no memory");
        }));
        assertFalse(player.events().seeking());
        player.seekTo(0);
        recorder.await("seek");
        assertEquals(1, recorder.count("seek"));
    }
}
