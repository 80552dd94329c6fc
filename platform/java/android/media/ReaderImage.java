// SPDX-License-Identifier: Apache-2.0
package android.media;

import java.nio.ByteBuffer;

/** An image with a copy of a frame's pixels, without gaps between the rows. */
final class ReaderImage extends Image {
    static final int BYTES_PER_PIXEL = 4;

    private final ImageReader mReader;
    private final int mWidth;
    private final int mHeight;
    private final long mTimestampNs;
    private final ByteBuffer mPixels;
    private final Plane mPlane = new PixelPlane();
    private volatile boolean mClosed;

    ReaderImage(ImageReader reader, int width, int height, long timestampNs, ByteBuffer pixels) {
        mReader = reader;
        mWidth = width;
        mHeight = height;
        mTimestampNs = timestampNs;
        mPixels = pixels;
    }

    ByteBuffer pixels() {
        return mPixels;
    }

    /** From here on the image refuses. Whether it was open. */
    synchronized boolean invalidate() {
        boolean wasOpen = !mClosed;
        mClosed = true;
        return wasOpen;
    }

    @Override
    public int getFormat() {
        checkOpen();
        return mReader.getImageFormat();
    }

    @Override
    public int getWidth() {
        checkOpen();
        return mWidth;
    }

    @Override
    public int getHeight() {
        checkOpen();
        return mHeight;
    }

    @Override
    public long getTimestamp() {
        checkOpen();
        return mTimestampNs;
    }

    @Override
    public Plane[] getPlanes() {
        checkOpen();
        return new Plane[] {mPlane};
    }

    @Override
    public void close() {
        if (invalidate()) {
            mReader.takeBack(this);
        }
    }

    private void checkOpen() {
        if (mClosed) {
            throw new IllegalStateException("Image is already closed");
        }
    }

    private final class PixelPlane extends Plane {
        @Override
        public int getRowStride() {
            checkOpen();
            return mWidth * BYTES_PER_PIXEL;
        }

        @Override
        public int getPixelStride() {
            checkOpen();
            return BYTES_PER_PIXEL;
        }

        @Override
        public ByteBuffer getBuffer() {
            checkOpen();
            return mPixels;
        }
    }
}
