// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.FontMetrics;
import java.awt.Graphics;
import java.awt.Graphics2D;
import javax.swing.JToggleButton;

/** One of several that exclude each other: a colour, or a word where that says more. */
final class ChoiceButton extends JToggleButton {
    private static final int HEIGHT = 28;
    private static final int SWATCH = 16;

    private final String word;
    private final Color color;

    /** Shows the colour; one that nobody could see is shown as its name. */
    ChoiceButton(String of, String name, Color color, Runnable choose) {
        this.word = name;
        this.color = color;
        setToolTipText(of + ": " + name);
        getAccessibleContext().setAccessibleName(of + ": " + name);
        setFont(Theme.small());
        setOpaque(false);
        setContentAreaFilled(false);
        setBorderPainted(false);
        setRequestFocusEnabled(false);
        addActionListener(event -> choose.run());
    }

    private boolean isSwatch() {
        return color != null && color.getAlpha() == 255;
    }

    @Override
    public Dimension getPreferredSize() {
        int height = Theme.px(HEIGHT);
        int width =
                isSwatch()
                        ? height
                        : getFontMetrics(getFont()).stringWidth(word) + Theme.px(14);
        return new Dimension(width, height);
    }

    @Override
    public Dimension getMaximumSize() {
        return getPreferredSize();
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = Theme.smooth(graphics);
        if (isSelected() || getModel().isRollover()) {
            g.setColor(isSelected() ? Theme.TRACK : Theme.HOVER);
            g.fillRoundRect(0, 0, getWidth(), getHeight(), Theme.corner(), Theme.corner());
        }
        if (isSwatch()) {
            paintSwatch(g);
        } else {
            paintWord(g);
        }
        Theme.paintFocus(g, this);
        g.dispose();
    }

    private void paintSwatch(Graphics2D g) {
        int size = Theme.px(SWATCH);
        int left = (getWidth() - size) / 2;
        int top = (getHeight() - size) / 2;
        g.setColor(color);
        g.fillOval(left, top, size, size);
        g.setColor(isSelected() ? Theme.ACCENT : Theme.BUFFERED);
        g.setStroke(new BasicStroke(Theme.px(isSelected() ? 2 : 1)));
        g.drawOval(left, top, size, size);
    }

    private void paintWord(Graphics2D g) {
        FontMetrics metrics = g.getFontMetrics(getFont());
        g.setFont(getFont());
        g.setColor(isSelected() ? Theme.ACCENT : Theme.TEXT);
        g.drawString(
                word,
                (getWidth() - metrics.stringWidth(word)) / 2,
                (getHeight() - metrics.getHeight()) / 2 + metrics.getAscent());
    }
}
