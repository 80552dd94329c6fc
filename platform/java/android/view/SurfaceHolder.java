// SPDX-License-Identifier: Apache-2.0
package android.view;

/**
 * Holds the surface of a {@link SurfaceView}, which comes and goes with the view's window. The
 * surface may be asked for on any thread; callbacks are added and removed on that of AWT's events.
 * Nothing blocks.
 */
public interface SurfaceHolder {
    /** Is notified of the surface, on the thread of AWT's events; a player waits for none of it. */
    interface Callback {
        /**
         * There is a surface; a player may draw on it from now on.
         *
         * @param holder holds it
         */
        void surfaceCreated(SurfaceHolder holder);

        /**
         * The surface has a size; also called once after it was created.
         *
         * @param holder holds it
         * @param format of the pixels: {@link android.graphics.PixelFormat#RGBX_8888}
         * @param width pixels
         * @param height rows
         */
        void surfaceChanged(SurfaceHolder holder, int format, int width, int height);

        /**
         * The surface is about to go. Give the player another one or none; one that still draws is
         * made to let go afterwards.
         *
         * @param holder holds it until this returns
         */
        void surfaceDestroyed(SurfaceHolder holder);
    }

    /**
     * Adds a callback. Is there a surface already, then the callback is notified of it before this
     * returns, on the calling thread.
     *
     * @param callback is notified from now on
     */
    void addCallback(Callback callback);

    /**
     * Removes a callback; one that was not added is ignored.
     *
     * @param callback is not notified any more
     */
    void removeCallback(Callback callback);

    /**
     * The surface.
     *
     * @return null while there is none
     */
    Surface getSurface();
}
