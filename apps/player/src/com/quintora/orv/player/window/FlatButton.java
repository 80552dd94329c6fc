// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.awt.FontMetrics;
import java.awt.Graphics;
import java.awt.Graphics2D;
import javax.swing.JButton;

/** A borderless button with a picture, or with a short text. */
final class FlatButton extends JButton {
    private static final int GLYPH_SIZE = 20;

    private Glyph glyph;

    FlatButton(Glyph glyph, String tip, Runnable action) {
        this.glyph = glyph;
        describe(tip);
        // The keyboard gets here by Tab; a click shall not take the keys along.
        setRequestFocusEnabled(false);
        setOpaque(false);
        setContentAreaFilled(false);
        setBorderPainted(false);
        setFont(Theme.body());
        addActionListener(event -> action.run());
    }

    void show(Glyph glyph, String tip) {
        if (glyph != this.glyph) {
            this.glyph = glyph;
            repaint();
        }
        describe(tip);
    }

    private void describe(String tip) {
        setToolTipText(tip);
        getAccessibleContext().setAccessibleName(tip);
    }

    @Override
    public Dimension getPreferredSize() {
        int text =
                getText().isEmpty()
                        ? 0
                        : getFontMetrics(getFont()).stringWidth(getText()) + Theme.px(16);
        return new Dimension(Math.max(Theme.button(), text), Theme.button());
    }

    @Override
    public Dimension getMaximumSize() {
        return getPreferredSize();
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = Theme.smooth(graphics);
        if (isEnabled() && (getModel().isRollover() || getModel().isPressed())) {
            g.setColor(getModel().isPressed() ? Theme.TRACK : Theme.HOVER);
            g.fillRoundRect(0, 0, getWidth(), getHeight(), Theme.corner(), Theme.corner());
        }
        paintContent(g);
        Theme.paintFocus(g, this);
        g.dispose();
    }

    private void paintContent(Graphics2D g) {
        var color = isEnabled() ? Theme.TEXT : Theme.BUFFERED;
        if (getText().isEmpty()) {
            int size = Theme.px(GLYPH_SIZE);
            glyph.paint(
                    g, (getWidth() - size) / 2.0, (getHeight() - size) / 2.0, size, color);
            return;
        }
        FontMetrics metrics = g.getFontMetrics(getFont());
        g.setFont(getFont());
        g.setColor(color);
        g.drawString(
                getText(),
                (getWidth() - metrics.stringWidth(getText())) / 2,
                (getHeight() - metrics.getHeight()) / 2 + metrics.getAscent());
    }
}
