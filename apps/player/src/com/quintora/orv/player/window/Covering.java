// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Container;
import java.awt.Rectangle;
import java.awt.Window;
import javax.swing.SwingUtilities;

/** What lies over a component in its window: controls, menus, words. */
final class Covering {
    private Covering() {}

    /** On the window's thread. Other windows, such as large menus, do not count. */
    static boolean isOver(Component covered) {
        Component below = covered;
        for (Container parent = covered.getParent();
                parent != null && !(below instanceof Window);
                parent = parent.getParent()) {
            if (parent instanceof NoticePane notices && notices.hasWords()) {
                return true;
            }
            Rectangle area = SwingUtilities.convertRectangle(
                    covered.getParent(), covered.getBounds(), parent);
            if (isAnyOver(area, below, parent)) {
                return true;
            }
            below = parent;
        }
        return false;
    }

    // The first of a container's components is the uppermost.
    private static boolean isAnyOver(Rectangle area, Component below, Container parent) {
        for (Component sibling : parent.getComponents()) {
            if (sibling == below) {
                return false;
            }
            if (sibling.isVisible() && sibling.getBounds().intersects(area)) {
                return true;
            }
        }
        return false;
    }
}
