// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.AudioOutput;

/** Remembers how loud the sound is and where it goes. */
final class FakeAudioOutput implements AudioOutput {
    private final Guard guard;
    private final FakeState state;
    private float left = 1;
    private float right = 1;
    private boolean muted;
    private int session;

    FakeAudioOutput(Guard guard, FakeState state) {
        this.guard = guard;
        this.state = state;
    }

    @Override
    public void setVolume(float newLeft, float newRight) {
        change("setVolume()", () -> {
            requireGain(newLeft);
            requireGain(newRight);
            left = newLeft;
            right = newRight;
        });
    }

    @Override
    public float getLeftVolume() {
        return ask("getLeftVolume()", () -> left);
    }

    @Override
    public float getRightVolume() {
        return ask("getRightVolume()", () -> right);
    }

    @Override
    public void setMuted(boolean newMuted) {
        change("setMuted()", () -> muted = newMuted);
    }

    @Override
    public boolean isMuted() {
        return ask("isMuted()", () -> muted);
    }

    @Override
    public void setStreamType(int type) {
        change("setStreamType()", () -> {});
    }

    @Override
    public void setSessionId(int id) {
        change("setSessionId()", () -> {
            if (id < 0) {
                throw new IllegalArgumentException(
                        "an audio session's number is not negative: " + id);
            }
            session = id;
        });
    }

    @Override
    public int getSessionId() {
        return ask("getSessionId()", () -> session);
    }

    @Override
    public void attachAuxEffect(int id) {
        change("attachAuxEffect()", () -> {});
    }

    @Override
    public void setAuxEffectSendLevel(float level) {
        change("setAuxEffectSendLevel()", () -> requireGain(level));
    }

    private <T> T ask(String call, Guard.Action<T, RuntimeException> question) {
        return guard.ask(() -> {
            state.requireAlive(call);
            return question.run();
        });
    }

    private void change(String call, Guard.Command<RuntimeException> command) {
        guard.run(() -> {
            state.requireAlive(call);
            command.run();
        });
    }

    private static void requireGain(float gain) {
        if (!(gain >= 0 && gain <= 1)) {
            throw new IllegalArgumentException("a volume is 0 to 1: " + gain);
        }
    }
}
