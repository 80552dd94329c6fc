// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.FontMetrics;

/** Shortens words that have not enough room. Widths are in pixels. */
public final class Ellipsis {
    private static final String SIGN = "…";

    private Ellipsis() {}

    /** Leaves out the end, as of a title. */
    public static String atEnd(String text, FontMetrics metrics, int width) {
        int end = text.length();
        String shown = text;
        while (end > 0 && metrics.stringWidth(shown) > width) {
            end = text.offsetByCodePoints(end, -1);
            shown = text.substring(0, end) + SIGN;
        }
        return shown;
    }

    /** Leaves out the middle, as of a path, both ends of which say something. */
    public static String inMiddle(String text, FontMetrics metrics, int width) {
        int start = text.offsetByCodePoints(0, text.codePointCount(0, text.length()) / 2);
        int end = start;
        String shown = text;
        while (start > 0 && metrics.stringWidth(shown) > width) {
            start = text.offsetByCodePoints(start, -1);
            end = end < text.length() ? text.offsetByCodePoints(end, 1) : end;
            shown = text.substring(0, start) + SIGN + text.substring(end);
        }
        return shown;
    }
}
