// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import org.junit.jupiter.api.Test;

/** Media, and sections of them, that play again and again. */
class RepeatTest {
    // Marks are set in passing, and the clock is asked now and then.
    private static final int LATE_MS = 500;

    private int nearest = Integer.MAX_VALUE;

    @Test
    void aSectionIsRepeated() throws Exception {
        try (Session session = open("video.mp4", "--ab", "1:2")) {
            assertEquals(1_000, session.player().getCurrentPosition(), 50);
            session.start();
            awaitRounds(session, 1_000 + LATE_MS, 1_800);
            assertTrue(nearest > 900, "it began again at " + nearest);
        }
    }

    @Test
    void aSectionMayEndWithTheMedia() throws Exception {
        try (Session session = open("silent.mp4", "--ab", "1:2")) {
            session.start();
            awaitRounds(session, 1_000 + LATE_MS, 1_700);
        }
    }

    @Test
    void theWholeIsRepeated() throws Exception {
        try (Session session = open("silent.mp4", "--loop")) {
            session.start();
            awaitRounds(session, LATE_MS, 1_500);
        }
    }

    private static Session open(String... arguments) throws Exception {
        arguments[0] = Media.path(arguments[0]);
        PlayOptions options = PlayOptions.of(arguments);
        Session session = new Session(options, image -> {});
        session.open();
        return session;
    }

    /** Twice to the end of what is repeated, and back. */
    private void awaitRounds(Session session, int begun, int nearlyDone) throws Exception {
        for (int round = 0; round < 2; round++) {
            Wait.until("it nearly ends", () -> positionOf(session) >= nearlyDone);
            Wait.until("it begins again", () -> positionOf(session) <= begun);
        }
    }

    private int positionOf(Session session) {
        assertEquals(1, session.ended().getCount(), "it came to its end");
        int position = session.player().getCurrentPosition();
        nearest = Math.min(nearest, position);
        return position;
    }
}
