// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * Where a player's sound goes and how loud. Thread-safe; every state but RELEASED, in which all
 * methods throw {@link IllegalStateException}. What is set outlasts a reset.
 */
public interface AudioOutput {
    /**
     * Sets how loud the sound is. While it is muted the volume is kept for later.
     *
     * @param left 0 for silence to 1 for as recorded
     * @param right the same, for the right side
     * @throws IllegalArgumentException for a volume out of range
     * @throws IllegalStateException when the engine refuses
     */
    void setVolume(float left, float right);

    /**
     * The volume of the left side; muting does not change it.
     *
     * @return 0 to 1; 1 at first
     */
    float getLeftVolume();

    /**
     * The volume of the right side; muting does not change it.
     *
     * @return 0 to 1; 1 at first
     */
    float getRightVolume();

    /**
     * Silences the sound, or has it at its volume again.
     *
     * @param muted true for silence
     * @throws IllegalStateException when the engine refuses
     */
    void setMuted(boolean muted);

    /**
     * Whether the sound is muted.
     *
     * @return what was last set; false at first
     */
    boolean isMuted();

    /**
     * Chooses the platform's stream that the sound belongs to.
     *
     * @param type the platform's number, such as 3 for music
     */
    void setStreamType(int type);

    /**
     * Chooses the platform's audio session that the sound belongs to.
     *
     * @param id 0 or more
     * @throws IllegalArgumentException when it is negative
     */
    void setSessionId(int id);

    /**
     * The audio session.
     *
     * @return what was last set, 0 at first
     */
    int getSessionId();

    /**
     * Attaches one of the platform's auxiliary effects.
     *
     * @param id the effect's number; 0 for none
     */
    void attachAuxEffect(int id);

    /**
     * Sets how much of the sound goes to the auxiliary effect.
     *
     * @param level 0 to 1
     * @throws IllegalArgumentException for a level out of range
     */
    void setAuxEffectSendLevel(float level);
}
