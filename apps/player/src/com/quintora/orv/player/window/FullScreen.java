// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.AWTEvent;
import java.awt.Cursor;
import java.awt.Point;
import java.awt.Rectangle;
import java.awt.Toolkit;
import java.awt.event.MouseEvent;
import java.awt.image.BufferedImage;
import javax.swing.JComponent;
import javax.swing.JFrame;
import javax.swing.Timer;

/**
 * The window over the whole screen. Its controls lie over the picture; they and the pointer hide
 * while the mouse rests.
 */
final class FullScreen {
    private static final int REST_MS = 2_500;

    private final JFrame frame;
    private final Deck deck;
    private final JComponent controls;
    private final Timer rest = new Timer(REST_MS, event -> hideControls());
    private final Cursor noCursor =
            Toolkit.getDefaultToolkit()
                    .createCustomCursor(
                            new BufferedImage(16, 16, BufferedImage.TYPE_INT_ARGB),
                            new Point(),
                            "none");
    private boolean on;
    private boolean playing;
    private Rectangle windowed;

    FullScreen(JFrame frame, Deck deck, JComponent controls) {
        this.frame = frame;
        this.deck = deck;
        this.controls = controls;
        rest.setRepeats(false);
        Toolkit.getDefaultToolkit()
                .addAWTEventListener(this::onMouse, AWTEvent.MOUSE_MOTION_EVENT_MASK);
    }

    /** The window's place on the screen, also while it fills that. */
    Rectangle windowedBounds() {
        return on ? windowed : frame.getBounds();
    }

    boolean isOn() {
        return on;
    }

    void set(boolean wanted) {
        on = wanted;
        if (on) {
            windowed = frame.getBounds();
        }
        // A window can lose its frame only while it is not shown.
        frame.dispose();
        frame.setUndecorated(on);
        deck.setOverlapping(on);
        frame.getGraphicsConfiguration().getDevice().setFullScreenWindow(on ? frame : null);
        if (!on) {
            frame.setBounds(windowed);
        }
        frame.setVisible(true);
        showControls();
    }

    /** Controls stay while the media rests. */
    void showPlaying(boolean playing) {
        this.playing = playing;
        if (!playing && !controls.isVisible()) {
            showControls();
        }
    }

    private void onMouse(AWTEvent event) {
        if (event instanceof MouseEvent) {
            showControls();
        }
    }

    /** Shows them, for a while at least. */
    void showControls() {
        controls.setVisible(true);
        frame.validate();
        frame.getRootPane().setCursor(null);
        rest.restart();
    }

    private void hideControls() {
        if (ChoiceMenu.isOpen()) {
            rest.restart();
        } else if (on && playing) {
            controls.setVisible(false);
            frame.getRootPane().setCursor(noCursor);
        }
    }
}
