// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.internal.base.Arguments;
import java.nio.ByteBuffer;

/** A picture of the media. Immutable. */
public final class Thumbnail {
    private final int width;
    private final int height;
    private final ColorMode colorMode;
    private final byte[] pixels;

    /**
     * A picture.
     *
     * @param width pixels, above 0
     * @param height rows, above 0
     * @param colorMode the pixels' format
     * @param pixels {@code width * height * colorMode.bytesPerPixel()} bytes, row by row from the
     *     top, without padding; copied
     * @throws IllegalArgumentException when something is null, or the sizes do not match
     */
    public Thumbnail(int width, int height, ColorMode colorMode, byte[] pixels) {
        this.width = width;
        this.height = height;
        this.colorMode = Arguments.require(colorMode, "the pixels' format");
        this.pixels = Arguments.require(pixels, "the array of pixels").clone();
        if (width < 1 || height < 1
                || pixels.length != (long) width * height * colorMode.bytesPerPixel()) {
            throw new IllegalArgumentException(pixels.length + " bytes are no picture of "
                    + width + "x" + height + " in " + colorMode);
        }
    }

    /**
     * The picture's width.
     *
     * @return pixels
     */
    public int width() {
        return width;
    }

    /**
     * The picture's height.
     *
     * @return rows
     */
    public int height() {
        return height;
    }

    /**
     * The pixels' format.
     *
     * @return the format
     */
    public ColorMode colorMode() {
        return colorMode;
    }

    /**
     * The pixels, without a copy.
     *
     * @return a read-only buffer of its own, row by row from the top, without padding
     */
    public ByteBuffer pixels() {
        return ByteBuffer.wrap(pixels).asReadOnlyBuffer();
    }

    /**
     * A copy of the pixels.
     *
     * @return {@code width() * height() * colorMode().bytesPerPixel()} bytes, row by row from the
     *     top, without padding
     */
    public byte[] toByteArray() {
        return pixels.clone();
    }

    @Override
    public String toString() {
        return "Thumbnail[" + width + "x" + height + " " + colorMode + "]";
    }
}
