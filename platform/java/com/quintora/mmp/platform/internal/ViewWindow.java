// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.platform.internal;

import android.view.Surface;
import java.awt.Component;
import java.lang.ref.Cleaner;
import java.lang.ref.Reference;

/** The native half of a view's window. Thread-safe. */
final class ViewWindow {
    static {
        PlatformLibrary.load();
    }

    private static final Cleaner CLEANER = Cleaner.create();
    private static final boolean KNOWS_WINDOWS = loadWindows();

    // Lives as long as this object, so that no call can meet a window that is gone.
    private final long mNative;
    private long mSeen; // The one thread's that awaits frames.

    ViewWindow(long id, boolean acceptsSoftwareGl) {
        long window = nativeCreate(id, acceptsSoftwareGl);
        if (window == 0) {
            throw new OutOfMemoryError("native window");
        }
        mNative = window;
        CLEANER.register(this, () -> nativeDestroy(window));
    }

    // The JDK's own, and what was built against it.
    private static boolean loadWindows() {
        try {
            System.loadLibrary("jawt");
            return true;
        } catch (UnsatisfiedLinkError e) {
            return false;
        }
    }

    /** The desktop's number of a component's window; 0 when that cannot be known. */
    static long idOf(Component component) {
        try {
            return KNOWS_WINDOWS ? nativeWindowOf(component) : 0;
        } catch (UnsatisfiedLinkError e) {
            return 0; // Built without the JDK's headers.
        }
    }

    /** A surface for the window; who cannot draw on it fills the buffers of the other one. */
    Surface surface(Surface buffers) {
        Surface surface = nativeCreateSurface(mNative, buffers);
        Reference.reachabilityFence(this);
        if (surface == null) {
            throw new OutOfMemoryError("native producer");
        }
        return surface;
    }

    boolean isDrawnByGpu() {
        boolean isDrawn = nativeIsDrawnByGpu(mNative);
        Reference.reachabilityFence(this);
        return isDrawn;
    }

    String describeDrawing() {
        String description = nativeDescribeDrawing(mNative);
        Reference.reachabilityFence(this);
        return description;
    }

    void redraw() {
        nativeRedraw(mNative);
        Reference.reachabilityFence(this);
    }

    void hold(boolean held) {
        nativeHold(mNative, held);
        Reference.reachabilityFence(this);
    }

    /** A frame that was drawn by software shows. */
    void reportFrame(long timeNs) {
        nativeReportFrame(mNative, timeNs / 1000);
        Reference.reachabilityFence(this);
    }

    /** Waits until nobody draws on the window any more. */
    void close() {
        nativeClose(mNative);
        Reference.reachabilityFence(this);
    }

    /** The media time of the next frame in nanoseconds; -1 when none came in time. */
    long awaitFrame(int timeoutMillis) {
        long[] frame = new long[2];
        nativeAwaitFrame(mNative, mSeen, timeoutMillis, frame);
        Reference.reachabilityFence(this);
        if (frame[0] == 0) {
            return -1;
        }
        mSeen = frame[0];
        return frame[1] * 1000;
    }

    private static native long nativeWindowOf(Component component);

    private static native long nativeCreate(long id, boolean acceptsSoftwareGl);

    private static native void nativeDestroy(long window);

    private static native Surface nativeCreateSurface(long window, Surface buffers);

    private static native void nativeRedraw(long window);

    private static native void nativeHold(long window, boolean held);

    private static native void nativeReportFrame(long window, long timeUs);

    private static native void nativeClose(long window);

    private static native boolean nativeIsDrawnByGpu(long window);

    private static native String nativeDescribeDrawing(long window);

    private static native void nativeAwaitFrame(
            long window, long seen, int timeoutMs, long[] frame);
}
