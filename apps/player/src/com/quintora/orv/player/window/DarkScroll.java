// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Rectangle;
import javax.swing.BorderFactory;
import javax.swing.JButton;
import javax.swing.JComponent;
import javax.swing.JScrollBar;
import javax.swing.JScrollPane;
import javax.swing.plaf.basic.BasicScrollBarUI;

/** Scrolls what it holds, with narrow bars in the window's look. */
final class DarkScroll extends JScrollPane {
    private static final int BAR = 10;

    private static final int STEP = 20;

    DarkScroll(Component content) {
        super(content);
        setBorder(BorderFactory.createEmptyBorder());
        setOpaque(false);
        getViewport().setOpaque(false);
        dress(getVerticalScrollBar());
        dress(getHorizontalScrollBar());
    }

    /** A bar's width in pixels. */
    static int bar() {
        return Theme.px(BAR);
    }

    private static void dress(JScrollBar bar) {
        bar.setUI(new Thumb());
        bar.setUnitIncrement(Theme.px(STEP));
        bar.setPreferredSize(new Dimension(bar(), bar()));
        bar.setOpaque(false);
    }

    private static final class Thumb extends BasicScrollBarUI {
        @Override
        protected void paintTrack(Graphics g, JComponent bar, Rectangle place) {}

        @Override
        protected void paintThumb(Graphics graphics, JComponent bar, Rectangle place) {
            var g = Theme.smooth(graphics);
            g.setColor(isDragging ? Theme.BUFFERED : Theme.TRACK);
            int edge = Theme.px(2);
            g.fillRoundRect(
                    place.x + edge, place.y + edge,
                    place.width - 2 * edge, place.height - 2 * edge,
                    bar(), bar());
            g.dispose();
        }

        @Override
        protected JButton createIncreaseButton(int orientation) {
            return none();
        }

        @Override
        protected JButton createDecreaseButton(int orientation) {
            return none();
        }

        private static JButton none() {
            JButton button = new JButton();
            button.setPreferredSize(new Dimension());
            button.setVisible(false); // Or Tab, and screen readers, would find it.
            return button;
        }
    }
}
