// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** Pixel formats of thumbnails. 16-bit formats are in the machine's byte order. */
public enum ColorMode {
    /** 5 bits red, 6 green, 5 blue, red in the high bits. */
    RGB565(3, 2),
    /** 1 bit alpha, 5 each of red, green and blue, alpha in the high bit. */
    ARGB1555(4, 2),
    /** Bytes blue, green, red, alpha. */
    ARGB8888(5, 4),
    /** Bytes U, Y, V, Y for two pixels. */
    UYVY422(9, 2),
    /** Bytes Y, U, Y, V for two pixels. */
    YUYV422(10, 2),
    /** 4 bits each of alpha, red, green and blue, alpha in the high bits. */
    ARGB4444(11, 2),
    /** Bytes red, green, blue, alpha. */
    RGBA8888(12, 4),
    /** 5 bits blue, 6 green, 5 red, blue in the high bits. */
    BGR565(15, 2),
    /** 16 bits of brightness. */
    GRAY16(16, 2),
    /** Bytes alpha, blue, green, red. */
    ABGR8888(17, 4),
    /** Bytes blue, green, red and one that means nothing. */
    XRGB8888(18, 4);

    private final int number;
    private final int bytesPerPixel;

    ColorMode(int number, int bytesPerPixel) {
        this.number = number;
        this.bytesPerPixel = bytesPerPixel;
    }

    /**
     * The engine's number of this format.
     *
     * @return 3 to 18
     */
    public int number() {
        return number;
    }

    /**
     * The size of a pixel.
     *
     * @return 2 or 4
     */
    public int bytesPerPixel() {
        return bytesPerPixel;
    }
}
