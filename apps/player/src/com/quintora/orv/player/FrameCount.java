// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** Counts the frames that were shown and those that were missed. Thread-safe. */
final class FrameCount {
    private MissedFrames missed = new MissedFrames(0);
    private long droppedBefore;
    private long shown;
    private long firstFrameAt;
    private long newestNs = -1;

    /** How many frames a second shall come; 0 when unknown, and then none is missed. */
    synchronized void expect(double framesPerSecond) {
        droppedBefore = dropped();
        missed = new MissedFrames(framesPerSecond);
    }

    /** The next frame may have any time, as after a seek. */
    synchronized void expectJump() {
        missed.jump();
    }

    /** A frame of that time is shown; the one before is not counted again. */
    synchronized void add(long timeNs) {
        if (firstFrameAt == 0) {
            firstFrameAt = System.currentTimeMillis();
        }
        if (timeNs != newestNs) {
            newestNs = timeNs;
            missed.add(timeNs);
            shown++;
        }
    }

    synchronized long shown() {
        return shown;
    }

    synchronized long dropped() {
        return droppedBefore + missed.count();
    }

    /** When the first frame came, as System.currentTimeMillis; 0 before. */
    synchronized long firstFrameAt() {
        return firstFrameAt;
    }
}
