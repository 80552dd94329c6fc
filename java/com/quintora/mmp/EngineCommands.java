// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.os.Parcel;
import java.util.Objects;
import java.util.Set;

/**
 * Calls whose meaning is the engine's and the platform's. Some of them lead nowhere on a given
 * native half; each says how that shows. Thread-safe; all methods throw {@link
 * IllegalStateException} after release.
 */
public final class EngineCommands {
    private final OrvMediaPlayer player;

    EngineCommands(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * Says what the player is for on the screen.
     *
     * @param role the role
     */
    public void setRole(PlayerRole role) {
        player.states.requireAlive("setRole()");
        player.native_setPlayerRole(role.ordinal());
    }

    /**
     * Changes the handling of transport streams.
     *
     * @param setting the engine's number, 0 to 65535
     * @return false when the engine knows no such setting
     * @throws IllegalArgumentException for a number out of range
     */
    public boolean setTransportStream(int setting) {
        player.states.requireAlive("setTransportStream()");
        if (setting < 0 || setting > 0xFFFF) {
            throw new IllegalArgumentException("the setting is 0 to 65535: " + setting);
        }
        return player.native_setTS(setting);
    }

    /**
     * Unlocks media that parents locked.
     *
     * @param pin the number to unlock with
     * @return false when it is not the right one, or the engine knows no lock
     */
    public boolean unlock(int pin) {
        player.states.requireAlive("unlock()");
        return player.native_setUnLockPin(pin) == 0;
    }

    /**
     * Sends a line to the decoder's command interpreter.
     *
     * @param command the line
     * @param argument the interpreter's number
     * @return true when it was accepted
     */
    public boolean sendCommand(String command, int argument) {
        player.states.requireAlive("sendCommand()");
        return player.native_QTVDECSendCliCommand(
                Objects.requireNonNull(command, "command"), argument) == 0;
    }

    /**
     * Sends the engine a request.
     *
     * @param request what is asked
     * @param reply where the answer goes; stays empty where requests lead nowhere
     * @return 0, or a negative status
     */
    public int invoke(Parcel request, Parcel reply) {
        player.states.requireAlive("invoke()");
        return player.native_invoke(request, reply);
    }

    /**
     * Sets a parameter of the engine.
     *
     * @param key the engine's number of it
     * @param value its value
     * @return false when the engine has no such parameter, or parameters lead nowhere
     */
    public boolean setParameter(int key, Parcel value) {
        player.states.requireAlive("setParameter()");
        return player.native_setParameter(key, value);
    }

    /**
     * Reads a parameter of the engine.
     *
     * @param key the engine's number of it
     * @param reply where its value goes; stays empty where parameters lead nowhere
     */
    public void getParameter(int key, Parcel reply) {
        player.states.requireAlive("getParameter()");
        player.native_getParameter(key, reply);
    }

    /**
     * Says which kinds of metadata are wanted.
     *
     * @param allow the wanted kinds' codes, 64 at most; 0 among them means every kind
     * @param block the unwanted kinds' codes, the same way
     * @return 0, or a negative status
     */
    public int setMetadataFilter(Set<Integer> allow, Set<Integer> block) {
        player.states.requireAlive("setMetadataFilter()");
        Parcel filter = Parcel.obtain();
        try {
            writeCodes(filter, allow);
            writeCodes(filter, block);
            return player.native_setMetadataFilter(filter);
        } finally {
            filter.recycle();
        }
    }

    /**
     * Reads metadata in the platform's own format.
     *
     * @param updateOnly only what changed since the last time
     * @param applyFilter leave out what the filter blocks
     * @param reply where it goes
     * @return false when there is none, or this way leads nowhere; see {@link Tracks#metadata()}
     */
    public boolean getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply) {
        player.states.requireAlive("getMetadata()");
        return player.native_getMetadata(updateOnly, applyFilter, reply);
    }

    private static void writeCodes(Parcel filter, Set<Integer> codes) {
        filter.writeInt(codes.size());
        codes.forEach(filter::writeInt);
    }
}
