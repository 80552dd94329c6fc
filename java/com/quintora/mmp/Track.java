// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** A track of a player's media, as its table was when it was read. Immutable. */
public sealed interface Track permits VideoTrack, AudioTrack, SubtitleTrack {
    /** What a track holds. */
    enum Kind {
        /** Moving pictures. */
        VIDEO,
        /** Sound. */
        AUDIO,
        /** Subtitles, as text or pictures. */
        SUBTITLE
    }

    /**
     * What the track holds.
     *
     * @return the kind
     */
    Kind kind();

    /**
     * The track's number among those of its kind.
     *
     * @return from 0
     */
    int index();

    /**
     * The codec.
     *
     * @return four characters, such as "h264"; empty when unknown
     */
    String codec();

    /**
     * What the media says of the track's use.
     *
     * @return the flags
     */
    TrackFlags flags();
}
