// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.lang.management.ManagementFactory;
import java.util.Locale;

/** Measures a playback against the clock. */
final class Stopwatch {
    private volatile long startNs;
    private volatile long endNs;
    private volatile int startMs;
    private volatile int endMs;

    void start(int positionMs) {
        startMs = positionMs;
        startNs = System.nanoTime();
    }

    void stop(int positionMs) {
        endNs = System.nanoTime();
        endMs = positionMs;
    }

    String report(FramePump frames) {
        StringBuilder text = new StringBuilder();
        if (frames.count().firstFrameAt() > 0) {
            long started = ManagementFactory.getRuntimeMXBean().getStartTime();
            text.append(
                    String.format(
                            Locale.ROOT,
                            "first frame %.2f s after the JVM's start; ",
                            (frames.count().firstFrameAt() - started) / 1000.0));
        }
        if (endNs > 0) {
            text.append(
                    String.format(
                            Locale.ROOT,
                            "%.2f s of media took %.2f s; ",
                            (endMs - startMs) / 1000.0,
                            (endNs - startNs) / 1e9));
        }
        return text
                + String.format("%d frames shown, %d dropped", frames.count().shown(), frames.count().dropped());
    }
}
