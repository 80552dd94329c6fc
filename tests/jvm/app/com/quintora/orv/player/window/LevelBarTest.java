// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.util.concurrent.atomic.AtomicInteger;
import org.junit.jupiter.api.Test;

/** A bar that is shown the same level again and again. */
class LevelBarTest {
    private final AtomicInteger repaints = new AtomicInteger();
    private final LevelBar bar = new LevelBar("Level", 100, level -> {}, step -> {}) {
        @Override
        public void repaint() {
            repaints.incrementAndGet();
        }
    };

    @Test
    void itIsPaintedOnlyWhereItLooksDifferent() {
        bar.setSize(112, 20);
        assertEquals(1, repaintsFor(0.5, 0));
        assertEquals(0, repaintsFor(0.5, 0), "the same");
        assertEquals(0, repaintsFor(0.501, 0), "a tenth of a pixel more");
        assertEquals(1, repaintsFor(0.52, 0));
        assertEquals(1, repaintsFor(0.52, 0.8));
        assertEquals(0, repaintsFor(0.52, 0.8), "the same");
        assertEquals(1, repaintsFor(0, 0.8), "nothing is another look than a little");
    }

    private int repaintsFor(double level, double behind) {
        repaints.set(0);
        bar.showLevel(level, behind);
        return repaints.get();
    }
}
