// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Ellipsis;
import com.quintora.orv.player.ReadingOrder;
import java.awt.Component;
import java.awt.Point;
import java.awt.Window;
import java.awt.event.HierarchyBoundsAdapter;
import java.awt.event.HierarchyEvent;
import javax.swing.JLabel;
import javax.swing.JWindow;
import javax.swing.SwingUtilities;

/** A few words over a picture that is a window of its own, which nothing can be painted on. */
final class WordsWindow {
    private static final int PLACE = 20;

    private final Component picture;
    private final JLabel label = new JLabel();
    private JWindow window;

    WordsWindow(Component picture) {
        this.picture = picture;
        label.setFont(Theme.body(16));
        label.setForeground(Theme.TEXT);
        label.setBackground(Theme.PANEL);
        label.setOpaque(true);
        label.setBorder(Theme.border(8, 14, 8, 14));
        label.putClientProperty("html.disable", true);
        picture.addHierarchyBoundsListener(
                new HierarchyBoundsAdapter() {
                    @Override
                    public void ancestorMoved(HierarchyEvent event) {
                        if (window != null && picture.isShowing()) {
                            place();
                        }
                    }
                });
    }

    /** Shows them in place of those before; none when empty. */
    void show(String words) {
        if (window != null && (words.isEmpty() || window.getOwner() != owner())) {
            window.dispose();
            window = null;
        }
        if (words.isEmpty() || !picture.isShowing()) {
            return;
        }
        if (window == null) {
            window = new JWindow(owner());
            window.setFocusableWindowState(false);
            window.add(label);
        }
        int room = picture.getWidth() - 2 * Theme.px(PLACE) - 2 * Theme.px(14);
        label.setText(
                Ellipsis.inMiddle(
                        ReadingOrder.ofSentence(words),
                        label.getFontMetrics(label.getFont()),
                        room));
        window.pack();
        place();
        window.setVisible(true);
    }

    private void place() {
        Point corner = picture.getLocationOnScreen();
        window.setLocation(corner.x + Theme.px(PLACE), corner.y + Theme.px(PLACE));
    }

    private Window owner() {
        return SwingUtilities.getWindowAncestor(picture);
    }
}
