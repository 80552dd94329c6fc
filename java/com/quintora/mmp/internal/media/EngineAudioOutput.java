// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.AudioOutput;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Commands;

/** Where a player's sound goes and how loud. The native half has no question for the volume. */
public final class EngineAudioOutput implements AudioOutput {
    private final NativePlayer natives;
    private final Commands commands;
    private float left = 1;
    private float right = 1;
    private boolean muted;

    public EngineAudioOutput(NativePlayer natives, Commands commands) {
        this.natives = natives;
        this.commands = commands;
    }

    @Override
    public synchronized void setVolume(float newLeft, float newRight) {
        commands.requireAlive("setVolume()");
        requireGain(newLeft);
        requireGain(newRight);
        if (!muted) {
            commands.run("setVolume()", () -> natives.setVolume(newLeft, newRight));
        }
        left = newLeft;
        right = newRight;
    }

    @Override
    public synchronized float getLeftVolume() {
        commands.requireAlive("getLeftVolume()");
        return left;
    }

    @Override
    public synchronized float getRightVolume() {
        commands.requireAlive("getRightVolume()");
        return right;
    }

    @Override
    public synchronized void setMuted(boolean newMuted) {
        commands.run("setMuted()", () ->
                natives.setVolume(newMuted ? 0 : left, newMuted ? 0 : right));
        muted = newMuted;
    }

    @Override
    public synchronized boolean isMuted() {
        commands.requireAlive("isMuted()");
        return muted;
    }

    @Override
    public void setStreamType(int type) {
        commands.run("setStreamType()", () -> natives.setAudioStreamType(type));
    }

    @Override
    public void setSessionId(int id) {
        commands.requireAlive("setSessionId()");
        if (id < 0) {
            throw new IllegalArgumentException("an audio session's number is not negative: " + id);
        }
        commands.run("setSessionId()", () -> natives.setAudioSessionId(id));
    }

    @Override
    public int getSessionId() {
        return commands.ask("getSessionId()", natives::getAudioSessionId);
    }

    @Override
    public void attachAuxEffect(int id) {
        commands.run("attachAuxEffect()", () -> natives.attachAuxEffect(id));
    }

    @Override
    public void setAuxEffectSendLevel(float level) {
        commands.requireAlive("setAuxEffectSendLevel()");
        requireGain(level);
        commands.run("setAuxEffectSendLevel()", () -> natives.setAuxEffectSendLevel(level));
    }

    private static void requireGain(float gain) {
        if (!(gain >= 0 && gain <= 1)) {
            throw new IllegalArgumentException("a volume is 0 to 1: " + gain);
        }
    }
}
