// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.LayoutManager;
import javax.swing.JPanel;

/** A panel that shows beside the picture. On the window's thread. */
abstract class SidePanel extends JPanel {
    private final String title;

    SidePanel(String title, LayoutManager layout) {
        super(layout);
        this.title = title;
        setBackground(Theme.PANEL);
        getAccessibleContext().setAccessibleName(title);
    }

    final String title() {
        return title;
    }

    /** It is about to show; what costs anything begins here, and gets the focus. */
    void onOpen() {}

    /** It no longer shows. */
    void onClose() {}
}
