// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * Where a player's sound goes and how loud. Thread-safe; every state but RELEASED, in which all
 * methods throw {@link IllegalStateException}.
 */
public final class AudioOutput {
    private final OrvMediaPlayer player;

    AudioOutput(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * Sets how loud the sound is.
     *
     * @param left 0 for silence to 1 for as recorded
     * @param right the same, for the right side
     * @throws IllegalArgumentException for a volume out of range
     * @throws IllegalStateException when the engine refuses
     */
    public void setVolume(float left, float right) {
        player.states.requireAlive("setVolume()");
        requireGain(left);
        requireGain(right);
        player.run("setVolume()", () -> player.native_setVolume(left, right));
    }

    /**
     * Says which of the platform's streams the sound belongs to.
     *
     * @param type the platform's number, such as 3 for music
     */
    public void setStreamType(int type) {
        player.run("setStreamType()", () -> player.native_setAudioStreamType(type));
    }

    /**
     * Says which of the platform's audio sessions the sound belongs to.
     *
     * @param id 0 or more
     * @throws IllegalArgumentException when it is negative
     */
    public void setSessionId(int id) {
        player.states.requireAlive("setSessionId()");
        if (id < 0) {
            throw new IllegalArgumentException("an audio session's number is not negative: " + id);
        }
        player.run("setSessionId()", () -> player.native_setAudioSessionId(id));
    }

    /**
     * The audio session.
     *
     * @return what was last set, 0 at first
     */
    public int getSessionId() {
        return player.ask("getSessionId()", player::native_getAudioSessionId);
    }

    /**
     * Attaches one of the platform's auxiliary effects.
     *
     * @param id the effect's number; 0 for none
     */
    public void attachAuxEffect(int id) {
        player.run("attachAuxEffect()", () -> player.native_attachAuxEffect(id));
    }

    /**
     * Sets how much of the sound goes to the auxiliary effect.
     *
     * @param level 0 to 1
     * @throws IllegalArgumentException for a level out of range
     */
    public void setAuxEffectSendLevel(float level) {
        player.states.requireAlive("setAuxEffectSendLevel()");
        requireGain(level);
        player.run("setAuxEffectSendLevel()", () -> player.native_setAuxEffectSendLevel(level));
    }

    private static void requireGain(float gain) {
        if (!(gain >= 0 && gain <= 1)) {
            throw new IllegalArgumentException("a volume is 0 to 1: " + gain);
        }
    }
}
