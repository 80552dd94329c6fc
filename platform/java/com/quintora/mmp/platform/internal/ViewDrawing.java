// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.platform.internal;

import android.view.Surface;
import java.awt.Component;

/**
 * What draws on a view, through all the windows that the view has one after the other. Open and
 * close are for the thread of AWT's events, the rest is for any.
 */
public final class ViewDrawing {
    private final boolean mAcceptsSoftwareGl;
    // The last one; null before the first, and where the desktop's windows cannot be known.
    private volatile ViewWindow mWindow;
    private volatile boolean mHeld;
    private volatile Runnable mOnRelease = () -> {};

    public ViewDrawing(boolean acceptsSoftwareGl) {
        mAcceptsSoftwareGl = acceptsSoftwareGl;
    }

    /** Is run when the view may show its newest picture again. */
    public void setOnRelease(Runnable onRelease) {
        mOnRelease = onRelease;
    }

    /** A surface for the component's new window; who cannot draw on that fills the buffers. */
    public Surface open(Component component, Surface buffers) {
        long id = ViewWindow.idOf(component);
        ViewWindow window = id == 0 ? null : new ViewWindow(id, mAcceptsSoftwareGl);
        mWindow = window;
        if (window == null) {
            return buffers;
        }
        window.hold(mHeld);
        return window.surface(buffers);
    }

    /** Waits until nobody draws on the window any more. */
    public void close() {
        ViewWindow window = mWindow;
        if (window != null) {
            window.close();
        }
    }

    public boolean isByGpu() {
        ViewWindow window = mWindow;
        return window != null && window.isDrawnByGpu();
    }

    public String describe() {
        ViewWindow window = mWindow;
        return window == null ? "" : window.describeDrawing();
    }

    public void redraw() {
        ViewWindow window = mWindow;
        if (window != null) {
            window.redraw();
        }
    }

    /** A frame that was drawn by software shows. */
    public void reportFrame(long timeNs) {
        ViewWindow window = mWindow;
        if (window != null) {
            window.reportFrame(timeNs);
        }
    }

    /** The media time of the next frame in nanoseconds; -1 when none came in time. */
    public long awaitFrame(int timeoutMillis) throws InterruptedException {
        ViewWindow window = mWindow;
        if (window == null) {
            Thread.sleep(timeoutMillis);
            return -1;
        }
        return window.awaitFrame(timeoutMillis);
    }

    public void hold(boolean held) {
        mHeld = held;
        ViewWindow window = mWindow;
        if (window != null) {
            window.hold(held);
        }
        if (!held) {
            mOnRelease.run();
        }
    }

    public boolean isHeld() {
        return mHeld;
    }
}
