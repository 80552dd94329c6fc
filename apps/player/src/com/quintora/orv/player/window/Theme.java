// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Component;
import java.awt.Dimension;
import java.awt.Font;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.util.List;
import javax.swing.BorderFactory;
import javax.swing.UIManager;
import javax.swing.UnsupportedLookAndFeelException;
import javax.swing.border.Border;
import javax.swing.plaf.metal.MetalLookAndFeel;

/** The window's colours, and its letters and measures (pixels) in the scale that was asked for. */
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

    private static final Font LETTERS = new Font(Font.SANS_SERIF, Font.PLAIN, 13);

    private static final List<String> DIALOG_ICONS =
            List.of(
                    "FileChooser.upFolderIcon", "FileChooser.homeFolderIcon",
                    "FileChooser.newFolderIcon", "FileChooser.listViewIcon",
                    "FileChooser.detailsViewIcon", "FileView.directoryIcon",
                    "FileView.fileIcon", "FileView.computerIcon", "FileView.hardDriveIcon",
                    "FileView.floppyDriveIcon");

    private static volatile double factor = 1;
    private static volatile double dressed; // The factor of dialogs.

    private Theme() {}

    /** How many times as large as usual all is that is made from now on: from 1 to 4. */
    static void scale(double wanted) {
        factor = wanted;
    }

    static double scale() {
        return factor;
    }

    /** A measure in the pixels of the present scale. */
    static int px(int usual) {
        return (int) Math.round(usual * factor);
    }

    static Dimension size(int width, int height) {
        return new Dimension(px(width), px(height));
    }

    /** Room round a component, before scaling. */
    static Border border(int top, int left, int bottom, int right) {
        return BorderFactory.createEmptyBorder(px(top), px(left), px(bottom), px(right));
    }

    static Font body() {
        return body(13);
    }

    static Font small() {
        return body(12);
    }

    static Font title() {
        return body(20).deriveFont(Font.BOLD);
    }

    /** The usual letters in another size, before scaling. */
    static Font body(float size) {
        return LETTERS.deriveFont((float) (size * factor));
    }

    static int gap() {
        return px(8);
    }

    static int button() {
        return px(36);
    }

    static int corner() {
        return px(10);
    }

    /** Gives dialogs the same look. Call before Swing is used first, and in each other scale. */
    static void dressDialogs() {
        dressed = factor;
        MetalLookAndFeel.setCurrentTheme(new DarkMetal());
        UIManager.put("swing.boldMetal", false);
        for (String gradient : List.of("Button", "ScrollBar", "ComboBox", "ToggleButton")) {
            UIManager.put(gradient + ".gradient", null);
        }
    }

    /** Gives what Swing draws itself the same look. Call before the first component is made. */
    static void install() {
        if (dressed != factor) {
            dressDialogs();
            redress();
        }
        UIManager.put("ToolTip.background", RAISED);
        UIManager.put("ToolTip.foreground", TEXT);
        UIManager.put("ToolTip.font", small());
        UIManager.put("ToolTip.border", border(4, 8, 4, 8));
    }

    private static void redress() {
        try {
            UIManager.setLookAndFeel(new MetalLookAndFeel());
        } catch (UnsupportedLookAndFeelException e) {
            throw new AssertionError(e); // It is Java's own, everywhere.
        }
        LargerIcon.putInPlaceOf(DIALOG_ICONS, factor);
    }

    /** A ring just inside a component, while the keyboard is at it. */
    static void paintFocus(Graphics2D g, Component component) {
        if (component.isFocusOwner()) {
            g.setColor(ACCENT);
            g.setStroke(new BasicStroke(px(2)));
            int half = px(2) / 2;
            g.drawRoundRect(
                    half,
                    half,
                    component.getWidth() - 2 * half,
                    component.getHeight() - 2 * half,
                    corner(),
                    corner());
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
