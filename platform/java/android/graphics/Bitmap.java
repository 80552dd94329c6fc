// SPDX-License-Identifier: Apache-2.0
package android.graphics;

import java.util.Objects;

/**
 * An immutable picture of ARGB pixels: each an int 0xAARRGGBB, not premultiplied. Safe for use by
 * several threads.
 */
public final class Bitmap {
    /** How pixels are stored. */
    public enum Config {
        /** 8 bits each of alpha, red, green and blue. */
        ARGB_8888
    }

    private final int[] mPixels;
    private final int mWidth;
    private final int mHeight;
    private final Config mConfig;

    private Bitmap(int[] pixels, int width, int height, Config config) {
        mPixels = pixels;
        mWidth = width;
        mHeight = height;
        mConfig = config;
    }

    /**
     * Makes a bitmap from a copy of the pixels.
     *
     * @param colors the rows, top first, without gaps; at least width times height of them
     * @param width pixels in a row, 1 or more
     * @param height the number of rows, 1 or more
     * @param config how the pixels are stored
     * @return a new bitmap
     * @throws NullPointerException for no colors or no config
     * @throws IllegalArgumentException for a size that is not positive
     * @throws ArrayIndexOutOfBoundsException for too few colors
     */
    public static Bitmap createBitmap(int[] colors, int width, int height, Config config) {
        Objects.requireNonNull(config, "config");
        if (width <= 0 || height <= 0) {
            throw new IllegalArgumentException("width and height must be > 0");
        }
        long count = (long) width * height;
        if (colors.length < count) {
            throw new ArrayIndexOutOfBoundsException(
                    colors.length + " colors for " + width + "x" + height + " pixels");
        }
        int[] pixels = new int[(int) count];
        System.arraycopy(colors, 0, pixels, 0, pixels.length);
        return new Bitmap(pixels, width, height, config);
    }

    /**
     * The width.
     *
     * @return pixels in a row
     */
    public int getWidth() {
        return mWidth;
    }

    /**
     * The height.
     *
     * @return the number of rows
     */
    public int getHeight() {
        return mHeight;
    }

    /**
     * How the pixels are stored.
     *
     * @return never null
     */
    public Config getConfig() {
        return mConfig;
    }

    /**
     * One pixel.
     *
     * @param x its column, from 0
     * @param y its row, from 0
     * @return its color, 0xAARRGGBB
     * @throws IllegalArgumentException for a position outside the bitmap
     */
    public int getPixel(int x, int y) {
        if (x < 0 || x >= mWidth || y < 0 || y >= mHeight) {
            throw new IllegalArgumentException(
                    "(" + x + ", " + y + ") is outside " + mWidth + "x" + mHeight);
        }
        return mPixels[y * mWidth + x];
    }

    /**
     * Copies a rectangle of pixels out.
     *
     * @param pixels receives the colors
     * @param offset the first index written
     * @param stride array entries from one row to the next, at least width; negative to write the
     *        rows towards the start of the array
     * @param x the rectangle's left column
     * @param y its top row
     * @param width its pixels in a row
     * @param height its number of rows
     * @throws IllegalArgumentException for a rectangle outside the bitmap or a stride whose
     *         magnitude is below width
     * @throws ArrayIndexOutOfBoundsException for an array too small
     */
    public void getPixels(
            int[] pixels, int offset, int stride, int x, int y, int width, int height) {
        if (x < 0 || y < 0 || width < 0 || height < 0 || width > mWidth - x
                || height > mHeight - y) {
            throw new IllegalArgumentException("rectangle outside " + mWidth + "x" + mHeight);
        }
        if (Math.abs(stride) < width) {
            throw new IllegalArgumentException("stride " + stride + " is below width " + width);
        }
        for (int row = 0; row < height; row++) {
            System.arraycopy(
                    mPixels, (y + row) * mWidth + x, pixels, offset + row * stride, width);
        }
    }
}
