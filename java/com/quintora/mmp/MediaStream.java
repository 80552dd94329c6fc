// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.OptionalLong;

/**
 * A stream of the media's container. Immutable.
 *
 * @param index its place in the container, from 0
 * @param kind what it holds
 * @param track its index in the table of {@link Tracks} for its kind; empty for what is no track
 * @param codec the codec's short name, such as "aac" or "h264"; empty when unknown
 * @param codecName the codec's name in words; empty when unknown
 * @param codecTag the container's code of the codec, such as "mp4a"; empty when it has none
 * @param profile the codec's profile, such as "Main 10"; empty when unknown
 * @param level the codec's own number of the level, above 0; empty when unknown
 * @param language an ISO 639 code; empty when the container does not say
 * @param title the stream's title; empty when it has none
 * @param flags what the container says of its use, such as "default", "forced" or
 *     "hearing_impaired"
 * @param startMicros its first timestamp in microseconds; empty when unknown
 * @param durationMicros how long it is, in microseconds; empty when unknown
 * @param bitRate bits per second, above 0; empty when unknown
 * @param picture what is known of the pictures; empty but for {@link Kind#VIDEO} and {@link
 *     Kind#PICTURE}
 * @param sound what is known of the sound; empty but for {@link Kind#AUDIO}
 * @param attachment what is known of the file; empty but for {@link Kind#ATTACHMENT}
 */
public record MediaStream(
        int index,
        Kind kind,
        OptionalInt track,
        String codec,
        String codecName,
        Optional<String> codecTag,
        Optional<String> profile,
        OptionalInt level,
        Optional<String> language,
        Optional<String> title,
        List<String> flags,
        OptionalLong startMicros,
        OptionalLong durationMicros,
        OptionalLong bitRate,
        Optional<PictureDetails> picture,
        Optional<SoundDetails> sound,
        Optional<Attachment> attachment) {
    /** What a stream holds. */
    public enum Kind {
        /** Moving pictures. */
        VIDEO,
        /** An embedded picture, such as a cover. */
        PICTURE,
        /** Sound. */
        AUDIO,
        /** Subtitles, as text or pictures. */
        SUBTITLE,
        /** A file, such as a font. */
        ATTACHMENT,
        /** Anything else, such as time codes. */
        DATA
    }

    /**
     * An attached file.
     *
     * @param fileName its name; empty when it has none
     * @param mimeType its type, such as "font/ttf"; empty when the container does not say
     * @param size bytes; empty when unknown
     */
    public record Attachment(
            Optional<String> fileName, Optional<String> mimeType, OptionalLong size) {}

    /**
     * Copies the list.
     *
     * @param index its place in the container, from 0
     * @param kind what it holds
     * @param track its index in the table of {@link Tracks} for its kind; empty for what is no
     *     track
     * @param codec the codec's short name, such as "aac" or "h264"; empty when unknown
     * @param codecName the codec's name in words; empty when unknown
     * @param codecTag the container's code of the codec, such as "mp4a"; empty when it has none
     * @param profile the codec's profile, such as "Main 10"; empty when unknown
     * @param level the codec's own number of the level, above 0; empty when unknown
     * @param language an ISO 639 code; empty when the container does not say
     * @param title the stream's title; empty when it has none
     * @param flags what the container says of its use, such as "default", "forced" or
     *     "hearing_impaired"
     * @param startMicros its first timestamp in microseconds; empty when unknown
     * @param durationMicros how long it is, in microseconds; empty when unknown
     * @param bitRate bits per second, above 0; empty when unknown
     * @param picture what is known of the pictures; empty but for {@link Kind#VIDEO} and {@link
     *     Kind#PICTURE}
     * @param sound what is known of the sound; empty but for {@link Kind#AUDIO}
     * @param attachment what is known of the file; empty but for {@link Kind#ATTACHMENT}
     */
    public MediaStream {
        flags = List.copyOf(flags);
    }
}
