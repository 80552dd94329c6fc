// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Color;
import java.util.LinkedHashMap;
import java.util.Map;
import java.util.function.Consumer;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.ButtonGroup;

/** Buttons of which one is chosen; none, if it is another value that is shown. */
final class ChoiceRow<T> extends Box {
    private final Map<T, ChoiceButton> buttons = new LinkedHashMap<>();
    private final ButtonGroup group = new ButtonGroup();
    private final String name;
    private final Consumer<T> choose;

    ChoiceRow(String name, Consumer<T> choose) {
        super(BoxLayout.X_AXIS);
        this.name = name;
        this.choose = choose;
        getAccessibleContext().setAccessibleName(name);
    }

    /** The colour may be null. */
    ChoiceRow<T> add(String label, Color color, T value) {
        ChoiceButton button =
                new ChoiceButton(name, label, color, () -> choose.accept(value));
        buttons.put(value, button);
        group.add(button);
        add(button);
        return this;
    }

    void show(T value) {
        if (buttons.containsKey(value)) {
            buttons.get(value).setSelected(true);
        } else {
            group.clearSelection();
        }
    }
}
