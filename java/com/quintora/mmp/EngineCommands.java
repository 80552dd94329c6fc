// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.os.Parcel;
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
     * @throws IllegalArgumentException when it is null
     */
    public void setRole(PlayerRole role) {
        player.run("setRole()",
                () -> player.native_setPlayerRole(Arguments.require(role, "the role").ordinal()));
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
        return player.ask("setTransportStream()", () -> player.native_setTS(setting));
    }

    /**
     * Unlocks media that parents locked.
     *
     * @param pin the number to unlock with
     * @return false when it is not the right one, or the engine knows no lock
     */
    public boolean unlock(int pin) {
        return player.ask("unlock()", () -> player.native_setUnLockPin(pin) == 0);
    }

    /**
     * Sends a line to the decoder's command interpreter.
     *
     * @param command the line
     * @param argument the interpreter's number
     * @return true when it was accepted
     * @throws IllegalArgumentException when the line is null
     */
    public boolean sendCommand(String command, int argument) {
        return player.ask("sendCommand()", () -> player.native_QTVDECSendCliCommand(
                Arguments.require(command, "the command"), argument) == 0);
    }

    /**
     * Sends the engine a request.
     *
     * @param request what is asked
     * @param reply where the answer goes; stays empty where requests lead nowhere
     * @return 0, or a negative status
     * @throws IllegalArgumentException when one of them is null
     */
    public int invoke(Parcel request, Parcel reply) {
        return player.ask("invoke()", () -> player.native_invoke(
                Arguments.require(request, "the request"), Arguments.require(reply, "the reply")));
    }

    /**
     * Sets a parameter of the engine.
     *
     * @param key the engine's number of it
     * @param value its value
     * @return false when the engine has no such parameter, or parameters lead nowhere
     * @throws IllegalArgumentException when the value is null
     */
    public boolean setParameter(int key, Parcel value) {
        return player.ask("setParameter()",
                () -> player.native_setParameter(key, Arguments.require(value, "the value")));
    }

    /**
     * Reads a parameter of the engine.
     *
     * @param key the engine's number of it
     * @param reply where its value goes; stays empty where parameters lead nowhere
     * @throws IllegalArgumentException when the reply is null
     */
    public void getParameter(int key, Parcel reply) {
        player.run("getParameter()",
                () -> player.native_getParameter(key, Arguments.require(reply, "the reply")));
    }

    /**
     * Says which kinds of metadata are wanted.
     *
     * @param allow the wanted kinds' codes, 64 at most; 0 among them means every kind
     * @param block the unwanted kinds' codes, the same way
     * @return 0, or a negative status
     * @throws IllegalArgumentException when a set or a code is null
     */
    public int setMetadataFilter(Set<Integer> allow, Set<Integer> block) {
        player.states.requireAlive("setMetadataFilter()");
        Parcel filter = Parcel.obtain();
        try {
            writeCodes(filter, Arguments.require(allow, "the set of wanted kinds"));
            writeCodes(filter, Arguments.require(block, "the set of unwanted kinds"));
            return player.ask("setMetadataFilter()",
                    () -> player.native_setMetadataFilter(filter));
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
     * @throws IllegalArgumentException when the reply is null
     */
    public boolean getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply) {
        return player.ask("getMetadata()", () -> player.native_getMetadata(
                updateOnly, applyFilter, Arguments.require(reply, "the reply")));
    }

    private static void writeCodes(Parcel filter, Set<Integer> codes) {
        filter.writeInt(codes.size());
        codes.forEach(code -> filter.writeInt(Arguments.require(code, "a code")));
    }
}
