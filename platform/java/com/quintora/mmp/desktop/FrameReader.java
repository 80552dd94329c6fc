// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import android.view.Surface;
import com.quintora.mmp.platform.internal.PlatformLibrary;
import java.lang.ref.Cleaner;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.util.concurrent.Executor;

/**
 * Lends the frames that a player draws, without a copy: the consumer behind a {@link Surface}.
 * Their size may change while the player draws. {@link android.media.ImageReader} is what a program
 * uses that shall also run on a television.
 *
 * <p>The newest frame wins: one that was not taken before the next arrives is dropped, so a slow
 * reader never holds up the player. All methods may be called from any thread; only
 * {@link #awaitFrame} blocks. Close the reader after use: the player then draws nowhere.
 */
public final class FrameReader implements AutoCloseable {
    static {
        PlatformLibrary.load();
    }

    private static final Cleaner CLEANER = Cleaner.create();

    // What the native queue answers, as in the platform's error numbers.
    private static final int NO_ERROR = 0;
    private static final int WOULD_BLOCK = -11;
    private static final int NO_INIT = -19;

    // The long[] that nativeAcquire fills.
    private static final int SLOT = 0;
    private static final int WIDTH = 1;
    private static final int HEIGHT = 2;
    private static final int STRIDE = 3;
    private static final int TIMESTAMP_US = 4;
    private static final int MEMORY = 5;
    private static final int FIELD_COUNT = 6;

    // Waits are cut into pieces of this length, to see interruptions.
    private static final int WAIT_SLICE_MS = 50;

    // The native queue lives as long as this object; close() only abandons it,
    // so that no call can meet a queue that is gone.
    private final long mQueue;
    private final Surface mSurface;
    private final Object mListenerLock = new Object();
    private FrameNotifier mNotifier;
    private volatile boolean mClosed;

    /** Makes a reader of frames in the video's own size. */
    public FrameReader() {
        this(0, 0);
    }

    /**
     * Makes a reader.
     *
     * @param width pixels, up to 16384; 0 with a height of 0 for the video's own size
     * @param height rows, up to 16384
     * @throws IllegalArgumentException for any other size
     */
    public FrameReader(int width, int height) {
        long queue = nativeCreate();
        if (queue == 0) {
            throw new OutOfMemoryError("native buffer queue");
        }
        mQueue = queue;
        CLEANER.register(this, () -> nativeDestroy(queue));
        setFrameSize(width, height);
        mSurface = nativeCreateSurface(queue);
    }

    /**
     * The surface to give to a player.
     *
     * @return always the same one; {@link #close()} releases it
     */
    public Surface getSurface() {
        return mSurface;
    }

    /**
     * Asks the player for frames of another size, from one of its next frames on.
     *
     * @param width pixels, up to 16384; 0 with a height of 0 for the video's own size
     * @param height rows, up to 16384
     * @throws IllegalArgumentException for any other size
     */
    public void setFrameSize(int width, int height) {
        if (nativeSetFrameSize(mQueue, width, height) != NO_ERROR) {
            throw new IllegalArgumentException("Invalid frame size " + width + "x" + height);
        }
    }

    /**
     * Takes the newest frame, without waiting.
     *
     * @return the frame, or null when there is none newer than the one taken before
     * @throws IllegalStateException while an earlier frame is not closed, or after {@link #close()}
     */
    public VideoFrame acquireLatestFrame() {
        long[] fields = new long[FIELD_COUNT];
        int status = nativeAcquire(mQueue, fields);
        switch (status) {
            case NO_ERROR:
                return frameOf(fields);
            case WOULD_BLOCK:
                return null;
            case NO_INIT:
                throw new IllegalStateException("FrameReader is closed");
            default:
                throw new IllegalStateException("The frame taken before is not closed");
        }
    }

