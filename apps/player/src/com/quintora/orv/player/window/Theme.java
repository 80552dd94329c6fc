// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Component;
import java.awt.Font;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.util.List;
import javax.swing.BorderFactory;
import javax.swing.UIManager;
import javax.swing.plaf.metal.MetalLookAndFeel;

/** The window's colours, letters and measures (pixels). */
final class Theme {
    static final Color STAGE = new Color(0x0B0C0E);
    static final Color PANEL = new Color(0x17191E);
    static final Color RAISED = new Color(0x262A32);
    static final Color HOVER = new Color(0x333844);
    static final Color TRACK = new Color(0x3A404C);
    static final Color BUFFERED = new Color(0x5B6372);
    static final Color ACCENT = new Color(0x4C9BFF);
    static final Color SECTION = new Color(0xFFC24B);
    static final Color TEXT = new Color(0xE9EBEF);
    static final Color MUTED = new Color(0x98A0AD);
    static final Color ALERT = new Color(0xFF6B5E);

    static final Font BODY = new Font(Font.SANS_SERIF, Font.PLAIN, 13);
    static final Font SMALL = BODY.deriveFont(12f);
    static final Font TITLE = BODY.deriveFont(Font.BOLD, 20f);

    static final int GAP = 8;
    static final int BUTTON = 36;
    static final int CORNER = 10;

    private Theme() {}

    /** Gives dialogs the same look. Call before Swing is used first. */
    static void dressDialogs() {
        MetalLookAndFeel.setCurrentTheme(new DarkMetal());
        UIManager.put("swing.boldMetal", false);
        for (String gradient : List.of("Button", "ScrollBar", "ComboBox", "ToggleButton")) {
            UIManager.put(gradient + ".gradient", null);
        }
    }

    /** Gives what Swing draws itself the same look. Call before the first component is made. */
    static void install() {
        UIManager.put("ToolTip.background", RAISED);
        UIManager.put("ToolTip.foreground", TEXT);
        UIManager.put("ToolTip.font", SMALL);
        UIManager.put("ToolTip.border", BorderFactory.createEmptyBorder(4, 8, 4, 8));
    }

    /** A ring just inside a component, while the keyboard is at it. */
    static void paintFocus(Graphics2D g, Component component) {
        if (component.isFocusOwner()) {
            g.setColor(ACCENT);
            g.setStroke(new BasicStroke(2));
            g.drawRoundRect(
                    1, 1, component.getWidth() - 2, component.getHeight() - 2, CORNER, CORNER);
        }
    }

    static Graphics2D smooth(Graphics g) {
        Graphics2D g2 = (Graphics2D) g.create();
        g2.setRenderingHint(RenderingHints.KEY_ANTIALIASING, RenderingHints.VALUE_ANTIALIAS_ON);
        g2.setRenderingHint(
                RenderingHints.KEY_TEXT_ANTIALIASING, RenderingHints.VALUE_TEXT_ANTIALIAS_ON);
        g2.setRenderingHint(
                RenderingHints.KEY_STROKE_CONTROL, RenderingHints.VALUE_STROKE_PURE);
        return g2;
    }
}
