// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerState;
import java.util.EnumSet;
import java.util.Set;

/**
 * Plays, pauses and moves a player. While it moves, the media rests and its frames are not shown;
 * whether it shall play afterwards can be said at any time and never waits for the move. Moves
 * block, and wait for one another. Thread-safe.
 */
final class Playhead {
    private static final Set<PlayerState> RESTING =
            EnumSet.of(PlayerState.PREPARED, PlayerState.PAUSED, PlayerState.COMPLETED);

    /** What happens while the frames are hidden. */
    interface Hidden<T> {
        T run() throws Failure;
    }

    private final OrvMediaPlayer player;
    private final FramePump frames;
    private final Object moves = new Object();
    private volatile Approach approach;

    // Both under the lock of this object.
    private boolean moving;
    private boolean playsAfterwards;

    Playhead(OrvMediaPlayer player, FramePump frames) {
        this.player = player;
        this.frames = frames;
    }

    /** Call once the media is prepared. */
    void open() {
        if (player.getVideoWidth() > 0) {
            approach = Approach.of(player);
        }
    }

    synchronized boolean isPlaying() {
        return moving ? playsAfterwards : player.getState() == PlayerState.STARTED;
    }

    synchronized boolean isMoving() {
        return moving;
    }

    synchronized void togglePlaying() {
        boolean play = !isPlaying();
        playsAfterwards = play;
        if (!moving && play) {
            player.start();
        } else if (!moving) {
            player.pause();
        }
    }

    /**
     * Goes to the frame that is shown at that time; media without a picture, and media that plays
     * backward, to where a seek leads.
     *
     * @throws IllegalStateException when the media cannot seek
     */
    void seekTo(int millis) {
        move(
                () -> {
                    if (approach == null || player.trickPlay().getSpeed() < 0) {
                        player.seekToAndWait(millis);
                    } else {
                        approach.to(millis);
                    }
                });
    }

    /**
     * Goes some frames on, or back when negative, and stays there.
     *
     * @throws IllegalStateException when the media has no picture or no such frame
     */
    void step(int count) {
        move(
                () -> {
                    rest();
                    player.trickPlay().stepAndWait(count);
                });
    }

    /** Runs what makes the player draw what is not to be seen; blocks. */
    <T> T keepPicture(Hidden<T> task) throws Failure {
        synchronized (moves) {
            frames.hide(true);
            try {
                return task.run();
            } finally {
                frames.count().expectJump();
                frames.hide(false);
            }
        }
    }

    private synchronized void rest() {
        playsAfterwards = false;
    }

    private void move(Runnable way) {
        synchronized (moves) {
            try {
                begin();
                way.run();
            } finally {
                end();
            }
        }
    }

    private synchronized void begin() {
        playsAfterwards = player.getState() == PlayerState.STARTED;
        moving = true;
        frames.hide(true);
        if (playsAfterwards) {
            player.pause();
        }
    }

    private synchronized void end() {
        moving = false;
        frames.count().expectJump();
        frames.hide(false);
        // Otherwise the media failed, or was released.
        if (playsAfterwards && RESTING.contains(player.getState())) {
            player.start();
        }
    }
}
