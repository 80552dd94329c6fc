// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import android.os.Parcel;
import com.quintora.mmp.EngineCommands;
import com.quintora.mmp.PlayerRole;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Commands;
import java.util.Set;

/** Calls whose meaning is the engine's and the platform's. */
public final class DirectCommands implements EngineCommands {
    private final NativePlayer natives;
    private final Commands commands;

    public DirectCommands(NativePlayer natives, Commands commands) {
        this.natives = natives;
        this.commands = commands;
    }

    @Override
    public void setRole(PlayerRole role) {
        commands.run("setRole()",
                () -> natives.setPlayerRole(Arguments.require(role, "the role").ordinal()));
    }

    @Override
    public boolean setTransportStream(int setting) {
        commands.requireAlive("setTransportStream()");
        if (setting < 0 || setting > 0xFFFF) {
            throw new IllegalArgumentException("the setting is 0 to 65535: " + setting);
        }
        return commands.ask("setTransportStream()", () -> natives.setTS(setting));
    }

    @Override
    public boolean unlock(int pin) {
        return commands.ask("unlock()", () -> natives.setUnLockPin(pin) == 0);
    }

    @Override
    public boolean sendCommand(String command, int argument) {
        return commands.ask("sendCommand()", () -> natives.QTVDECSendCliCommand(
                Arguments.require(command, "the command"), argument) == 0);
    }

    @Override
    public int invoke(Parcel request, Parcel reply) {
        return commands.ask("invoke()", () -> natives.invoke(
                Arguments.require(request, "the request"), Arguments.require(reply, "the reply")));
    }

    @Override
    public boolean setParameter(int key, Parcel value) {
        return commands.ask("setParameter()",
                () -> natives.setParameter(key, Arguments.require(value, "the value")));
    }

    @Override
    public void getParameter(int key, Parcel reply) {
        commands.run("getParameter()",
                () -> natives.getParameter(key, Arguments.require(reply, "the reply")));
    }

    @Override
    public int setMetadataFilter(Set<Integer> allow, Set<Integer> block) {
        commands.requireAlive("setMetadataFilter()");
        Parcel filter = Parcel.obtain();
        try {
            writeCodes(filter, Arguments.require(allow, "the set of wanted kinds"));
            writeCodes(filter, Arguments.require(block, "the set of unwanted kinds"));
            return commands.ask("setMetadataFilter()",
                    () -> natives.setMetadataFilter(filter));
        } finally {
            filter.recycle();
        }
    }

    @Override
    public boolean getMetadata(boolean updateOnly, boolean applyFilter, Parcel reply) {
        return commands.ask("getMetadata()", () -> natives.getMetadata(
                updateOnly, applyFilter, Arguments.require(reply, "the reply")));
    }

    private static void writeCodes(Parcel filter, Set<Integer> codes) {
        filter.writeInt(codes.size());
        codes.forEach(code -> filter.writeInt(Arguments.require(code, "a code")));
    }
}
