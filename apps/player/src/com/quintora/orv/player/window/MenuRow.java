// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Graphics2D;
import javax.swing.AbstractButton;
import javax.swing.JMenu;

/** The look of a menu's row: a tick, what it says, and at the right its keys. */
final class MenuRow {
    private static final int TICK = 16;
    private static final int MARGIN = 14;
    private static final int TEXT_AT = MARGIN + TICK + 10;
    private static final int KEYS_GAP = 28;
    private static final int ARROW = 14;
    private static final int HEIGHT = 30;
    private static final int MIN_WIDTH = 200;

    private MenuRow() {}

    static void prepare(AbstractButton row) {
        // The media's own words are never markup.
        row.putClientProperty("html.disable", true);
        row.setFont(Theme.body());
        row.setBorder(null);
    }

    static Dimension size(AbstractButton row, String keys) {
        var metrics = row.getFontMetrics(row.getFont());
        int right = row instanceof JMenu ? Theme.px(KEYS_GAP + ARROW) : widthOfKeys(row, keys);
        int width = Theme.px(TEXT_AT) + metrics.stringWidth(row.getText()) + right
                + Theme.px(MARGIN);
        return new Dimension(Math.max(Theme.px(MIN_WIDTH), width), Theme.px(HEIGHT));
    }

    private static int widthOfKeys(AbstractButton row, String keys) {
        return keys.isEmpty()
                ? 0
                : Theme.px(KEYS_GAP) + row.getFontMetrics(Theme.small()).stringWidth(keys);
    }

    static void paint(
            Graphics graphics, AbstractButton row, boolean isAt, boolean isOn, String keys) {
        Graphics2D g = Theme.smooth(graphics);
        int height = row.getHeight();
        int margin = Theme.px(MARGIN);
        g.setColor(isAt ? Theme.HOVER : Theme.RAISED);
        g.fillRect(0, 0, row.getWidth(), height);
        if (isOn) {
            int tick = Theme.px(TICK);
            Glyph.CHECK.paint(g, margin, (height - tick) / 2.0, tick, Theme.ACCENT);
        }
        g.setFont(row.getFont());
        g.setColor(Theme.TEXT);
        var metrics = g.getFontMetrics();
        int baseline = (height - metrics.getHeight()) / 2 + metrics.getAscent();
        g.drawString(row.getText(), Theme.px(TEXT_AT), baseline);
        if (row instanceof JMenu) {
            int arrow = Theme.px(ARROW);
            int x = row.getWidth() - margin - arrow;
            Glyph.SUBMENU.paint(g, x, (height - arrow) / 2.0, arrow, Theme.MUTED);
        }
        g.setFont(Theme.small());
        g.setColor(Theme.MUTED);
        int width = g.getFontMetrics().stringWidth(keys);
        g.drawString(keys, row.getWidth() - margin - width, baseline);
        g.dispose();
    }
}
