// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Container;
import java.awt.Rectangle;
import java.awt.event.FocusAdapter;
import java.awt.event.FocusEvent;
import javax.swing.JComponent;

/** Scrolls to what the keyboard reaches, where it would not be seen. */
final class FollowFocus extends FocusAdapter {
    private static final FollowFocus INSTANCE = new FollowFocus();

    private FollowFocus() {}

    /** For all that is in there now. */
    static void in(Container container) {
        for (Component child : container.getComponents()) {
            child.addFocusListener(INSTANCE);
            if (child instanceof Container box) {
                in(box);
            }
        }
    }

    @Override
    public void focusGained(FocusEvent event) {
        JComponent component = (JComponent) event.getComponent();
        component.scrollRectToVisible(
                new Rectangle(component.getWidth(), component.getHeight()));
    }
}
