// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.fail;

import java.util.Random;
import org.junit.jupiter.api.Test;

/**
 * Random calls of a player over natives that refuse at random, held to a model of its states.
 * {@code -Dorv.test.sequences=N} tries more sequences, {@code -Dorv.test.seed=N} others.
 */
class RandomCallsTest {
    private static final int CALLS = 40;

    @Test
    void everyCallDoesWhatItsStateAllowsAndNoMore() throws Exception {
        long first = Long.getLong("orv.test.seed", 1);
        for (long seed = first; seed < first + Long.getLong("orv.test.sequences", 300); seed++) {
            run(seed);
        }
    }

    private static void run(long seed) throws Exception {
        Random random = new Random(seed);
        ModelledPlayer player = new ModelledPlayer();
        StringBuilder story = new StringBuilder("sequence " + seed + ":");
        try {
            for (int i = 0; i < CALLS; i++) {
                ModelledPlayer.Call call = player.calls.get(random.nextInt(player.calls.size()));
                boolean refuses = random.nextInt(8) == 0;
                story.append(' ').append(call.name()).append(refuses ? " (refused)" : "");
                player.make(call, refuses);
                if (random.nextInt(6) == 0) {
                    story.append(" (end)");
                    player.reachEnd();
                }
            }
        } catch (AssertionError | Exception e) {
            fail(story.toString(), e);
        } finally {
            player.units.lifetime.close();
        }
        assertEquals("RELEASED", player.units.states.state().name(), story.toString());
        assertFalse(player.units.states.commands.isHeldByCurrentThread(), story.toString());
    }
}
