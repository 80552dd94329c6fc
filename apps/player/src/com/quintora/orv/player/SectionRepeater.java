// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;

/**
 * Repeats a section. The player takes marks where it stands, so this follows it up to the
 * section's start and end, and marks them in passing.
 */
final class SectionRepeater extends Thread {
    private static final int POLL_MS = 5;

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
            if (section.from() > 0) {
                player.seekTo(section.from());
            }
            await(section.from());
            player.trickPlay().repeatFromHere();
            await(section.to());
            player.trickPlay().repeatUntilHere();
        } catch (InterruptedException | IllegalStateException e) {
            // The player was released meanwhile.
            interrupt();
        }
    }

    private void await(int millis) throws InterruptedException {
        while (player.getCurrentPosition() < millis) {
            sleep(POLL_MS);
        }
    }
}
