// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import android.view.Surface;
import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.util.function.Consumer;

/** Takes the frames that the player draws, on a thread of its own, and counts them. */
final class FramePump implements AutoCloseable {
    private static final int WAIT_MS = 100;

    private final FrameReader reader = new FrameReader();
    private final Thread thread = new Thread(this::run, "frames");
    private final Consumer<VideoFrame> screen;

    private final FrameCount count = new FrameCount();
    private boolean hidden; // Under the lock of this object.
    private volatile DesktopSurfaceView view; // That is drawn on in place of the reader's surface.
    private volatile boolean closed;

    /** The screen is called with each frame on the pump's thread, and must not keep it. */
    FramePump(Consumer<VideoFrame> screen) {
        this.screen = screen;
        thread.setDaemon(true);
    }

    FrameReader reader() {
        return reader;
    }

    void start() {
        thread.start();
    }

    /** Also counts, and hides, the frames that are drawn on that view. */
    void watch(DesktopSurfaceView watched) {
        view = watched;
        Thread watcher = new Thread(() -> countFramesOf(watched), "window frames");
        watcher.setDaemon(true);
        watcher.start();
    }

    /** What the player draws on. */
    Surface surface() {
        return view == null ? reader.getSurface() : view.getHolder().getSurface();
    }

    FrameCount count() {
        return count;
    }

    /** Of the frames that come meanwhile only the last is shown, afterwards. */
    synchronized void hide(boolean hide) {
        hidden = hide;
        notifyAll();
        if (view != null) {
            view.hold(hide);
        }
    }

    private void run() {
        try {
            while (!closed) {
                takeFrame();
            }
        } catch (InterruptedException | IllegalStateException e) {
            // Both mean that the reader was closed while this thread waited.
            Thread.currentThread().interrupt();
        }
    }

    private void takeFrame() throws InterruptedException {
        try (VideoFrame frame = reader.awaitFrame(WAIT_MS)) {
            if (frame != null && !isOvertaken()) {
                count.add(frame.getTimestamp());
                screen.accept(frame);
            }
        }
    }

    private void countFramesOf(DesktopSurfaceView view) {
        try {
            while (!closed) {
                long timeNs = view.awaitFrame(WAIT_MS);
                if (timeNs >= 0) {
                    count.add(timeNs);
                }
            }
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }

    /** Keeps a frame until frames are shown; whether there is a later one then. */
    private synchronized boolean isOvertaken() throws InterruptedException {
        if (!hidden) {
            return false;
        }
        long before = reader.getFrameCount();
        while (hidden && !closed) {
            wait();
        }
        return closed || reader.getFrameCount() > before;
    }

    @Override
    public synchronized void close() {
        closed = true;
        notifyAll();
        reader.close();
    }
}
