// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.text.DecimalFormat;
import java.text.DecimalFormatSymbols;
import java.util.Locale;

/** The speeds that the window offers, slowest first. */
final class Speeds {
    private static final double[] OFFERED = {0.25, 0.5, 0.75, 1, 1.25, 1.5, 2, 4, 8, 16};

    private Speeds() {}

    static double[] offered() {
        return OFFERED.clone();
    }

    /** The offered speed that lies some steps from a speed, or the last in that direction. */
    static double from(double speed, int steps) {
        int nearest = 0;
        for (int i = 1; i < OFFERED.length; i++) {
            if (Math.abs(OFFERED[i] - speed) < Math.abs(OFFERED[nearest] - speed)) {
                nearest = i;
            }
        }
        return OFFERED[Math.max(0, Math.min(OFFERED.length - 1, nearest + steps))];
    }

    static String label(double speed) {
        return new DecimalFormat("0.##", DecimalFormatSymbols.getInstance(Locale.ROOT))
                        .format(speed)
                + "×";
    }
}
