// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/**
 * Counts the frames that media have but that never came, by comparing how far the frames' times
 * have come with how many frames there were. A frame's own time may be that of its neighbour, so a
 * gap counts once the next frame confirms it. For one thread.
 */
final class MissedFrames {
    private static final long NONE = Long.MIN_VALUE;

    private final long periodNs;
    private long before;
    private long missed;
    private long previous = NONE;
    private long start = NONE;
    private long frames;
    private long lackingBefore;

    /** Media of so many frames a second at normal speed; 0 for unknown: then none is missed. */
    MissedFrames(double framesPerSecond) {
        periodNs = framesPerSecond > 0 ? (long) (1e9 / framesPerSecond) : 0;
    }

    /** The next frame may have any time. */
    void jump() {
        before += missed;
        missed = 0;
        start = NONE;
        previous = NONE;
    }

    /** A frame of that time has come. */
    void add(long timeNs) {
        if (periodNs == 0) {
            return;
        }
        if (start != NONE && timeNs < start) {
            jump();
        }
        if (start == NONE) {
            begin(timeNs);
            return;
        }
        frames++;
        long lacking = Math.round((double) (timeNs - start) / periodNs) - frames;
        missed = Math.max(missed, Math.min(lacking, lackingBefore));
        lackingBefore = lacking;
    }

    // While the media rests, the same frame may come again and again.
    private void begin(long timeNs) {
        if (previous != NONE && previous != timeNs) {
            start = timeNs;
            frames = 0;
            lackingBefore = 0;
        }
        previous = timeNs;
    }

    long count() {
        return before + missed;
    }
}
