// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;

/**
 * Speeds, single frames, repeated sections and byte positions of a player. Thread-safe; all methods
 * throw {@link IllegalStateException} after release, and those that change something also before
 * the media is prepared.
 */
public final class TrickPlay {
    /** The lowest speed, forward and backward. */
    public static final double MIN_SPEED = 0.25;

    /** The highest speed, forward and backward. */
    public static final double MAX_SPEED = 32;

    // The engine counts speeds in thousandths.
    private static final int NORMAL_SPEED = 1000;

    private static final int REPEAT_OFF = 0;
    private static final int REPEAT_SET_A = 1;
    private static final int REPEAT_SET_B = 2;

    private final OrvMediaPlayer player;

    TrickPlay(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * Changes the speed of playing.
     *
     * @param speed 1 for normal, {@link #MIN_SPEED} to {@link #MAX_SPEED} in steps of 0.001, or
     *     the negative of that to play backward; neither 0 nor what lies between
     * @throws IllegalArgumentException for a speed that {@link #canPlayAt} denies
     * @throws IllegalStateException before the media is prepared
     */
    public void setSpeed(double speed) {
        requireMedia("setSpeed()");
        if (!canPlayAt(speed)
                || player.ask("setSpeed()",
                        () -> player.native_setPlayMode(thousandths(speed)) != 0)) {
            throw new IllegalArgumentException("this media cannot be played at speed " + speed);
        }
        player.wake();
    }

    /**
     * The speed of playing.
     *
     * @return 1 for normal, negative for backward
     */
    public double getSpeed() {
        return player.ask("getSpeed()", player::native_getPlayMode) / (double) NORMAL_SPEED;
    }

    /**
     * Whether a seek is possible while playing at a speed.
     *
     * @param speed as for {@link #setSpeed}, or 0 for halted
     * @return true if so
     */
    public boolean canSeekAt(double speed) {
        return player.ask("canSeekAt()",
                () -> inRange(speed) && player.native_canDoSeek(thousandths(speed)));
    }

    /**
     * Whether the media can be played at a speed.
     *
     * @param speed as for {@link #setSpeed}
     * @return true if so; false for every speed out of range
     */
    public boolean canPlayAt(double speed) {
        return player.ask("canPlayAt()",
                () -> inRange(speed) && player.native_canDoTrick(thousandths(speed)));
    }

    /**
     * Goes some frames on and halts there. Blocks until the last one is shown, at most 5 seconds
     * for each frame forward and 10 for each back; reset and release end it. The player becomes
     * PAUSED, also when there are fewer frames: it halts at the last one then. Media without a
     * picture play on.
     *
     * @param frames how many; negative for back
     * @throws IllegalStateException when the media have no picture or no such frame
     */
    public void step(int frames) {
        requireMedia("step()");
        player.halt("step()", () -> player.native_step(frames));
    }

    /**
     * Begins the section to repeat at the present position.
     *
     * @return false when the engine cannot
     */
    public boolean repeatFromHere() {
        return repeat("repeatFromHere()", REPEAT_SET_A);
    }

    /**
     * Ends the section to repeat at the present position and repeats it from now on.
     *
     * @return false when no section was begun before this position
     */
    public boolean repeatUntilHere() {
        return repeat("repeatUntilHere()", REPEAT_SET_B);
    }

    /**
     * Repeats no section any more.
     *
     * @return false when the engine cannot
     */
    public boolean repeatOff() {
        return repeat("repeatOff()", REPEAT_OFF);
    }

    /**
     * Where the media is being read.
     *
     * @return bytes from the start; the low 32 bits of it, as an unsigned number
     * @throws IOException when the engine cannot tell
     */
    public long getBytePosition() throws IOException {
        requireMedia("getBytePosition()");
        try {
            return Integer.toUnsignedLong(player.native_getCurrentBytePosition());
        } catch (IllegalStateException e) {
            throw player.refusal("getBytePosition()", e);
        }
    }

    /**
     * Goes to a place in the media's bytes, and blocks until it is shown, for a limited time, as
     * {@link OrvMediaPlayer#seekTo} does.
     *
     * @param position bytes from the start, below 2 GiB: the native half carries no more
     * @throws IllegalArgumentException for a position out of range
     * @throws IllegalStateException when the engine cannot
     */
    public void seekToByte(long position) {
        requireMedia("seekToByte()");
        if (position < 0 || position > Integer.MAX_VALUE) {
            throw new IllegalArgumentException("the byte position is out of range: " + position);
        }
        player.seek("seekToByte(" + position + ")", () -> player.native_seekToPosition(position));
    }

    /**
     * How much of the media is buffered.
     *
     * @return 0 to 100
     */
    public int getBufferedPercent() {
        return player.ask("getBufferedPercent()", player::native_getBufferPercent);
    }

    private boolean repeat(String call, int type) {
        requireMedia(call);
        return player.ask(call, () -> player.native_setABRepeat(type) > 0);
    }

    private void requireMedia(String call) {
        player.states.require(call, StateMachine.WITH_MEDIA);
    }

    private static boolean inRange(double speed) {
        return speed >= -MAX_SPEED && speed <= MAX_SPEED;
    }

    private static int thousandths(double speed) {
        return (int) Math.round(speed * NORMAL_SPEED);
    }
}
