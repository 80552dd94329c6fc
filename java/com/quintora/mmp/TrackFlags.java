// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * What is said of a track.
 *
 * @param bits the engine's bits
 */
public record TrackFlags(int bits) {
    private static final int DEFAULT = 1;
    private static final int FORCED = 1 << 1;
    private static final int EXTERNAL = 1 << 2;
    private static final int SELECTED = 1 << 3;

    /**
     * Whether the media suggests this track.
     *
     * @return true if so
     */
    public boolean isDefault() {
        return (bits & DEFAULT) != 0;
    }

    /**
     * Whether the track is meant to be shown in any case.
     *
     * @return true if so
     */
    public boolean isForced() {
        return (bits & FORCED) != 0;
    }

    /**
     * Whether the track came from a file beside the media.
     *
     * @return true if so
     */
    public boolean isExternal() {
        return (bits & EXTERNAL) != 0;
    }

    /**
     * Whether the track was being played when the table was read.
     *
     * @return true if so
     */
    public boolean isSelected() {
        return (bits & SELECTED) != 0;
    }
}
