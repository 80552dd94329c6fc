// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import org.junit.jupiter.api.Test;

/** What a desktop wishes for, by its dots per inch in 1024ths. */
class ScaleFactorTest {
    @Test
    void aDesktopWithoutAWishIsUsual() {
        assertEquals(1, ScaleFactor.wished(null, 1));
        assertEquals(1, ScaleFactor.wished("large", 1));
        assertEquals(1, ScaleFactor.wished(-1, 1));
        assertEquals(1, ScaleFactor.wished(96 * 1024, 1));
        assertEquals(1, ScaleFactor.wished(72 * 1024, 1));
    }

    @Test
    void partsOfAFactorCount() {
        assertEquals(1.25, ScaleFactor.wished(120 * 1024, 1));
        assertEquals(1.5, ScaleFactor.wished(144 * 1024, 1));
        assertEquals(4, ScaleFactor.wished(1000 * 1024, 1));
    }

    @Test
    void whatJavaDoesItselfIsNotDoneTwice() {
        assertEquals(1, ScaleFactor.wished(192 * 1024, 2));
        assertEquals(1.25, ScaleFactor.wished(240 * 1024, 2));
    }
}
