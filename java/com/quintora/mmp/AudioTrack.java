// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * A sound track. Texts are empty and numbers 0 when unknown.
 *
 * @param index its number among the sound tracks, from 0
 * @param codec four characters, such as "aac " or "mp4a"
 * @param channels how many
 * @param sampleRate samples per second and channel
 * @param bitRate bits per second
 * @param bitsPerSample 0 for codecs without a sample width
 * @param trackId the container's number
 * @param title the track's title, at most 128 UTF-16 units, as are the following texts
 * @param codecName the codec's name in words
 * @param channelLayout such as "stereo" or "5.1"
 * @param profile the codec's profile
 * @param flags what is said of the track
 * @param comment a comment
 * @param encoder the program that made the track
 * @param handler the container's handler name
 * @param language an ISO 639 code
 */
public record AudioTrack(
        int index,
        String codec,
        int channels,
        int sampleRate,
        int bitRate,
        int bitsPerSample,
        int trackId,
        String title,
        String codecName,
        String channelLayout,
        String profile,
        TrackFlags flags,
        String comment,
        String encoder,
        String handler,
        String language) implements Track {
    @Override
    public Kind kind() {
        return Kind.AUDIO;
    }
}
