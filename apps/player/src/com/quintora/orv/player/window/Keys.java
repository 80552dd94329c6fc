// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.KeyboardFocusManager;
import java.awt.event.ActionEvent;
import java.awt.event.KeyEvent;
import java.util.List;
import java.util.function.BooleanSupplier;
import javax.swing.AbstractAction;
import javax.swing.JComponent;
import javax.swing.KeyStroke;
import javax.swing.text.JTextComponent;

/** The window's keys. They rest while a menu is open, which has keys of its own. */
final class Keys {
    private Keys() {}

    /**
     * Binds the actions' keys for the window in which that component is. It must not be the root
     * pane, where these bindings would hide those of an open menu.
     */
    static void bind(JComponent content, List<ActionGroup> groups) {
        for (ActionGroup group : groups) {
            for (Action action : group.actions()) {
                for (String key : action.keys()) {
                    boolean isTyped = isTyped(KeyStroke.getKeyStroke(key));
                    bind(
                            content,
                            JComponent.WHEN_IN_FOCUSED_WINDOW,
                            key,
                            () -> !ChoiceMenu.isOpen() && !(isTyped && isTyping()),
                            action.run());
                }
            }
        }
    }

    // What writes something in a field, or does something to its text.
    private static boolean isTyped(KeyStroke key) {
        int code = key.getKeyCode();
        boolean isFunction = code >= KeyEvent.VK_F1 && code <= KeyEvent.VK_F12;
        return code != KeyEvent.VK_ESCAPE && !isFunction;
    }

    private static boolean isTyping() {
        Component focused =
                KeyboardFocusManager.getCurrentKeyboardFocusManager().getPermanentFocusOwner();
        return focused instanceof JTextComponent text && text.isEditable();
    }

    /** While a component has the focus or, as the condition says, its window has. */
    static void bind(JComponent component, int condition, String key, Runnable action) {
        bind(component, condition, key, () -> !ChoiceMenu.isOpen(), action);
    }

    private static void bind(
            JComponent component,
            int condition,
            String key,
            BooleanSupplier isEnabled,
            Runnable action) {
        component.getInputMap(condition).put(KeyStroke.getKeyStroke(key), key);
        component.getActionMap()
                .put(
                        key,
                        new AbstractAction() {
                            @Override
                            public void actionPerformed(ActionEvent event) {
                                action.run();
                            }

                            @Override
                            public boolean isEnabled() {
                                return isEnabled.getAsBoolean();
                            }
                        });
    }
}
