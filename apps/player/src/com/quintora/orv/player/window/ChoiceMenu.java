// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Dimension;
import java.awt.Graphics;
import java.util.List;
import javax.swing.JLabel;
import javax.swing.JMenuItem;
import javax.swing.JPopupMenu;
import javax.swing.MenuElement;
import javax.swing.MenuSelectionManager;

/**
 * A list of choices that opens above a button, with a tick at the present one, where the keyboard
 * begins: Up and Down move, Enter chooses, Escape closes.
 */
final class ChoiceMenu {
    /** A choice: what it says, whether it holds now, what it does. */
    record Choice(String text, boolean chosen, Runnable action) {}

    private ChoiceMenu() {}

    static void open(Component above, String title, List<Choice> choices) {
        JPopupMenu menu = new JPopupMenu(title);
        menu.setBackground(Theme.RAISED);
        menu.setBorder(Theme.border(6, 0, 6, 0));
        JLabel heading = new JLabel(title);
        heading.setFont(Theme.small());
        heading.setForeground(Theme.MUTED);
        heading.setBorder(Theme.border(4, 14, 6, 14));
        menu.add(heading);
        JMenuItem present = null;
        for (Choice choice : choices) {
            JMenuItem item = menu.add(new Item(choice));
            present = present == null || choice.chosen ? item : present;
        }
        Dimension size = menu.getPreferredSize();
        menu.show(above, above.getWidth() - size.width, -size.height - Theme.gap());
        MenuSelectionManager.defaultManager()
                .setSelectedPath(new MenuElement[] {menu, present});
    }

    static boolean isOpen() {
        return MenuSelectionManager.defaultManager().getSelectedPath().length > 0;
    }

    private static final class Item extends JMenuItem {
        private final boolean isChosen;

        Item(Choice choice) {
            super(choice.text);
            MenuRow.prepare(this);
            isChosen = choice.chosen;
            addActionListener(event -> choice.action.run());
        }

        @Override
        public Dimension getPreferredSize() {
            return MenuRow.size(this, "");
        }

        @Override
        protected void paintComponent(Graphics graphics) {
            MenuRow.paint(graphics, this, isArmed(), isChosen, "");
        }
    }
}
