// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.quintora.mmp.Media;
import org.junit.jupiter.api.Test;

class SessionTest {
    /** Who waits for its end, as for that of a rehearsal, waits for nothing else. */
    @Test
    void aSessionThatCannotBeOpenedHasEnded() throws Exception {
        for (String source : new String[] {"/no/such.mkv", Media.path("garbage.bin")}) {
            try (Session session = new Session(PlayOptions.of(source), frame -> {})) {
                assertEquals(1, session.ended().getCount());
                assertThrows(Failure.class, session::open);
                assertEquals(0, session.ended().getCount());
            }
        }
    }
}
