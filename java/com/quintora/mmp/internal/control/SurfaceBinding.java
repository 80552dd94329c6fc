// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import android.view.Surface;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.SharedFields;
import java.io.IOException;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.locks.ReentrantLock;
import org.jetbrains.annotations.Nullable;

/**
 * Keeps those calls apart that change or use the surface: the native half counts references to it
 * without a lock of its own. Thread-safe.
 */
public final class SurfaceBinding {
    private static final int RELEASE_WAIT_MS = 100;

    private final NativePlayer natives;
    private final SharedFields fields;
    private final Commands commands;
    private final ReentrantLock lock = new ReentrantLock();

    public SurfaceBinding(NativePlayer natives, SharedFields fields, Commands commands) {
        this.natives = natives;
        this.fields = fields;
        this.commands = commands;
    }

    public void set(@Nullable Surface surface) {
        commands.run("setSurface()", () -> bind(surface));
    }

    private void bind(@Nullable Surface surface) {
        lock.lock();
        try {
            natives.setVideoSurface(surface);
        } catch (IllegalArgumentException e) {
            // The native half gave up the old surface's reference but kept its address, and would
            // give the reference up again next time. The engine holds one of its own.
            fields.forgetSurface();
            throw e;
        } finally {
            lock.unlock();
        }
    }

    void prepare() throws IOException {
        lock.lock();
        try {
            natives.prepare();
        } finally {
            lock.unlock();
        }
    }

    /** Waits while a surface is bound, but not for a prepare that only the release can end. */
    void release() {
        boolean locked = false;
        try {
            locked = lock.tryLock(RELEASE_WAIT_MS, TimeUnit.MILLISECONDS);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
        try {
            natives.release();
        } finally {
            if (locked) {
                lock.unlock();
            }
        }
    }
}
