// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Graphics;
import java.awt.LayoutManager;
import javax.swing.JPanel;

/** A panel with round corners. */
final class Card extends JPanel {
    Card(LayoutManager layout) {
        super(layout);
        setOpaque(false);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        var g = Theme.smooth(graphics);
        g.setColor(Theme.PANEL);
        g.fillRoundRect(0, 0, getWidth(), getHeight(), 2 * Theme.corner(), 2 * Theme.corner());
        g.dispose();
    }
}
