// SPDX-License-Identifier: Apache-2.0
package android.view;

import com.quintora.mmp.platform.internal.PlatformLibrary;
import java.lang.ref.Cleaner;

/**
 * A place to draw video frames on: that of an {@link android.media.ImageReader}, of a
 * {@link SurfaceHolder} or of a {@link com.quintora.mmp.desktop.FrameReader}. All methods may be
 * called from any thread and none blocks.
 */
public class Surface {
    static {
        PlatformLibrary.load();
    }

    private static final Cleaner CLEANER = Cleaner.create();

    /** The address of the native surface, 0 once released. Native code reads it by this name. */
    private long mNativeObject;

    private final Cleaner.Cleanable mCleanable;

    // Without a consumer: a player refuses to draw on it.
    Surface() {
        this(0);
    }

    // Also called from native code, by this signature. The cleaner keeps no hold on the object.
    @SuppressWarnings("this-escape")
    Surface(long producer) {
        long surface = nativeCreate(producer);
        if (surface == 0) {
            throw new OutOfMemoryError("native surface");
        }
        mNativeObject = surface;
        mCleanable = CLEANER.register(this, () -> nativeRelease(surface));
    }

    /**
     * Whether the surface can be given to a player.
     *
     * @return true until {@link #release()}
     */
    public synchronized boolean isValid() {
        return mNativeObject != 0;
    }

    /**
     * Gives up this object's hold on the native surface. A player that draws on it goes on
     * undisturbed; later uses of this object fail. May be called again.
     */
    public void release() {
        synchronized (this) {
            mNativeObject = 0;
        }
        mCleanable.clean();
    }

    private static native long nativeCreate(long producer);

    private static native void nativeRelease(long surface);
}
