// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import java.nio.ByteBuffer;
import java.util.Objects;

/**
 * One video frame lent by a {@link FrameReader}: 32 bits a pixel, bytes B, G, R, X in memory. The
 * reader lends one frame at a time, so close it as soon as it is shown or copied. Not thread-safe,
 * but any one thread may use it. Nothing blocks. Once it is closed, every method but {@link #close}
 * throws {@link IllegalStateException}.
 */
public final class VideoFrame implements AutoCloseable {
    private final FrameReader mReader;
    private final int mSlot;
    private final int mWidth;
    private final int mHeight;
    private final int mRowStride;
    private final long mTimestampUs;
    private final ByteBuffer mPixels;
    private boolean mClosed;

    VideoFrame(FrameReader reader, int slot, int width, int height, int rowStride, long timestampUs,
            ByteBuffer pixels) {
        mReader = Objects.requireNonNull(reader);
        mSlot = slot;
        mWidth = width;
        mHeight = height;
        mRowStride = rowStride;
        mTimestampUs = timestampUs;
        mPixels = pixels;
    }

    /**
     * The width.
     *
     * @return pixels in a row
     * @throws IllegalStateException if the frame is closed
     */
    public int getWidth() {
        checkOpen();
        return mWidth;
    }

    /**
     * The height.
     *
     * @return the number of rows
     * @throws IllegalStateException if the frame is closed
     */
    public int getHeight() {
        checkOpen();
        return mHeight;
    }

    /**
     * The distance of rows.
     *
     * @return bytes from the start of one row to the start of the next, a multiple of 64
     * @throws IllegalStateException if the frame is closed
     */
    public int getRowStride() {
        checkOpen();
        return mRowStride;
    }

    /**
     * When the frame shows.
     *
     * @return its media time in nanoseconds
     * @throws IllegalStateException if the frame is closed
     */
    public long getTimestamp() {
        checkOpen();
        return mTimestampUs * 1000;
    }

    /**
     * The rows, top first. Read as ints, each pixel is 0xXXRRGGBB with X undefined.
     *
     * @return a direct, read-only, little-endian buffer of row stride times height bytes. Once the
     *         frame is closed the content changes under the reader, usually not before another
     *         frame was taken, but reading stays harmless
     * @throws IllegalStateException if the frame is closed
     */
    public ByteBuffer getPixels() {
        checkOpen();
        return mPixels;
    }

    /**
     * Gives the frame back to the reader; closing again does nothing.
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
            throw new IllegalStateException("The frame is already closed");
        }
    }
}
