// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Rectangle;
import java.util.concurrent.atomic.AtomicInteger;
import javax.swing.JFrame;
import javax.swing.JPanel;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** A bar below a picture, and over it. */
class DeckWindowTest {
    private final AtomicInteger paintings = new AtomicInteger();
    private final JPanel picture = new JPanel();
    private final JPanel bar = new JPanel() {
        @Override
        protected void paintComponent(Graphics graphics) {
            super.paintComponent(graphics);
            paintings.incrementAndGet();
        }
    };
    private final Deck deck = new Deck(picture, bar, hidden());
    private JFrame frame;

    private static JPanel hidden() {
        JPanel side = new JPanel();
        side.setVisible(false);
        return side;
    }

    @BeforeEach
    void open() throws Exception {
        SwingUtilities.invokeAndWait(() -> {
            picture.setPreferredSize(new Dimension(300, 200));
            bar.setPreferredSize(new Dimension(300, 40));
            frame = new JFrame();
            frame.add(deck);
            frame.pack();
            frame.setVisible(true);
        });
        Wait.until("it is painted", () -> paintings.get() > 0);
    }

    @AfterEach
    void close() throws Exception {
        SwingUtilities.invokeAndWait(frame::dispose);
    }

    @Test
    void belowThePictureTheBarIsLeftAlone() throws Exception {
        assertEquals(new Rectangle(0, 200, 300, 40), bar.getBounds());
        assertEquals(new Rectangle(0, 0, 300, 200), picture.getBounds());
        assertEquals(0, paintingsForAFrame());
    }

    @Test
    void overThePictureTheBarIsPaintedAfterEachFrame() throws Exception {
        SwingUtilities.invokeAndWait(() -> {
            deck.setOverlapping(true);
            frame.validate();
        });
        assertEquals(new Rectangle(0, 200, 300, 40), bar.getBounds());
        assertEquals(new Rectangle(0, 0, 300, 240), picture.getBounds());
        assertTrue(paintingsForAFrame() > 0);
    }

    private int paintingsForAFrame() throws Exception {
        return WindowFixture.onWindow(() -> {
            int before = paintings.get();
            picture.paintImmediately(picture.getVisibleRect());
            return paintings.get() - before;
        });
    }
}
