// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import javax.swing.SwingUtilities;
import javax.swing.Timer;

/**
 * Tells one click from two. One waits for whether it is the first of two, so that two do nothing
 * else before. On the window's thread.
 */
final class Clicks extends MouseAdapter {
    private static final int WAIT_MS = 250;

    private final Runnable onOne;
    private final Runnable onTwo;
    private final Timer first;

    /** Two that are slow for two run what one runs before and after them. */
    Clicks(Runnable onOne, Runnable onTwo) {
        this.onOne = onOne;
        this.onTwo = onTwo;
        first = new Timer(WAIT_MS, event -> onOne.run());
        first.setRepeats(false);
    }

    @Override
    public void mouseClicked(MouseEvent event) {
        if (!SwingUtilities.isLeftMouseButton(event)) {
            return;
        }
        if (event.getClickCount() % 2 == 1) {
            first.restart();
            return;
        }
        if (first.isRunning()) {
            first.stop();
        } else {
            onOne.run(); // What the first one did is undone.
        }
        onTwo.run();
    }

    void stop() {
        first.stop();
    }
}
