// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.Arrays;

/**
 * Something worth knowing about playing.
 *
 * @param kind what it is
 * @param what the engine's number of it
 * @param extra the engine's further number, or 0
 */
public record PlaybackInfo(Kind kind, int what, int extra) {
    /** What is worth knowing. */
    public enum Kind {
        /** The picture or sound began to run for the first time. */
        RENDERING_STARTED(3),
        /** Playing waits for data. */
        BUFFERING_STARTED(701),
        /** Playing goes on. */
        BUFFERING_ENDED(702),
        /** Information of the engine's own. */
        OTHER(0);

        private final int what;

        Kind(int what) {
            this.what = what;
        }
    }

    /**
     * The information of an engine's numbers.
     *
     * @param what the engine's number of it
     * @param extra the engine's further number, or 0
     * @return the information, of {@link Kind#OTHER} for an unknown number
     */
    public static PlaybackInfo of(int what, int extra) {
        Kind kind = Arrays.stream(Kind.values())
                .filter(known -> known != Kind.OTHER && known.what == what)
                .findFirst()
                .orElse(Kind.OTHER);
        return new PlaybackInfo(kind, what, extra);
    }

    /**
     * Information without a further number.
     *
     * @param kind what it is
     * @return the information
     */
    public static PlaybackInfo of(Kind kind) {
        return new PlaybackInfo(kind, kind.what, 0);
    }
}
