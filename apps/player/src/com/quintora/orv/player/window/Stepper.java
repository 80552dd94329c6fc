// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.util.function.IntConsumer;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.JLabel;
import javax.swing.SwingConstants;

/** A value between two buttons, which step it down and up. */
final class Stepper extends Box {
    private static final int VALUE_WIDTH = 72;

    private final JLabel value = new JLabel("", SwingConstants.CENTER);
    private final String name;

    /** The step is -1 or 1. */
    Stepper(String name, String down, String up, IntConsumer step) {
        super(BoxLayout.X_AXIS);
        this.name = name;
        getAccessibleContext().setAccessibleName(name);
        value.setFont(Theme.body());
        value.setForeground(Theme.TEXT);
        Dimension size = new Dimension(Theme.px(VALUE_WIDTH), Theme.button());
        value.setPreferredSize(size);
        value.setMaximumSize(size);
        add(button("−", down, () -> step.accept(-1)));
        add(value);
        add(button("+", up, () -> step.accept(1)));
    }

    private static FlatButton button(String sign, String name, Runnable action) {
        FlatButton button = new FlatButton(null, name, action);
        button.setText(sign);
        return button;
    }

    void show(String words) {
        value.setText(words);
        value.getAccessibleContext().setAccessibleName(name + " " + words);
    }
}
