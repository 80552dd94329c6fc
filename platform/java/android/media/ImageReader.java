// SPDX-License-Identifier: Apache-2.0
package android.media;

import android.graphics.PixelFormat;
import android.os.Handler;
import android.os.Looper;
import android.view.Surface;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.nio.IntBuffer;
import java.util.ArrayDeque;
import java.util.Deque;
import java.util.HashSet;
import java.util.Set;

/**
 * Gives a program the frames that a player draws, as images of one size and format.
 *
 * <p>One frame waits to be taken at most: the next one takes its place, so that a slow program
 * never holds up the player. Each image is a copy of its frame; {@link FrameReader} lends the
 * desktop's frames themselves. All methods may be called from any thread and none blocks.
 */
public class ImageReader implements AutoCloseable {
    /** Is notified of new frames. */
    public interface OnImageAvailableListener {
        /**
         * Called once for one or several new frames.
         *
         * @param reader has them; take the newest with {@link ImageReader#acquireLatestImage()}
         */
        void onImageAvailable(ImageReader reader);
    }

    // What a frame, read as little-endian ints, has beside blue in its low byte.
    private static final int BLUE = 0xff;
    private static final int GREEN = 0xff00;
    private static final int OPAQUE = 0xff000000;

    private final FrameReader mFrames;
    private final int mWidth;
    private final int mHeight;
    private final int mFormat;
    private final int mMaxImages;

    // All under the lock of mOpen.
    private final Set<ReaderImage> mOpen = new HashSet<>();
    private final Deque<ByteBuffer> mSpare = new ArrayDeque<>();
    private boolean mClosed;

    private ImageReader(int width, int height, int format, int maxImages) {
        mFrames = new FrameReader(width, height);
        mWidth = width;
        mHeight = height;
        mFormat = format;
        mMaxImages = maxImages;
    }

    /**
     * Makes a reader. Close it after use: the player then draws nowhere.
     *
     * @param width of the images in pixels, 1 to 16384
     * @param height of the images in rows, 1 to 16384
     * @param format {@link PixelFormat#RGBA_8888} or {@link PixelFormat#RGBX_8888}; the images of
     *        both are opaque
     * @param maxImages how many images may be open at a time, 1 or more
     * @return a new reader
     * @throws IllegalArgumentException for anything else
     */
    public static ImageReader newInstance(int width, int height, int format, int maxImages) {
        if (width < 1 || height < 1) {
            throw new IllegalArgumentException("The image dimensions must be positive");
        }
        if (maxImages < 1) {
            throw new IllegalArgumentException("maxImages must be at least 1");
        }
        if (format != PixelFormat.RGBA_8888 && format != PixelFormat.RGBX_8888) {
            throw new IllegalArgumentException("Format " + format + " is not supported");
        }
        return new ImageReader(width, height, format, maxImages);
    }

    /**
     * The width that the reader was made with.
     *
     * @return pixels
     */
    public int getWidth() {
        return mWidth;
    }

    /**
     * The height that the reader was made with.
     *
     * @return rows
     */
    public int getHeight() {
        return mHeight;
    }

    /**
     * The format of the images.
     *
     * @return one of {@link PixelFormat}
     */
    public int getImageFormat() {
        return mFormat;
    }

    /**
     * How many images may be open at a time.
     *
     * @return 1 or more
     */
    public int getMaxImages() {
        return mMaxImages;
    }

    /**
     * The surface to give to a player.
     *
     * @return always the same one; {@link #close()} releases it
     */
    public Surface getSurface() {
        return mFrames.getSurface();
    }

    /**
     * Takes the newest frame.
     *
     * @return null when there is none newer than the one that was taken before
     * @throws IllegalStateException while {@link #getMaxImages()} images are open, or after
     *         {@link #close()}
     */
    public Image acquireLatestImage() {
        return acquireNextImage();
    }

    /**
     * Takes the frame that waits longest; as one waits at most, this is the newest, too.
     *
     * @return null when there is none newer than the one that was taken before
     * @throws IllegalStateException while {@link #getMaxImages()} images are open, or after
     *         {@link #close()}
     */
    public Image acquireNextImage() {
        synchronized (mOpen) {
            if (mClosed) {
                throw new IllegalStateException("ImageReader is closed");
            }
            if (mOpen.size() >= mMaxImages) {
                throw new IllegalStateException("maxImages (" + mMaxImages
                        + ") has already been acquired, call #close before acquiring more.");
            }
            try (VideoFrame frame = mFrames.acquireLatestFrame()) {
                return frame == null ? null : open(frame);
            }
        }
    }

    /**
     * Sets who is notified of new frames; at most one listener at a time.
     *
     * @param listener null for none
     * @param handler its thread runs the listener; null for that of the calling thread's looper
     * @throws IllegalArgumentException for a listener without a handler on a thread that has no
     *         looper
     */
    public void setOnImageAvailableListener(OnImageAvailableListener listener, Handler handler) {
        if (listener == null) {
            mFrames.setOnFrameAvailable(null, null);
            return;
        }
        Looper looper = handler == null ? Looper.myLooper() : handler.getLooper();
        if (looper == null) {
            throw new IllegalArgumentException(
                    "handler is null but the current thread is not a looper");
        }
        Handler notified = handler == null ? new Handler(looper) : handler;
        mFrames.setOnFrameAvailable(() -> listener.onImageAvailable(this), notified::post);
    }

    /**
     * Ends the reading: the surface is released, the player's frames go nowhere, the listener is
     * dropped, images that are open are closed. May be called again.
     */
    @Override
    public void close() {
        mFrames.close();
        synchronized (mOpen) {
            mClosed = true;
            mOpen.forEach(ReaderImage::invalidate);
            mOpen.clear();
            mSpare.clear();
        }
    }

    void takeBack(ReaderImage image) {
        synchronized (mOpen) {
            if (mOpen.remove(image)) {
                mSpare.add(image.pixels());
            }
        }
    }

    private Image open(VideoFrame frame) {
        int width = frame.getWidth();
        int height = frame.getHeight();
        ByteBuffer pixels = pixelsOf(width * height * ReaderImage.BYTES_PER_PIXEL);
        int[] row = new int[width];
        IntBuffer source = frame.getPixels().asIntBuffer();
        IntBuffer target = pixels.order(ByteOrder.LITTLE_ENDIAN).asIntBuffer();
        for (int y = 0; y < height; y++) {
            source.get(y * (frame.getRowStride() / ReaderImage.BYTES_PER_PIXEL), row);
            turnRound(row);
            target.put(row);
        }
        ReaderImage image = new ReaderImage(
                this, width, height, frame.getTimestamp(), pixels.order(ByteOrder.nativeOrder()));
        mOpen.add(image);
        return image;
    }

    // Spare ones are mostly of that size, as a reader's frames have one.
    private ByteBuffer pixelsOf(int bytes) {
        mSpare.removeIf(spare -> spare.capacity() != bytes);
        ByteBuffer spare = mSpare.poll();
        return spare == null ? ByteBuffer.allocateDirect(bytes) : spare.clear();
    }

    private static void turnRound(int[] pixels) {
        for (int i = 0; i < pixels.length; i++) {
            int pixel = pixels[i];
            pixels[i] = OPAQUE | (pixel & BLUE) << 16 | pixel & GREEN | pixel >> 16 & BLUE;
        }
    }
}
