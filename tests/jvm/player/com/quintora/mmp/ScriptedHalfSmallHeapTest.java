// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import org.junit.jupiter.api.Test;

/** Thousands of players that nobody releases, in a heap of 16 MB. */
class ScriptedHalfSmallHeapTest {
    private static final int PLAYERS = 2000;

    @Test
    void forgottenPlayersAreFreedWithoutBeingAskedFor() throws Exception {
        assertTrue(Runtime.getRuntime().maxMemory() <= 16 << 20, "the heap is small");
        int most = 0;
        try (WarningCount warnings = new WarningCount()) {
            for (int i = 0; i < PLAYERS; i++) {
                forget();
                most = Math.max(most, ScriptedHalf.livePlayers());
            }
            assertTrue(most < PLAYERS, "memory alone had some freed: " + most);
            Wait.until("every player of the engine was freed", () -> {
                System.gc();
                return ScriptedHalf.livePlayers() == 0;
            });
            assertEquals(PLAYERS, warnings.count(), "each was reported once");
        }
    }

    private static void forget() throws Exception {
        OrvMediaPlayer player = new OrvMediaPlayer();
        player.addListener(new Recorder());
        player.setDataSource("/film");
        player.prepareAndWait();
        player.start();
    }
}
