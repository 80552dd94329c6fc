// SPDX-License-Identifier: Apache-2.0
package android.view;

/** Holds the surface of a {@link SurfaceView}, which comes and goes with the view's window. */
public interface SurfaceHolder {
    /** Is notified of the surface, on the thread of the window. */
    interface Callback {
        /** There is a surface; a player may draw on it from now on. */
        void surfaceCreated(SurfaceHolder holder);

        /** The surface has a size, in pixels; also called once after it was created. */
        void surfaceChanged(SurfaceHolder holder, int format, int width, int height);

        /**
         * The surface is about to go. Give the player another one or none; one that still draws is
         * made to let go afterwards.
         */
        void surfaceDestroyed(SurfaceHolder holder);
    }

    /** Adds a listener; it hears of a surface that is there already, too, before this returns. */
    void addCallback(Callback callback);

    void removeCallback(Callback callback);

    /** The surface, or null while there is none. */
    Surface getSurface();
}
