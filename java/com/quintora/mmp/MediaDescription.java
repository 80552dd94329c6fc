// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.List;
import java.util.OptionalLong;

/**
 * What the media say of themselves beyond the tables of {@link Tracks}. Names of formats, codecs
 * and colours are FFmpeg's. Immutable.
 *
 * @param format the container's short name, such as "matroska,webm"; several names of one format
 *     are separated by commas
 * @param formatName the container's name in words
 * @param durationMicros how long the media is, in microseconds; empty when unknown
 * @param startMicros the first timestamp in microseconds, which is position 0; may be negative;
 *     empty when unknown
 * @param bitRate bits per second of the whole, above 0; empty when unknown
 * @param size bytes, above 0; empty when unknown
 * @param streams all streams in the container's order, also those that are no tracks
 */
public record MediaDescription(
        String format,
        String formatName,
        OptionalLong durationMicros,
        OptionalLong startMicros,
        OptionalLong bitRate,
        OptionalLong size,
        List<MediaStream> streams) {
    /**
     * Copies the list.
     *
     * @param format the container's short name, such as "matroska,webm"; several names of one
     *     format are separated by commas
     * @param formatName the container's name in words
     * @param durationMicros how long the media is, in microseconds; empty when unknown
     * @param startMicros the first timestamp in microseconds, which is position 0; may be
     *     negative; empty when unknown
     * @param bitRate bits per second of the whole, above 0; empty when unknown
     * @param size bytes, above 0; empty when unknown
     * @param streams all streams in the container's order, also those that are no tracks
     */
    public MediaDescription {
        streams = List.copyOf(streams);
    }
}
