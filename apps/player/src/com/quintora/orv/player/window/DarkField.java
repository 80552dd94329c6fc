// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import javax.swing.BorderFactory;
import javax.swing.JTextField;

/** Gives fields for text the window's look. */
final class DarkField {
    private DarkField() {}

    /** The name is for screen readers and the tip. */
    static <T extends JTextField> T of(T field, String name) {
        field.setBackground(Theme.STAGE);
        field.setForeground(Theme.TEXT);
        field.setCaretColor(Theme.TEXT);
        field.setSelectionColor(Theme.TRACK);
        field.setSelectedTextColor(Theme.TEXT);
        field.setFont(Theme.body());
        field.setBorder(
                BorderFactory.createCompoundBorder(
                        BorderFactory.createLineBorder(Theme.TRACK),
                        Theme.border(4, 8, 4, 8)));
        field.setToolTipText(name);
        field.getAccessibleContext().setAccessibleName(name);
        return field;
    }
}
