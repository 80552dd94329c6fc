// SPDX-License-Identifier: Apache-2.0
package android.media;

import java.nio.ByteBuffer;
import java.util.Objects;

/**
 * One video frame lent by an {@link ImageReader}: 32 bits a pixel, bytes B, G, R, X in memory. The
 * reader lends one frame at a time, so close it as soon as it is shown or copied. Not thread-safe,
 * but any one thread may use it.
 */
public class Image implements AutoCloseable {
    /** The pixels of a frame. */
    public static final class Plane {
        private final Image mImage;

        private Plane(Image image) {
            mImage = image;
        }

        /** Bytes from the start of one row to the start of the next, a multiple of 64. */
        public int getRowStride() {
            mImage.checkOpen();
            return mImage.mRowStride;
        }

        /** Bytes from one pixel to the next: 4. */
        public int getPixelStride() {
            mImage.checkOpen();
            return 4;
        }

        /**
         * The rows, top first: a direct, read-only, little-endian buffer of row stride times height
         * bytes at position 0. Read as ints, each pixel is 0xXXRRGGBB with X undefined. Once the
         * image is closed the content changes under the reader, usually not before another frame
         * was taken, but reading stays harmless.
         */
        public ByteBuffer getBuffer() {
            mImage.checkOpen();
            return mImage.mPixels;
        }
    }

    private final ImageReader mReader;
    private final int mSlot;
    private final int mWidth;
    private final int mHeight;
    private final int mRowStride;
    private final long mTimestampUs;
    private final ByteBuffer mPixels;
    private boolean mClosed;

    Image(ImageReader reader, int slot, int width, int height, int rowStride, long timestampUs,
            ByteBuffer pixels) {
        mReader = Objects.requireNonNull(reader);
        mSlot = slot;
        mWidth = width;
        mHeight = height;
        mRowStride = rowStride;
        mTimestampUs = timestampUs;
        mPixels = pixels;
    }

    /** Pixels in a row. */
    public int getWidth() {
        checkOpen();
        return mWidth;
    }

    /** Number of rows. */
    public int getHeight() {
        checkOpen();
        return mHeight;
    }

    /** The frame's media time in nanoseconds. */
    public long getTimestamp() {
        checkOpen();
        return mTimestampUs * 1000;
    }

    /** One plane that holds whole pixels. */
    public Plane[] getPlanes() {
        checkOpen();
        return new Plane[] {new Plane(this)};
    }

    /**
     * Gives the frame back to the reader. The other methods throw
     * {@link IllegalStateException} from now on; closing again does nothing.
     */
    @Override
    public void close() {
        if (!mClosed) {
            mClosed = true;
            mReader.release(mSlot);
        }
    }

    private void checkOpen() {
        if (mClosed) {
            throw new IllegalStateException("Image is already closed");
        }
    }
}
