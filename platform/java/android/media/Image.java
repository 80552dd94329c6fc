// SPDX-License-Identifier: Apache-2.0
package android.media;

import java.nio.ByteBuffer;

/**
 * A frame that was taken from an {@link ImageReader}. Close it soon: a reader has only so many.
 * Once it or its reader is closed, every method but {@link #close} throws
 * {@link IllegalStateException}. Not thread-safe, but any one thread may use it. Nothing blocks.
 */
public abstract class Image implements AutoCloseable {
    Image() {}

    /** The pixels of an image. */
    public abstract static class Plane {
        Plane() {}

        /**
         * The distance of rows.
         *
         * @return bytes from the start of one row to the start of the next
         * @throws IllegalStateException if the image is closed
         */
        public abstract int getRowStride();

        /**
         * The distance of pixels.
         *
         * @return bytes from one pixel of a row to the next
         * @throws IllegalStateException if the image is closed
         */
        public abstract int getPixelStride();

        /**
         * The pixels, row by row, the top one first, as the image's format says.
         *
         * @return a direct buffer in native byte order, with the first pixel at index 0; the same
         *         one in each call. Do not use it once the image is closed: the pixels may be
         *         those of another then
         * @throws IllegalStateException if the image is closed
         */
        public abstract ByteBuffer getBuffer();
    }

    /**
     * How the pixels are stored.
     *
     * @return the format that the reader was made with, of {@link android.graphics.PixelFormat}
     * @throws IllegalStateException if the image is closed
     */
    public abstract int getFormat();

    /**
     * The width.
     *
     * @return pixels in a row
     * @throws IllegalStateException if the image is closed
     */
    public abstract int getWidth();

    /**
     * The height.
     *
     * @return the number of rows
     * @throws IllegalStateException if the image is closed
     */
    public abstract int getHeight();

    /**
     * When the frame shows.
     *
     * @return its media time in nanoseconds
     * @throws IllegalStateException if the image is closed
     */
    public abstract long getTimestamp();

    /**
     * The pixels.
     *
     * @return one plane, with whole pixels
     * @throws IllegalStateException if the image is closed
     */
    public abstract Plane[] getPlanes();

    /** Gives the image back to its reader. May be called again. */
    @Override
    public abstract void close();
}
