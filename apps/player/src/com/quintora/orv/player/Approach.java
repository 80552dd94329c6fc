// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.VideoTrack;

/** The way from the key frame, at which a seek ends, to the moment that was asked for. */
final class Approach {
    // The fastest at which no frame is left out.
    private static final double SPEED = 16;

    private Approach() {}

    /** How many frames it is from where the player stands; 0 without a picture. */
    static int framesTo(OrvMediaPlayer player, int millis) {
        double framesPerSecond =
                player.tracks().currentVideo().map(VideoTrack::frameRate).orElse(0.0);
        int frames = (int) ((millis - player.getCurrentPosition()) * framesPerSecond / 1000);
        return Math.max(0, frames);
    }

    /** Goes that many frames on, or to the last one. The speed is the normal one afterwards. */
    static void step(OrvMediaPlayer player, int frames) {
        if (frames == 0) {
            return;
        }
        player.trickPlay().setSpeed(SPEED);
        try {
            player.trickPlay().step(frames);
        } catch (IllegalStateException e) {
            // The last frame may be nearer than the duration says: the player stands there.
        } finally {
            player.trickPlay().setSpeed(1);
        }
    }
}
