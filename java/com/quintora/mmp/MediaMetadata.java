// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.internal.base.Times;
import java.time.Duration;
import java.util.Optional;

/**
 * What the media says of itself. Texts have at most 128 UTF-16 units and are empty when unknown;
 * numbers are 0 when unknown.
 *
 * @param durationMillis milliseconds
 * @param bitRate bits per second of the whole media
 * @param year when it appeared
 * @param trackNumber its number on its album
 * @param title its title
 * @param artist who made it
 * @param album its album
 * @param genre its genre
 * @param chapterCount how many chapter marks it has
 * @param composer who composed it
 * @param container the file format's name
 * @param comment a comment
 */
public record MediaMetadata(
        int durationMillis,
        int bitRate,
        int year,
        int trackNumber,
        String title,
        String artist,
        String album,
        String genre,
        int chapterCount,
        String composer,
        String container,
        String comment) {
    /**
     * How long the media is.
     *
     * @return the duration; empty when unknown
     */
    public Optional<Duration> duration() {
        return Times.known(durationMillis);
    }
}
