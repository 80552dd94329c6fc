// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Color;
import java.awt.Cursor;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.event.FocusEvent;
import java.awt.event.FocusListener;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.util.function.DoubleConsumer;
import java.util.function.IntConsumer;
import javax.accessibility.AccessibleContext;
import javax.swing.JComponent;
import javax.swing.SwingUtilities;

/** A horizontal bar from 0 to 1 that the user sets: the volume, or the place in the media. */
class LevelBar extends JComponent {
    static final int HEIGHT = 20;

    private static final int THICKNESS = 4;
    private static final int KNOB = 12;

    private final int thickness = Theme.px(THICKNESS);
    private final int knob = Theme.px(KNOB);
    private final DoubleConsumer onSet;
    private double level;
    private double behind;
    private boolean dragged;
    private boolean hovered;

    /** The keys step by -1 or 1; what a step is, the listener decides. */
    LevelBar(String name, int width, DoubleConsumer onSet, IntConsumer onStep) {
        this.onSet = onSet;
        setPreferredSize(Theme.size(width, HEIGHT));
        setMinimumSize(Theme.size(40, HEIGHT));
        setCursor(Cursor.getPredefinedCursor(Cursor.HAND_CURSOR));
        getAccessibleContext().setAccessibleName(name);
        Mouse mouse = new Mouse();
        addMouseListener(mouse);
        addMouseMotionListener(mouse);
        bindKeys(onStep);
    }

    private void bindKeys(IntConsumer onStep) {
        setFocusable(true);
        addFocusListener(new Focus());
        onKey("LEFT", () -> onStep.accept(-1));
        onKey("DOWN", () -> onStep.accept(-1));
        onKey("RIGHT", () -> onStep.accept(1));
        onKey("UP", () -> onStep.accept(1));
        onKey("HOME", () -> onSet.accept(0));
        onKey("END", () -> onSet.accept(1));
    }

    private void onKey(String key, Runnable action) {
        Keys.bind(this, WHEN_FOCUSED, key, action);
    }

    /** Shows a level unless the user is just setting one; behind is the pale bar under it. */
    final void showLevel(double level, double behind) {
        if (!dragged) {
            changeLevel(clamp(level));
        }
        changeBehind(clamp(behind));
    }

    private void changeBehind(double behind) {
        boolean isSeen = widthOf(behind) != widthOf(this.behind);
        this.behind = behind;
        if (isSeen) {
            repaint();
        }
    }

    private void changeLevel(double level) {
        int before = value();
        boolean isSeen = widthOf(level) != widthOf(this.level);
        this.level = level;
        if (isSeen) {
            repaint();
        }
        if (value() != before) {
            getAccessibleContext()
                    .firePropertyChange(
                            AccessibleContext.ACCESSIBLE_VALUE_PROPERTY, before, value());
        }
    }

    /** As if the user had set it. */
    final void set(double level) {
        changeLevel(clamp(level));
        onSet.accept(this.level);
    }

    /** The level in the units that people know: percent, unless a subclass has others. */
    final int value() {
        return (int) Math.round(level * maximum());
    }

    /** The value of the level 1. */
    int maximum() {
        return 100;
    }

    final double levelAt(int x) {
        return clamp((x - knob / 2.0) / Math.max(1, getWidth() - knob));
    }

    final double xOf(double level) {
        return knob / 2.0 + level * (getWidth() - knob);
    }

    @Override
    public final AccessibleContext getAccessibleContext() {
        if (accessibleContext == null) {
            accessibleContext = new AccessibleLevel(this);
        }
        return accessibleContext;
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = Theme.smooth(graphics);
        fillTo(g, 1, Theme.TRACK);
        fillTo(g, behind, Theme.BUFFERED);
        fillTo(g, level, isEnabled() ? Theme.ACCENT : Theme.BUFFERED);
        paintMarks(g);
        if (isEnabled() && (hovered || dragged || isFocusOwner())) {
            g.setColor(Theme.TEXT);
            g.fillOval(lengthOf(level), (getHeight() - knob) / 2, knob, knob);
        }
        Theme.paintFocus(g, this);
        g.dispose();
    }

    /** For marks between the bar and its knob. */
    void paintMarks(Graphics2D g) {}

    private void fillTo(Graphics2D g, double end, Color color) {
        if (end <= 0) {
            return;
        }
        g.setColor(color);
        int left = knob / 2 - thickness / 2;
        g.fillRoundRect(
                left, (getHeight() - thickness) / 2, widthOf(end), thickness, thickness, thickness);
    }

    /** In pixels of the window; 0 for an empty bar. */
    private int widthOf(double end) {
        return end <= 0 ? 0 : lengthOf(end) + thickness;
    }

    private int lengthOf(double level) {
        return (int) Math.round(level * (getWidth() - knob));
    }

    private static double clamp(double value) {
        return Math.max(0, Math.min(1, value));
    }

    private final class Focus implements FocusListener {
        @Override
        public void focusGained(FocusEvent event) {
            repaint();
        }

        @Override
        public void focusLost(FocusEvent event) {
            repaint();
        }
    }

    private final class Mouse extends MouseAdapter {
        @Override
        public void mousePressed(MouseEvent event) {
            if (isEnabled() && SwingUtilities.isLeftMouseButton(event)) {
                dragged = true;
                mouseDragged(event);
            }
        }

        @Override
        public void mouseDragged(MouseEvent event) {
            if (dragged) {
                set(levelAt(event.getX()));
            }
        }

        @Override
        public void mouseReleased(MouseEvent event) {
            if (SwingUtilities.isLeftMouseButton(event)) {
                dragged = false;
            }
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
