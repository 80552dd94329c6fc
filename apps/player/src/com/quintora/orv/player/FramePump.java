// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import android.media.Image;
import android.media.ImageReader;
import java.util.function.Consumer;

/** Takes the frames that the player draws, on a thread of its own, and counts them. */
final class FramePump implements AutoCloseable {
    private static final int WAIT_MS = 100;

    private final ImageReader reader = ImageReader.newInstance(0, 0);
    private final Thread thread = new Thread(this::run, "frames");
    private final Consumer<Image> screen;

    // What the pump's thread is asked to do, and what it reports.
    private volatile double framesPerSecond;
    private volatile boolean jumped;
    private boolean hidden; // Under the lock of this object.
    private volatile long shown;
    private volatile long dropped;
    private volatile long firstFrameAt;
    private volatile boolean closed;

    /** The screen is called with each frame on the pump's thread, and must not keep it. */
    FramePump(Consumer<Image> screen) {
        this.screen = screen;
        thread.setDaemon(true);
    }

    ImageReader reader() {
        return reader;
    }

    void start() {
        thread.start();
    }

    /** How many frames a second shall come; 0 when unknown, and then none is missed. */
    void expect(double framesPerSecond) {
        this.framesPerSecond = framesPerSecond;
        jumped = true;
    }

    /** The next frame may have any time, as after a seek. */
    void expectJump() {
        jumped = true;
    }

    /** Of the frames that come meanwhile only the last is shown, afterwards. */
    synchronized void hide(boolean hide) {
        hidden = hide;
        notifyAll();
    }

    long shown() {
        return shown;
    }

    long dropped() {
        return dropped;
    }

    /** When the first frame came, as System.currentTimeMillis; 0 before. */
    long firstFrameAt() {
        return firstFrameAt;
    }

    private void run() {
        try {
            while (!closed) {
                takeFrames(new MissedFrames(framesPerSecond), dropped, framesPerSecond);
            }
        } catch (InterruptedException | IllegalStateException e) {
            // Both mean that the reader was closed while this thread waited.
            Thread.currentThread().interrupt();
        }
    }

    /** Goes on while that many frames a second are expected. */
    private void takeFrames(MissedFrames missed, long droppedBefore, double rate)
            throws InterruptedException {
        while (!closed && rate == framesPerSecond) {
            try (Image image = reader.awaitImage(WAIT_MS)) {
                if (image == null || isOvertaken()) {
                    continue;
                }
                if (firstFrameAt == 0) {
                    firstFrameAt = System.currentTimeMillis();
                }
                if (jumped) {
                    jumped = false;
                    missed.jump();
                }
                missed.add(image.getTimestamp());
                dropped = droppedBefore + missed.count();
                shown = shown + 1;
                screen.accept(image);
            }
        }
    }

    /** Keeps a frame until frames are shown; whether there is a later one then. */
    private synchronized boolean isOvertaken() throws InterruptedException {
        if (!hidden) {
            return false;
        }
        long count = reader.getFrameCount();
        while (hidden && !closed) {
            wait();
        }
        return closed || reader.getFrameCount() > count;
    }

    @Override
    public synchronized void close() {
        closed = true;
        notifyAll();
        reader.close();
    }
}
