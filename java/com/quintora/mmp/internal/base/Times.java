// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import java.time.Duration;
import java.util.Optional;

/** The engine's milliseconds as durations, and back. */
public final class Times {
    private static final Duration MAX = Duration.ofMillis(Integer.MAX_VALUE);

    private Times() {}

    public static int toMillis(Duration time) {
        Arguments.require(time, "the time");
        if (time.isNegative() || time.compareTo(MAX) > 0) {
            throw new IllegalArgumentException(
                    "a time is 0 to 2147483647 ms (24 days): " + time);
        }
        return (int) time.toMillis();
    }

    /** Empty for 0, which the engine reports for unknown. */
    public static Optional<Duration> known(int millis) {
        return millis == 0 ? Optional.empty() : Optional.of(Duration.ofMillis(millis));
    }
}
