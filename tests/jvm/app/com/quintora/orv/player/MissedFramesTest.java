// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;

import org.junit.jupiter.api.Test;

/** Frames that never came are counted, and only those. Times are in hundredths of a second. */
class MissedFramesTest {
    private final MissedFrames missed = new MissedFrames(25);

    private void come(int... hundredths) {
        for (int at : hundredths) {
            missed.add(at * 10_000_000L);
        }
    }

    @Test
    void noneIsMissedWhereEachCame() {
        come(0, 0, 0, 4, 8, 12, 16, 20);
        assertEquals(0, missed.count());
    }

    @Test
    void aGapIsCounted() {
        come(0, 4, 8, 20, 24);
        assertEquals(2, missed.count());
    }

    @Test
    void aTimeThatComesLateIsNoGap() {
        come(0, 4, 8, 8, 16, 20, 20, 28);
        assertEquals(0, missed.count());
    }

    @Test
    void aTimeThatComesEarlyIsNoGap() {
        come(0, 4, 8, 12, 20, 20);
        assertEquals(0, missed.count());
    }

    @Test
    void aRestHidesNoGap() {
        come(0, 0, 0, 0, 4, 8, 16, 20);
        assertEquals(1, missed.count());
    }

    @Test
    void aJumpIsNoGap() {
        come(0, 4, 8, 20, 24);
        missed.jump();
        come(100, 100, 104, 108);
        assertEquals(2, missed.count());
    }

    @Test
    void theStartOfALoopIsNoGap() {
        come(40, 44, 48, 0, 4, 8, 16, 20);
        assertEquals(1, missed.count());
    }

    @Test
    void whatHasNoRateMissesNothing() {
        MissedFrames unknown = new MissedFrames(0);
        unknown.add(0);
        unknown.add(1_000_000_000L);
        unknown.add(9_000_000_000L);
        assertEquals(0, unknown.count());
    }
}
