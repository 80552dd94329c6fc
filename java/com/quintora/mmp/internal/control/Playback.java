// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.state.StateMachine;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Set;

/** Starts, pauses and stops, and answers how it runs. Thread-safe. */
public final class Playback {
    private static final Set<PlayerState> RUNNING =
            EnumSet.of(PlayerState.STARTED, PlayerState.PAUSED);
    private static final Set<PlayerState> CAN_PAUSE =
            EnumSet.of(PlayerState.STARTED, PlayerState.PAUSED, PlayerState.COMPLETED);
    private static final Set<PlayerState> CAN_STOP =
            EnumSet.of(PlayerState.PREPARED, PlayerState.STARTED, PlayerState.PAUSED,
                    PlayerState.COMPLETED, PlayerState.STOPPED);

    private interface EngineValue {
        int get() throws IOException;
    }

    private final NativePlayer natives;
    private final Commands commands;

    public Playback(NativePlayer natives, Commands commands) {
        this.natives = natives;
        this.commands = commands;
    }

    public void start() {
        Set<PlayerState> media = StateMachine.WITH_MEDIA;
        commands.command("start()", media, media, PlayerState.STARTED, natives::start);
        commands.runsOtherwise();
    }

    public void pause() {
        commands.command("pause()", CAN_PAUSE, RUNNING, PlayerState.PAUSED, natives::pause);
    }

    public void stop() {
        commands.command("stop()", CAN_STOP, CAN_STOP, PlayerState.STOPPED, natives::stop);
    }

    public boolean isPlaying() {
        return commands.ask("isPlaying()",
                () -> commands.states.state() == PlayerState.STARTED && natives.isPlaying());
    }

    public int position() {
        return ofMedia("getCurrentPosition()", natives::getCurrentPosition);
    }

    public int duration() {
        return ofMedia("getDuration()", natives::getDuration);
    }

    public int bufferedPercent() {
        return commands.ask("getBufferedPercent()", natives::getBufferPercent);
    }

    public int videoWidth() {
        return commands.ask("getVideoWidth()", natives::getVideoWidth);
    }

    public int videoHeight() {
        return commands.ask("getVideoHeight()", natives::getVideoHeight);
    }

    public void setLooping(boolean looping) {
        commands.run("setLooping()", () -> natives.setLooping(looping));
    }

    public boolean isLooping() {
        return commands.ask("isLooping()", natives::isLooping);
    }

    /** What the engine says of its media; 0 when there are none. */
    private int ofMedia(String call, EngineValue value) {
        commands.requireAlive(call);
        try {
            return commands.hasMedia() ? value.get() : 0;
        } catch (IOException | IllegalStateException e) {
            return 0; // They failed or went just now, which the next look finds.
        }
    }
}
