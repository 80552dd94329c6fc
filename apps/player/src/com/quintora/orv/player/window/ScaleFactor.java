// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.GraphicsEnvironment;
import java.awt.Toolkit;

/**
 * How many times as large as usual the window's controls are. Java itself knows whole factors alone
 * on X displays; what is missing to the desktop's wish is made up for here.
 */
final class ScaleFactor {
    private static final double USUAL_DPI = 96;
    private static final double PARTS_OF_DOT = 1024;
    private static final double LARGEST = 4;

    private ScaleFactor() {}

    /** What this desktop wishes for, from 1 to 4. */
    static double ofDesktop() {
        double ofJava =
                GraphicsEnvironment.getLocalGraphicsEnvironment()
                        .getDefaultScreenDevice()
                        .getDefaultConfiguration()
                        .getDefaultTransform()
                        .getScaleX();
        return wished(
                Toolkit.getDefaultToolkit().getDesktopProperty("gnome.Xft/DPI"), ofJava);
    }

    /**
     * Of a desktop's letters.
     *
     * @param dpi in 1024ths of dots per inch; what is no number says nothing
     * @param ofJava by how much Java enlarges all without our help
     */
    static double wished(Object dpi, double ofJava) {
        if (!(dpi instanceof Number parts)) {
            return 1;
        }
        double wish = parts.doubleValue() / PARTS_OF_DOT / USUAL_DPI / ofJava;
        return Math.max(1, Math.min(LARGEST, wish));
    }
}
