// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;

/**
 * Repeats a section. The player takes marks where it stands, so this follows it up to the
 * section's start and end, and marks them in passing. The player stands before the section.
 */
final class SectionRepeater extends Thread {
    private static final int POLL_MS = 5;

    // At the very end of the media it would be too late for a mark.
    private static final int BEFORE_END_MS = 100;

    private final OrvMediaPlayer player;
    private final Section section;

    SectionRepeater(OrvMediaPlayer player, Section section) {
        super("section");
        setDaemon(true);
        this.player = player;
        this.section = section;
    }

    @Override
    public void run() {
        try {
            await(section.from());
            player.trickPlay().repeatFromHere();
            await(end());
            player.trickPlay().repeatUntilHere();
        } catch (InterruptedException | IllegalStateException e) {
            // The player was released meanwhile.
            interrupt();
        }
    }

    private int end() {
        int duration = player.getDuration();
        double margin = BEFORE_END_MS * Math.max(1, player.trickPlay().getSpeed());
        return duration == 0 ? section.to() : Math.min(section.to(), (int) (duration - margin));
    }

    private void await(int millis) throws InterruptedException {
        while (player.getCurrentPosition() < millis) {
            sleep(POLL_MS);
        }
    }
}
