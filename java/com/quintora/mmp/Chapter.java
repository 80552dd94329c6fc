// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.time.Duration;
import java.util.Optional;

/**
 * A chapter mark.
 *
 * @param index its number, from 0
 * @param startMillis where it begins, in milliseconds
 * @param endMillis where it ends, in milliseconds; -1 when unknown
 * @param title its title, possibly empty
 */
public record Chapter(int index, int startMillis, int endMillis, String title) {
    /**
     * Where it begins.
     *
     * @return the time from the media's start
     */
    public Duration start() {
        return Duration.ofMillis(startMillis);
    }

    /**
     * Where it ends.
     *
     * @return the time from the media's start; empty when unknown
     */
    public Optional<Duration> end() {
        return endMillis < 0 ? Optional.empty() : Optional.of(Duration.ofMillis(endMillis));
    }
}
