// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import android.view.SurfaceHolder;

/** Reports each surface that a view gets after its first one. */
final class NewSurfaces implements SurfaceHolder.Callback {
    private final Runnable onNewSurface;
    private boolean isFirst = true;

    NewSurfaces(Runnable onNewSurface) {
        this.onNewSurface = onNewSurface;
    }

    @Override
    public void surfaceCreated(SurfaceHolder holder) {
        if (!isFirst) {
            onNewSurface.run();
        }
        isFirst = false;
    }

    @Override
    public void surfaceChanged(SurfaceHolder holder, int format, int width, int height) {}

    @Override
    public void surfaceDestroyed(SurfaceHolder holder) {
        // The view waits until the player has let go of it.
    }
}
