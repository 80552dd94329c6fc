// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.subtitles;

/** Where lines of subtitles stand between the picture's left and right edge. */
public enum Side {
    LEFT("Left", 30),
    CENTER("Centre", 0),
    RIGHT("Right", -30);

    private final String label;
    private final int offset;

    Side(String label, int offset) {
        this.label = label;
        this.offset = offset;
    }

    public String label() {
        return label;
    }

    /** As the subtitles' attributes have it, in thousandths of the picture's width. */
    int offset() {
        return offset;
    }
}
