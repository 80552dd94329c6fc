// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Dimension;
import java.awt.Graphics;
import java.util.List;
import javax.swing.JMenu;
import javax.swing.JMenuItem;
import javax.swing.JPopupMenu;
import javax.swing.MenuElement;
import javax.swing.MenuSelectionManager;
import javax.swing.SwingUtilities;

/** The menu of all that the window does, a submenu for each group. */
final class ActionMenu {
    private ActionMenu() {}

    /** Opens it with its corner at that place of the component. */
    static void open(Component on, int x, int y, List<ActionGroup> groups) {
        JPopupMenu menu = menuOf(groups);
        menu.show(on, x, y);
        select(menu);
    }

    /** Opens it above a button. */
    static void openAbove(Component button, List<ActionGroup> groups) {
        JPopupMenu menu = menuOf(groups);
        Dimension size = menu.getPreferredSize();
        menu.show(button, button.getWidth() - size.width, -size.height - Theme.gap());
        select(menu);
    }

    private static JPopupMenu menuOf(List<ActionGroup> groups) {
        JPopupMenu menu = new JPopupMenu("Menu");
        dress(menu);
        groups.forEach(group -> menu.add(new Submenu(group)));
        return menu;
    }

    private static void dress(JPopupMenu menu) {
        menu.setBackground(Theme.RAISED);
        menu.setBorder(Theme.border(6, 0, 6, 0));
    }

    // So that the arrow keys begin at the first row.
    private static void select(JPopupMenu menu) {
        MenuSelectionManager.defaultManager()
                .setSelectedPath(
                        new MenuElement[] {menu, (MenuElement) menu.getComponent(0)});
    }

    private static final class Submenu extends JMenu {
        Submenu(ActionGroup group) {
            super(group.name());
            MenuRow.prepare(this);
            setOpaque(true);
            dress(getPopupMenu());
            group.actions().forEach(action -> add(new Item(action)));
        }

        @Override
        public Dimension getPreferredSize() {
            return MenuRow.size(this, "");
        }

        @Override
        protected void paintComponent(Graphics graphics) {
            MenuRow.paint(graphics, this, isSelected() || isArmed(), false, "");
        }
    }

    private static final class Item extends JMenuItem {
        private final String keys;
        private final boolean isOn;

        Item(Action action) {
            super(action.name());
            MenuRow.prepare(this);
            keys = action.keyNames();
            isOn = action.isOn().getAsBoolean();
            getAccessibleContext().setAccessibleDescription(keys);
            // Some open another menu, which this one's end would close again.
            addActionListener(event -> SwingUtilities.invokeLater(action.run()));
        }

        @Override
        public Dimension getPreferredSize() {
            return MenuRow.size(this, keys);
        }

        @Override
        protected void paintComponent(Graphics graphics) {
            MenuRow.paint(graphics, this, isArmed(), isOn, keys);
        }
    }
}
