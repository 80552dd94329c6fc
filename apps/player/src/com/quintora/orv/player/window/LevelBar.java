// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Color;
import java.awt.Cursor;
import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.util.function.DoubleConsumer;
import javax.swing.JPanel;

/** A horizontal bar from 0 to 1 that the mouse sets: the volume, or the place in the media. */
class LevelBar extends JPanel {
    private static final int THICKNESS = 4;
    private static final int KNOB = 12;

    private final DoubleConsumer onSet;
    private double level;
    private double behind;
    private boolean dragged;
    private boolean hovered;

    LevelBar(String name, int width, DoubleConsumer onSet) {
        this.onSet = onSet;
        setOpaque(false);
        setPreferredSize(new Dimension(width, 20));
        setMinimumSize(new Dimension(40, 20));
        setCursor(Cursor.getPredefinedCursor(Cursor.HAND_CURSOR));
        getAccessibleContext().setAccessibleName(name);
        Mouse mouse = new Mouse();
        addMouseListener(mouse);
        addMouseMotionListener(mouse);
    }

    /** Shows a level unless the user is just setting one; behind is the pale bar under it. */
    final void showLevel(double level, double behind) {
        if (!dragged) {
            this.level = clamp(level);
        }
        this.behind = clamp(behind);
        repaint();
    }

    final double levelAt(int x) {
        return clamp((x - KNOB / 2.0) / Math.max(1, getWidth() - KNOB));
    }

    final double xOf(double level) {
        return KNOB / 2.0 + level * (getWidth() - KNOB);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = Theme.smooth(graphics);
        fillTo(g, 1, Theme.TRACK);
        fillTo(g, behind, Theme.BUFFERED);
        fillTo(g, level, isEnabled() ? Theme.ACCENT : Theme.BUFFERED);
        paintMarks(g);
        if (isEnabled() && (hovered || dragged)) {
            g.setColor(Theme.TEXT);
            g.fillOval((int) (xOf(level) - KNOB / 2.0), (getHeight() - KNOB) / 2, KNOB, KNOB);
        }
        g.dispose();
    }

    /** For marks between the bar and its knob. */
    void paintMarks(Graphics2D g) {}

    private void fillTo(Graphics2D g, double end, Color color) {
        if (end <= 0) {
            return;
        }
        g.setColor(color);
        int left = KNOB / 2 - THICKNESS / 2;
        int width = (int) Math.round(end * (getWidth() - KNOB)) + THICKNESS;
        g.fillRoundRect(
                left, (getHeight() - THICKNESS) / 2, width, THICKNESS, THICKNESS, THICKNESS);
    }

    private static double clamp(double value) {
        return Math.max(0, Math.min(1, value));
    }

    private final class Mouse extends MouseAdapter {
        @Override
        public void mousePressed(MouseEvent event) {
            if (isEnabled()) {
                dragged = true;
                mouseDragged(event);
            }
        }

        @Override
        public void mouseDragged(MouseEvent event) {
            if (dragged) {
                level = levelAt(event.getX());
                onSet.accept(level);
                repaint();
            }
        }

        @Override
        public void mouseReleased(MouseEvent event) {
            dragged = false;
        }

        @Override
        public void mouseEntered(MouseEvent event) {
            hovered = true;
            repaint();
        }

        @Override
        public void mouseExited(MouseEvent event) {
            hovered = false;
            repaint();
        }
    }
}
