// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * A picture track. Numbers are 0 when unknown.
 *
 * @param index its number among the picture tracks, from 0
 * @param codec four characters, such as "h264"; empty when unknown
 * @param width pixels
 * @param height rows
 * @param frameRate frames per second
 * @param bitRate bits per second
 * @param flags what is said of the track
 */
public record VideoTrack(
        int index,
        String codec,
        int width,
        int height,
        double frameRate,
        int bitRate,
        TrackFlags flags) implements Track {
    @Override
    public Kind kind() {
        return Kind.VIDEO;
    }
}
