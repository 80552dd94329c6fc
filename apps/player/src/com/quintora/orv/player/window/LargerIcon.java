// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.util.List;
import javax.swing.Icon;
import javax.swing.UIManager;

/** An icon of Swing's own look in another size: most of them are drawn by lines. */
final class LargerIcon implements Icon {
    private final Icon usual;
    private final double factor;

    private LargerIcon(Icon usual, double factor) {
        this.usual = usual;
        this.factor = factor;
    }

    /** In the present look; a new one begins with its own. */
    static void putInPlaceOf(List<String> names, double factor) {
        var look = UIManager.getLookAndFeelDefaults();
        for (String name : names) {
            Icon usual = look.getIcon(name);
            if (usual != null) {
                look.put(name, new LargerIcon(usual, factor));
            }
        }
    }

    @Override
    public void paintIcon(Component on, Graphics graphics, int x, int y) {
        Graphics2D g = (Graphics2D) graphics.create();
        g.translate(x, y);
        g.scale(factor, factor);
        usual.paintIcon(on, g, 0, 0);
        g.dispose();
    }

    @Override
    public int getIconWidth() {
        return (int) Math.round(usual.getIconWidth() * factor);
    }

    @Override
    public int getIconHeight() {
        return (int) Math.round(usual.getIconHeight() * factor);
    }
}
