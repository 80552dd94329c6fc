// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;

import org.junit.jupiter.api.Test;

/** Frames that come, come again, and do not come. */
class FrameCountTest {
    private static final long PERIOD_NS = 40_000_000;

    private final FrameCount count = new FrameCount();

    @Test
    void aFrameThatIsDrawnAnewCountsOnce() {
        count.expect(25);
        for (int frame : new int[] {0, 0, 1, 2, 2, 2, 3}) {
            count.add(frame * PERIOD_NS);
        }
        assertEquals(4, count.shown());
        assertEquals(0, count.dropped());
    }

    @Test
    void aFrameThatIsDrawnAnewMakesUpForNoMissedOne() {
        count.expect(25);
        for (int frame : new int[] {0, 1, 1, 1, 1, 5, 6, 7}) {
            count.add(frame * PERIOD_NS);
        }
        assertEquals(5, count.shown());
        assertEquals(3, count.dropped());
    }
}
