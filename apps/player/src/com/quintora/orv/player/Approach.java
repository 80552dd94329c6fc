// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.VideoTrack;

/** The way from the key frame, at which a seek ends, to the moment that was asked for. */
final class Approach {
    // The fastest at which no frame is left out.
    private static final double SPEED = 16;
    private static final int ROUNDING_MS = 1;

    private Approach() {}

    /**
     * Goes on to the frame of that moment, or to the last one. The speed is the normal one
     * afterwards.
     */
    static void to(OrvMediaPlayer player, int millis) {
        double framesPerSecond =
                player.tracks().currentVideo().map(VideoTrack::frameRate).orElse(0.0);
        double last = millis + ROUNDING_MS - 1000 / framesPerSecond;
        if (framesPerSecond == 0 || player.getCurrentPosition() > last) {
            return;
        }
        player.trickPlay().setSpeed(SPEED);
        try {
            stepTo(player, millis, last);
        } catch (IllegalStateException e) {
            // The last frame may be nearer than the duration says: the player stands there.
        } finally {
            player.trickPlay().setSpeed(1);
        }
    }

    // One by one: some media have fewer frames than their rate says.
    private static void stepTo(OrvMediaPlayer player, int millis, double last) {
        while (player.getCurrentPosition() <= last) {
            player.trickPlay().step(1);
        }
        if (player.getCurrentPosition() > millis + ROUNDING_MS) {
            player.trickPlay().step(-1);
        }
    }
}
