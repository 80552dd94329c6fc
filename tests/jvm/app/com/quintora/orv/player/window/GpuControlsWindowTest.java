// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import org.junit.jupiter.api.Nested;

/** What the window does with pictures drawn by software, it does with those of OpenGL, too. */
class GpuControlsWindowTest {
    private static final String[] OPTIONS = {"--gpu"};

    @Nested
    class Keys extends WindowTest {
        @Override
        String[] usualOptions() {
            return OPTIONS;
        }
    }

    @Nested
    class Menus extends MenuWindowTest {
        @Override
        String[] usualOptions() {
            return OPTIONS;
        }
    }

    @Nested
    class Stalling extends StallingWindowTest {
        @Override
        String[] usualOptions() {
            return OPTIONS;
        }
    }
}
