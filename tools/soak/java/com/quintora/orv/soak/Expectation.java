// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import java.util.EnumSet;
import java.util.Set;

/**
 * Which failures media may have.
 *
 * @param notice when a failure must be reported
 * @param errors the kinds that it may have
 */
record Expectation(Notice notice, Set<MediaError> errors) {
    /** When a failure must be reported. */
    enum Notice {
        /** There must be none. */
        NEVER,
        /** There may be one at any time. */
        PERHAPS,
        /** By setting the source or by prepare. */
        OPENING,
        /** By prepare, or while playing, before the end. */
        PLAYING
    }

    static final Expectation WELL = new Expectation(Notice.NEVER, EnumSet.noneOf(MediaError.class));

    /** What bytes that are not the media's may lead to. */
    static final Set<MediaError> DAMAGE = EnumSet.of(MediaError.MALFORMED, MediaError.UNSUPPORTED,
            MediaError.IO, MediaError.CUT_SHORT, MediaError.NOTHING_INSIDE, MediaError.EMPTY);

    /** What a connection may break with. */
    static final Set<MediaError> CONNECTION = EnumSet.of(MediaError.CONNECTION_LOST,
            MediaError.CANNOT_CONNECT, MediaError.CUT_SHORT, MediaError.NO_ANSWER,
            MediaError.TIMED_OUT, MediaError.IO, MediaError.NEEDS_RANGES, MediaError.MALFORMED,
            MediaError.NOTHING_INSIDE);

    static Expectation perhaps(Set<MediaError> errors) {
        return new Expectation(Notice.PERHAPS, errors);
    }

    static Expectation opening(MediaError... errors) {
        return new Expectation(Notice.OPENING, Set.of(errors));
    }

    static Expectation playing(Set<MediaError> errors) {
        return new Expectation(Notice.PLAYING, errors);
    }

    boolean isWell() {
        return notice == Notice.NEVER;
    }

    /** Throws what was reported when it must not have been. */
    void check(MediaException reported) {
        if (isWell()) {
            throw new AssertionError("media without a fault failed", reported);
        }
        if (!errors.contains(reported.error())) {
            throw new AssertionError(
                    "the fault was reported as " + reported.error() + ", not one of " + errors,
                    reported);
        }
        if (reported.getMessage() == null || reported.getMessage().isBlank()) {
            throw new AssertionError("the failure has no sentence", reported);
        }
    }
}
