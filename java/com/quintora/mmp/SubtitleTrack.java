// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * A subtitle track. Texts are empty when unknown.
 *
 * @param index its number among the subtitle tracks, from 0
 * @param trackId the container's number
 * @param codec four characters
 * @param language an ISO 639 code
 * @param title the track's title
 * @param flags what is said of the track
 */
public record SubtitleTrack(
        int index, int trackId, String codec, String language, String title, TrackFlags flags)
        implements Track {
    @Override
    public Kind kind() {
        return Kind.SUBTITLE;
    }
}
