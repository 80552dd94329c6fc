// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.os.Parcel;
import java.util.Set;

/**
 * Calls whose meaning is the engine's and the platform's. Some of them lead nowhere on a given
 * native half; each says how that shows. Thread-safe; all methods throw {@link
 * IllegalStateException} after release.
 */
public interface EngineCommands {
    /**
     * Says what the player is for on the screen.
     *
     * @param role the role
     * @throws IllegalArgumentException when it is null
     */
    void setRole(PlayerRole role);

    /**
     * Changes the handling of transport streams.
     *
     * @param setting the engine's number, 0 to 65535
     * @return false when the engine knows no such setting
     * @throws IllegalArgumentException for a number out of range
     */
    boolean setTransportStream(int setting);

    /**
     * Unlocks media that parents locked.
     *
     * @param pin the number to unlock with
     * @return false when it is not the right one, or the engine knows no lock
     */
    boolean unlock(int pin);

    /**
     * Sends a line to the decoder's command interpreter.
     *
     * @param command the line
     * @param argument the interpreter's number
     * @return true when it was accepted
     * @throws IllegalArgumentException when the line is null
     */
    boolean sendCommand(String command, int argument);

    /**
     * Sends the engine a request.
     *
     * @param request what is asked
     * @param reply where the answer goes; stays empty where requests lead nowhere
     * @return 0, or a negative status
     * @throws IllegalArgumentException when one of them is null
     */
    int invoke(Parcel request, Parcel reply);

    /**
     * Sets a parameter of the engine.
     *
     * @param key the engine's number of it
     * @param value its value
     * @return false when the engine has no such parameter, or parameters lead nowhere
     * @throws IllegalArgumentException when the value is null
     */
    boolean setParameter(int key, Parcel value);

    /**
     * Reads a parameter of the engine.
     *
     * @param key the engine's number of it
     * @param reply where its value goes; stays empty where parameters lead nowhere
     * @throws IllegalArgumentException when the reply is null
     */
    void getParameter(int key, Parcel reply);

    /**
     * Says which kinds of metadata are wanted.
     *
     * @param allow the wanted kinds' codes, 64 at most; 0 among them means every kind
     * @param block the unwanted kinds' codes, the same way
     * @return 0, or a negative status
     * @throws IllegalArgumentException when a set or a code is null
     */
    int setMetadataFilter(Set<Integer> allow, Set<Integer> block);

    /**
     * Reads metadata in the platform's own format.
     *
     * @param updateOnly only what changed since the last time
     * @param applyFilter leave out what the filter blocks
     * @param reply where it goes
     * @return false when there is none, or this way leads nowhere; see {@link Tracks#metadata()}
     * @throws IllegalArgumentException when the reply is null
     */
    boolean getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply);
}
