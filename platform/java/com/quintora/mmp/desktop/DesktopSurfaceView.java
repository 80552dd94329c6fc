// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import android.view.SurfaceView;
import com.quintora.mmp.platform.internal.ViewDrawing;

/**
 * A view that says what draws on it, and that can keep its picture. Its own methods are for any
 * thread, the others for that of AWT's events.
 *
 * @serial exclude
 */
@SuppressWarnings("serial") // Nobody serializes it.
public class DesktopSurfaceView extends SurfaceView {
    private final ViewDrawing mDrawing;

    /** Makes a view that leaves a graphics processor alone which is itself software. */
    public DesktopSurfaceView() {
        this(false);
    }

    /**
     * Makes a view.
     *
     * @param acceptsSoftwareGl whether to draw by OpenGL also where that is software
     */
    public DesktopSurfaceView(boolean acceptsSoftwareGl) {
        this(new ViewDrawing(acceptsSoftwareGl));
    }

    private DesktopSurfaceView(ViewDrawing drawing) {
        super(drawing);
        mDrawing = drawing;
    }

    /**
     * Whether the graphics processor draws now. Does not block.
     *
     * @return false also before a player has the surface
     */
    public boolean isDrawnByGpu() {
        return mDrawing.isByGpu();
    }

    /**
     * What draws. Does not block.
     *
     * @return the name of the graphics processor, or why software draws; empty before a player has
     *         the surface
     */
    public String describeDrawing() {
        return mDrawing.describe();
    }

    /**
     * Waits for the next frame that is drawn, be it one from before drawn anew. For one thread at a
     * time.
     *
     * @param timeoutMillis the longest wait in milliseconds, 0 for none
     * @return its media time in nanoseconds, or -1 when none came in time
     * @throws InterruptedException when the thread is interrupted while the view has no window; a
     *         wait for a window's frame ends with its time
     */
    public long awaitFrame(int timeoutMillis) throws InterruptedException {
        return mDrawing.awaitFrame(timeoutMillis);
    }

    /**
     * Keeps the picture whatever the player draws, or shows the newest again. Does not block.
     *
     * @param held whether the view keeps its picture from now on
     */
    public void hold(boolean held) {
        mDrawing.hold(held);
    }
}
