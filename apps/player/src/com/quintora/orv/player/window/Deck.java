// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BorderLayout;
import java.awt.Component;
import java.awt.Container;
import java.awt.Dimension;
import javax.swing.JPanel;

/**
 * The picture, the bar below it or over the whole of it, and beside the picture a panel while one
 * is open.
 */
final class Deck extends JPanel {
    private final Component picture;
    private final Component bar;
    private final Component side;
    private boolean overlaps;
    private boolean isApart;

    Deck(Component picture, Component bar, Component side) {
        super(new Layout());
        this.picture = picture;
        this.bar = bar;
        this.side = side;
        // The first is the uppermost.
        add(bar, BorderLayout.SOUTH);
        add(picture, BorderLayout.CENTER);
        add(side, BorderLayout.EAST);
    }

    /** Whether the bar lies over the picture, which has all the room then. */
    void setOverlapping(boolean overlaps) {
        this.overlaps = overlaps && !isApart;
        revalidate();
    }

    /** The bar never lies over the picture, which would cover it. */
    void keepApart() {
        isApart = true;
        setOverlapping(false);
    }

    /** Otherwise a new frame would be painted over the bar. */
    @Override
    public boolean isOptimizedDrawingEnabled() {
        return !overlaps;
    }

    private static final class Layout extends BorderLayout {
        @Override
        public void layoutContainer(Container target) {
            Deck deck = (Deck) target;
            if (!deck.overlaps) {
                super.layoutContainer(target);
                return;
            }
            Dimension room = deck.getSize();
            if (deck.side.isVisible()) {
                int width = Math.min(room.width, deck.side.getPreferredSize().width);
                deck.side.setBounds(room.width - width, 0, width, room.height);
                room.width -= width;
            }
            int height = Math.min(room.height, deck.bar.getPreferredSize().height);
            deck.picture.setBounds(0, 0, room.width, room.height);
            deck.bar.setBounds(0, room.height - height, room.width, height);
        }
    }
}
