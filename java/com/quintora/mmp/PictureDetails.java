// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.Optional;
import java.util.OptionalDouble;
import java.util.OptionalInt;

/**
 * What a stream says of its pictures. Immutable.
 *
 * @param width stored pixels, 0 when unknown
 * @param height stored rows, 0 when unknown
 * @param displayWidth columns on a display with square pixels, turned; 0 when unknown
 * @param displayHeight rows of the same; 0 when unknown
 * @param pixelAspect width to height of a stored pixel; empty when unknown, which means square
 * @param displayAspect width to height of the picture before it is turned; empty when unknown
 * @param rotation degrees to turn clockwise for display: 0, 90, 180 or 270
 * @param mirrored whether left and right then change sides
 * @param pixelFormat such as "yuv420p10le"; empty when unknown
 * @param bitDepth bits of a pixel's component, 1 to 32; empty when unknown
 * @param fieldOrder "progressive", or "tt", "bb", "tb", "bt": the field that is stored first and
 *     the one that is shown first; empty when unknown
 * @param color what is said of the colours
 * @param frameRate frames per second on average; empty when unknown
 * @param light what the pictures were mastered for
 */
public record PictureDetails(
        int width,
        int height,
        int displayWidth,
        int displayHeight,
        Optional<Ratio> pixelAspect,
        Optional<Ratio> displayAspect,
        int rotation,
        boolean mirrored,
        Optional<String> pixelFormat,
        OptionalInt bitDepth,
        Optional<String> fieldOrder,
        Color color,
        OptionalDouble frameRate,
        Light light) {
    /**
     * Two numbers above 0, as in 16:9.
     *
     * @param width the first
     * @param height the second
     */
    public record Ratio(int width, int height) {
        @Override
        public String toString() {
            return width + ":" + height;
        }
    }

    /**
     * How numbers become colours, by FFmpeg's names for the values of ITU-T H.273. Each is empty
     * when the media does not say.
     *
     * @param primaries such as "bt709" or "bt2020"
     * @param transfer such as "bt709", "smpte2084" (PQ) or "arib-std-b67" (HLG)
     * @param matrix such as "bt709" or "bt2020nc"
     * @param range "tv" (limited) or "pc" (full)
     * @param chromaLocation such as "left" or "topleft"
     */
    public record Color(
            Optional<String> primaries,
            Optional<String> transfer,
            Optional<String> matrix,
            Optional<String> range,
            Optional<String> chromaLocation) {
        /**
         * The kind of high dynamic range.
         *
         * @return "PQ" or "HLG"; empty for standard dynamic range
         */
        public Optional<String> highDynamicRange() {
            return switch (transfer.orElse("")) {
                case "smpte2084" -> Optional.of("PQ");
                case "arib-std-b67" -> Optional.of("HLG");
                default -> Optional.empty();
            };
        }
    }

    /**
     * Metadata of high dynamic range, where the container has them; all luminances in cd/m².
     *
     * @param masteringMin the darkest that the mastering display can show
     * @param masteringMax the brightest that it can show
     * @param maxContent the brightest pixel of the content
     * @param maxFrameAverage the brightest frame's average
     * @param dolbyVisionProfile the profile number of Dolby Vision
     */
    public record Light(
            OptionalDouble masteringMin,
            OptionalDouble masteringMax,
            OptionalDouble maxContent,
            OptionalDouble maxFrameAverage,
            OptionalInt dolbyVisionProfile) {}
}
