// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.Optional;
import java.util.OptionalInt;

/**
 * What a stream says of its sound. Immutable.
 *
 * @param sampleRate samples per second and channel as they are played, above 0; empty when unknown
 * @param channels how many, above 0; empty when unknown
 * @param channelLayout such as "stereo" or "5.1(side)"; empty when unknown
 * @param sampleFormat the decoder's format, such as "fltp"; empty when unknown
 * @param bitsPerSample above 0; empty for codecs without a sample width
 */
public record SoundDetails(
        OptionalInt sampleRate,
        OptionalInt channels,
        Optional<String> channelLayout,
        Optional<String> sampleFormat,
        OptionalInt bitsPerSample) {}
