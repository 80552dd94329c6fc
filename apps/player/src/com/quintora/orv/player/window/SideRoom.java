// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BorderLayout;
import java.util.HashMap;
import java.util.Map;
import java.util.function.Supplier;
import javax.swing.JLabel;
import javax.swing.JPanel;

/** The room beside the picture: one panel at a time, under its title, or none. */
final class SideRoom extends JPanel {
    private final Map<String, SidePanel> made = new HashMap<>();
    private final JLabel heading = new JLabel();
    private final Runnable onLeft;
    private SidePanel shown;

    /** Left is called when the room closes, for the focus to go elsewhere. */
    SideRoom(Runnable onLeft) {
        super(new BorderLayout());
        this.onLeft = onLeft;
        setBackground(Theme.PANEL);
        setVisible(false);
        heading.setFont(Theme.body().deriveFont(java.awt.Font.BOLD));
        heading.setForeground(Theme.TEXT);
        JPanel top = new JPanel(new BorderLayout());
        top.setOpaque(false);
        top.setBorder(Theme.border(6, 14, 4, 6));
        top.add(heading, BorderLayout.CENTER);
        top.add(new FlatButton(Glyph.CLOSE, "Close (Escape)", this::close), BorderLayout.EAST);
        add(top, BorderLayout.NORTH);
    }

    /** Shows the panel of that name, made when it is first asked for; or hides it if it shows. */
    void toggle(String name, Supplier<SidePanel> maker) {
        boolean isShown = isShown(name);
        close();
        if (!isShown) {
            open(made.computeIfAbsent(name, key -> maker.get()));
        }
    }

    boolean isShown(String name) {
        return shown != null && shown == made.get(name);
    }

    boolean isOpen() {
        return shown != null;
    }

    private void open(SidePanel panel) {
        shown = panel;
        heading.setText(panel.title());
        add(panel, BorderLayout.CENTER);
        setVisible(true);
        revalidate();
        repaint();
        panel.onOpen();
    }

    void close() {
        if (shown == null) {
            return;
        }
        SidePanel before = shown;
        shown = null;
        remove(before);
        setVisible(false);
        before.onClose();
        onLeft.run();
    }
}
