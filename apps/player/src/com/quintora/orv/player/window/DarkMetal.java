// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Color;
import javax.swing.plaf.ColorUIResource;
import javax.swing.plaf.FontUIResource;
import javax.swing.plaf.metal.DefaultMetalTheme;

/** The window's colours and letters for Swing's own look, in which dialogs show. */
final class DarkMetal extends DefaultMetalTheme {
    private static final ColorUIResource TEXT = resource(Theme.TEXT);
    private static final ColorUIResource FIELD = resource(Theme.STAGE);
    private final FontUIResource font = new FontUIResource(Theme.body());

    private static ColorUIResource resource(Color color) {
        return new ColorUIResource(color);
    }

    @Override
    public String getName() {
        return "Dark";
    }

    // Borders of what is active; the focus; what is selected.
    @Override
    protected ColorUIResource getPrimary1() {
        return resource(Theme.BUFFERED);
    }

    @Override
    protected ColorUIResource getPrimary2() {
        return resource(Theme.ACCENT);
    }

    @Override
    protected ColorUIResource getPrimary3() {
        return resource(Theme.HOVER);
    }

    // Borders; what is pressed or disabled; the ground.
    @Override
    protected ColorUIResource getSecondary1() {
        return resource(Theme.TRACK);
    }

    @Override
    protected ColorUIResource getSecondary2() {
        return resource(Theme.BUFFERED);
    }

    @Override
    protected ColorUIResource getSecondary3() {
        return resource(Theme.PANEL);
    }

    @Override
    protected ColorUIResource getBlack() {
        return TEXT;
    }

    @Override
    protected ColorUIResource getWhite() {
        return FIELD;
    }

    @Override
    public ColorUIResource getTextHighlightColor() {
        return resource(Theme.TRACK);
    }

    @Override
    public ColorUIResource getHighlightedTextColor() {
        return TEXT;
    }

    @Override
    public ColorUIResource getMenuSelectedBackground() {
        return resource(Theme.HOVER);
    }

    @Override
    public FontUIResource getControlTextFont() {
        return font;
    }

    @Override
    public FontUIResource getSystemTextFont() {
        return font;
    }

    @Override
    public FontUIResource getUserTextFont() {
        return font;
    }

    @Override
    public FontUIResource getMenuTextFont() {
        return font;
    }

    @Override
    public FontUIResource getWindowTitleFont() {
        return font;
    }

    @Override
    public FontUIResource getSubTextFont() {
        return new FontUIResource(Theme.small());
    }
}
