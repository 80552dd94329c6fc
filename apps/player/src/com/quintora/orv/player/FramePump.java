// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import android.media.Image;
import android.media.ImageReader;
import java.util.function.Consumer;

/**
 * Takes the frames that the player draws, on a thread of its own, and counts them. Frames that
 * the media has but that never came are seen as gaps between the frames' times.
 */
final class FramePump implements AutoCloseable {
    private static final int WAIT_MS = 100;

    private final ImageReader reader = ImageReader.newInstance(0, 0);
    private final Thread thread = new Thread(this::run, "frames");
    private final Consumer<Image> screen;
    private volatile long framePeriodNs;
    private volatile boolean continuous;
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

    /** The media's frames per second at normal speed; 0 when unknown, and then none is missed. */
    void expect(double framesPerSecond) {
        framePeriodNs = framesPerSecond > 0 ? (long) (1e9 / framesPerSecond) : 0;
    }

    /** The next frame may have any time: after a seek, or at another speed than normal. */
    void expectJump() {
        continuous = false;
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
        long previous = 0;
        try {
            while (!closed) {
                try (Image image = reader.awaitImage(WAIT_MS)) {
                    if (image == null) {
                        continue;
                    }
                    count(previous, image.getTimestamp());
                    previous = image.getTimestamp();
                    screen.accept(image);
                }
            }
        } catch (InterruptedException | IllegalStateException e) {
            // Both mean that the reader was closed while this thread waited.
            Thread.currentThread().interrupt();
        }
    }

    private void count(long previous, long now) {
        if (firstFrameAt == 0) {
            firstFrameAt = System.currentTimeMillis();
        }
        shown = shown + 1;
        long gap = now - previous;
        if (continuous && framePeriodNs > 0 && gap > framePeriodNs * 3 / 2) {
            dropped = dropped + Math.round((double) gap / framePeriodNs) - 1;
        }
        continuous = true;
    }

    @Override
    public void close() {
        closed = true;
        reader.close();
    }
}
