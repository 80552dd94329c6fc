// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.util.concurrent.CompletableFuture;

/**
 * Speeds, single frames, repeated sections and byte positions of a player. Thread-safe; all methods
 * throw {@link IllegalStateException} after release, and those that change something also before
 * the media is prepared.
 */
public interface TrickPlay {
    /** The lowest speed, forward and backward. */
    double MIN_SPEED = 0.25;

    /** The highest speed, forward and backward. */
    double MAX_SPEED = 32;

    /**
     * Changes the speed of playing.
     *
     * @param speed 1 for normal, {@link #MIN_SPEED} to {@link #MAX_SPEED} in steps of 0.001, or
     *     the negative of that to play backward; neither 0 nor what lies between
     * @throws IllegalArgumentException for a speed that {@link #canPlayAt} denies
     * @throws IllegalStateException before the media is prepared
     */
    void setSpeed(double speed);

    /**
     * The speed of playing.
     *
     * @return 1 for normal, negative for backward
     */
    double getSpeed();

    /**
     * Whether a seek is possible while playing at a speed.
     *
     * @param speed as for {@link #setSpeed}, or 0 for halted
     * @return true if so
     */
    boolean canSeekAt(double speed);

    /**
     * Whether the media can be played at a speed.
     *
     * @param speed as for {@link #setSpeed}
     * @return true if so; false for every speed out of range
     */
    boolean canPlayAt(double speed);

    /**
     * Goes some frames on and halts there. Does not block; steps are carried out in the order of
     * their calls. The player becomes PAUSED, also when there are fewer frames: it halts at the
     * last one then. Media without a picture play on.
     *
     * @param frames how many; negative for back
     * @return completed when the last frame is shown; exceptionally with an {@link
     *     IllegalStateException} when the media have no picture or no such frame, or after a reset
     *     or release
     * @throws IllegalStateException before the media is prepared
     */
    CompletableFuture<Void> step(int frames);

    /**
     * Goes some frames on and halts there; as {@link #step}, but blocks until the last one is
     * shown: at most 5 seconds for each frame forward and 10 for each back. Reset and release on
     * another thread end it.
     *
     * @param frames how many; negative for back
     * @throws IllegalStateException before the media is prepared, and when the media have no
     *     picture or no such frame
     */
    void stepAndWait(int frames);

    /**
     * Begins the section to repeat at the present position.
     *
     * @return false when the engine cannot
     */
    boolean repeatFromHere();

    /**
     * Ends the section to repeat at the present position and repeats it from now on.
     *
     * @return false when no section was begun before this position
     */
    boolean repeatUntilHere();

    /**
     * Repeats no section any more.
     *
     * @return false when the engine cannot
     */
    boolean repeatOff();

    /**
     * The place in the media's data that is being read.
     *
     * @return bytes from the start; the low 32 bits of it, as an unsigned number
     * @throws IOException when the engine does not know it
     */
    long getBytePosition() throws IOException;

    /**
     * Goes to a place in the media's data. Does not block; such seeks are carried out in the order
     * of their calls.
     *
     * @param position bytes from the start, below 2 GiB: the native half carries no more
     * @return completed when its picture is shown; exceptionally with an {@link
     *     IllegalStateException} when the engine cannot, or after a reset or release
     * @throws IllegalArgumentException for a position out of range
     * @throws IllegalStateException before the media is prepared
     */
    CompletableFuture<Void> seekToByte(long position);

    /**
     * Goes to a place in the media's data, and blocks until its picture is shown or the engine
     * gives up waiting for it.
     *
     * @param position bytes from the start, below 2 GiB: the native half carries no more
     * @throws IllegalArgumentException for a position out of range
     * @throws IllegalStateException when the engine cannot
     */
    void seekToByteAndWait(long position);
}
