// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.TrickPlay;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Background;
import com.quintora.mmp.internal.control.Commands;
import com.quintora.mmp.internal.control.Seeking;
import java.io.IOException;
import java.util.concurrent.CompletableFuture;

/** Speeds, single frames, repeated sections and byte positions of a player. */
public final class EngineTrickPlay implements TrickPlay {
    // The engine counts speeds in thousandths.
    private static final int NORMAL_SPEED = 1000;

    private static final int REPEAT_OFF = 0;
    private static final int REPEAT_SET_A = 1;
    private static final int REPEAT_SET_B = 2;

    private final NativePlayer natives;
    private final Commands commands;
    private final Seeking seeking;
    private final Background background;

    public EngineTrickPlay(
            NativePlayer natives, Commands commands, Seeking seeking, Background background) {
        this.natives = natives;
        this.commands = commands;
        this.seeking = seeking;
        this.background = background;
    }

    @Override
    public void setSpeed(double speed) {
        commands.requireMedia("setSpeed()");
        if (!canPlayAt(speed)
                || commands.ask("setSpeed()",
                        () -> natives.setPlayMode(thousandths(speed)) != 0)) {
            throw new IllegalArgumentException("this media cannot be played at speed " + speed);
        }
        commands.runsOtherwise();
    }

    @Override
    public double getSpeed() {
        return commands.ask("getSpeed()", natives::getPlayMode) / (double) NORMAL_SPEED;
    }

    @Override
    public boolean canSeekAt(double speed) {
        return commands.ask("canSeekAt()",
                () -> inRange(speed) && natives.canDoSeek(thousandths(speed)));
    }

    @Override
    public boolean canPlayAt(double speed) {
        return commands.ask("canPlayAt()",
                () -> inRange(speed) && natives.canDoTrick(thousandths(speed)));
    }

    @Override
    public CompletableFuture<Void> step(int frames) {
        return background.submit("step()", () -> {
            stepAndWait(frames);
            return null;
        });
    }

    @Override
    public void stepAndWait(int frames) {
        commands.requireMedia("stepAndWait()");
        commands.halt("step()", () -> natives.step(frames));
    }

    @Override
    public boolean repeatFromHere() {
        return repeat("repeatFromHere()", REPEAT_SET_A);
    }

    @Override
    public boolean repeatUntilHere() {
        return repeat("repeatUntilHere()", REPEAT_SET_B);
    }

    @Override
    public boolean repeatOff() {
        return repeat("repeatOff()", REPEAT_OFF);
    }

    @Override
    public long getBytePosition() throws IOException {
        commands.requireMedia("getBytePosition()");
        try {
            return Integer.toUnsignedLong(natives.getCurrentBytePosition());
        } catch (IllegalStateException e) {
            throw commands.refusal("getBytePosition()", e);
        }
    }

    @Override
    public CompletableFuture<Void> seekToByte(long position) {
        commands.requireMedia("seekToByte()");
        requireInRange(position);
        return background.submit("seekToByte()", () -> {
            seekTo("seekToByte(" + position + ")", position);
            return null;
        });
    }

    @Override
    public void seekToByteAndWait(long position) {
        commands.requireMedia("seekToByteAndWait()");
        requireInRange(position);
        seekTo("seekToByteAndWait(" + position + ")", position);
    }

    private void seekTo(String call, long position) {
        seeking.seek(call, () -> natives.seekToPosition(position));
    }

    private boolean repeat(String call, int type) {
        commands.requireMedia(call);
        return commands.ask(call, () -> natives.setABRepeat(type) > 0);
    }

    private static void requireInRange(long position) {
        if (position < 0 || position > Integer.MAX_VALUE) {
            throw new IllegalArgumentException("the byte position is out of range: " + position);
        }
    }

    private static boolean inRange(double speed) {
        return speed >= -MAX_SPEED && speed <= MAX_SPEED;
    }

    private static int thousandths(double speed) {
        return (int) Math.round(speed * NORMAL_SPEED);
    }
}