    /**
     * Takes the newest frame, waiting for one when there is none.
     *
     * @param timeoutMillis the longest wait in milliseconds; 0 or less for none
     * @return the frame, or null when none came in time
     * @throws IllegalStateException while an earlier frame is not closed, or when the reader is
     *         closed before or during the wait
     * @throws InterruptedException when the thread is interrupted while it waits
     */
    public VideoFrame awaitFrame(long timeoutMillis) throws InterruptedException {
        long start = System.nanoTime();
        while (true) {
            long seen = nativeGetQueuedCount(mQueue);
            VideoFrame frame = acquireLatestFrame();
            long leftMillis = timeoutMillis - (System.nanoTime() - start) / 1_000_000;
            if (frame != null || leftMillis <= 0) {
                return frame;
            }
            if (Thread.interrupted()) {
                throw new InterruptedException();
            }
            nativeAwaitFrame(mQueue, seen, (int) Math.min(leftMillis, WAIT_SLICE_MS));
        }
    }

    /**
     * Sets who is notified of new frames; at most one listener at a time.
     *
     * @param listener is run once for one or several new frames; null for none
     * @param executor runs the listener, such as {@code EventQueue::invokeLater}; null for a thread
     *        of the reader's own
     */
    public void setOnFrameAvailable(Runnable listener, Executor executor) {
        synchronized (mListenerLock) {
            if (mNotifier != null) {
                mNotifier.mStopped = true;
                mNotifier = null;
            }
            if (listener != null && !mClosed) {
                Executor notifier = executor != null ? executor : Runnable::run;
                mNotifier = new FrameNotifier(listener, notifier);
                mNotifier.start();
            }
        }
    }

    /**
     * How much was drawn.
     *
     * @return the number of frames so far
     */
    public long getFrameCount() {
        return nativeGetQueuedCount(mQueue);
    }

    /**
     * How much of that nobody saw.
     *
     * @return the number of frames that were overtaken by a newer one before anybody took them
     */
    public long getDroppedFrameCount() {
        return nativeGetDroppedCount(mQueue);
    }

    /**
     * Ends the reading: the surface is released, the player's frames go nowhere, waiting threads
     * return, the listener is dropped. A frame that is still open stays readable. May be called
     * again.
     */
    @Override
    public void close() {
        mClosed = true;
        setOnFrameAvailable(null, null);
        mSurface.release();
        nativeAbandon(mQueue);
    }

    void release(int slot) {
        nativeRelease(mQueue, slot);
    }

    // The buffer keeps the frame's memory, beyond the frame and the reader.
    private VideoFrame frameOf(long[] fields) {
        long memory = fields[MEMORY];
        ByteBuffer bytes = nativeWrapMemory(memory, fields[STRIDE] * fields[HEIGHT]);
        CLEANER.register(bytes, () -> nativeReleaseMemory(memory));
        ByteBuffer pixels = bytes.asReadOnlyBuffer().order(ByteOrder.LITTLE_ENDIAN);
        return new VideoFrame(this, (int) fields[SLOT], (int) fields[WIDTH], (int) fields[HEIGHT],
                (int) fields[STRIDE], fields[TIMESTAMP_US], pixels);
    }

    /** Waits for frames and notifies the listener. */
    private final class FrameNotifier extends Thread {
        private final Runnable mListener;
        private final Executor mExecutor;
        private long mSeen = nativeGetQueuedCount(mQueue);
        volatile boolean mStopped;

        FrameNotifier(Runnable listener, Executor executor) {
            super("FrameReader");
            setDaemon(true);
            mListener = listener;
            mExecutor = executor;
        }

        @Override
        public void run() {
            while (!mStopped) {
                long queued = nativeAwaitFrame(mQueue, mSeen, WAIT_SLICE_MS);
                if (queued > mSeen) {
                    mSeen = queued;
                    mExecutor.execute(this::notifyListener);
                }
            }
        }

        private void notifyListener() {
            if (!mStopped) {
                mListener.run();
            }
        }
    }

    private static native long nativeCreate();

    private static native void nativeDestroy(long queue);

    private static native ByteBuffer nativeWrapMemory(long memory, long bytes);

    private static native void nativeReleaseMemory(long memory);

    // Not static: a call in progress keeps this object, and with it the queue.
    private native Surface nativeCreateSurface(long queue);

    private native int nativeSetFrameSize(long queue, int width, int height);

    private native int nativeAcquire(long queue, long[] fields);

    private native int nativeRelease(long queue, int slot);

    private native long nativeAwaitFrame(long queue, long seen, int timeoutMs);

    private native void nativeAbandon(long queue);

    private native long nativeGetQueuedCount(long queue);

    private native long nativeGetDroppedCount(long queue);
}
