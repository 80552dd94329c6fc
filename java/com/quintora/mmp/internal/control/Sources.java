// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.EngineCall;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.SharedFields;
import com.quintora.mmp.internal.failure.Failures;
import com.quintora.mmp.internal.source.CurrentSource;
import com.quintora.mmp.internal.source.StreamAdapter;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Map;
import java.util.Set;

/** Hands the engine what to play. Thread-safe. */
public final class Sources {
    private static final Set<PlayerState> IDLE = EnumSet.of(PlayerState.IDLE);
    private static final String CALL = "setDataSource()";

    private final NativePlayer natives;
    private final SharedFields fields;
    private final Commands commands;
    private final CurrentSource current;

    public Sources(
            NativePlayer natives, SharedFields fields, Commands commands, CurrentSource current) {
        this.natives = natives;
        this.fields = fields;
        this.commands = commands;
        this.current = current;
    }

    public void set(String pathOrUrl) throws IOException {
        initialize(pathOrUrl, () -> natives.setDataSource(required(pathOrUrl)));
    }

    public void set(String url, Map<String, String> headers) throws IOException {
        Arguments.require(headers, "the headers' map").forEach((name, value) -> {
            Arguments.require(name, "a header's name");
            Arguments.require(value, "the value of the header " + name);
        });
        String[] names = headers.keySet().toArray(String[]::new);
        String[] values = headers.values().toArray(String[]::new);
        initialize(url, () -> natives.setDataSource(required(url), names, values));
    }

    public void set(FileDescriptor fd, long offset, long length) throws IOException {
        Arguments.require(fd, "the descriptor");
        initialize("the descriptor", () -> natives.setDataSource(fd, offset, length));
    }

    public void set(MediaStreamSource source) throws IOException {
        StreamAdapter adapter =
                new StreamAdapter(Arguments.require(source, "the stream source"), fields);
        try {
            initialize("the stream source", () -> {
                adapter.describe();
                current.use(adapter);
                natives.setDataSourceByInputStream();
            });
        } catch (IOException | RuntimeException | Error e) {
            current.drop(adapter);
            throw e;
        }
    }

    public void setPcmFormat(PcmMediaInfo format) {
        Arguments.require(format, "the PCM description").check();
        commands.states.require("setPcmFormat()", IDLE);
        commands.run("setPcmFormat()", () -> {
            natives.setPcmMediaInfo(format);
            natives.setPcmFlag();
        });
    }

    private void initialize(String name, EngineCall command) throws IOException {
        commands.states.commands.lock();
        try {
            int epoch = commands.states.require(CALL, IDLE);
            call(name, command);
            current.setName(name);
            if (!commands.states.move(epoch, IDLE, PlayerState.INITIALIZED)) {
                takeBack();
            }
        } finally {
            commands.states.commands.unlock();
        }
    }

    private void call(String name, EngineCall command) throws IOException {
        try {
            command.run();
        } catch (SecurityException e) {
            throw Failures.denied(name, e);
        } catch (MediaException e) {
            throw e;
        } catch (IOException e) {
            throw Failures.explain(name, e, null);
        } catch (IllegalStateException e) {
            throw commands.refusal(CALL, e);
        }
    }

    /** A reset or release came between: the engine must not keep what the player forgot. */
    private void takeBack() {
        current.setName("");
        try {
            natives.reset();
        } catch (IOException | IllegalStateException e) {
            // Released: nothing is kept.
        }
        commands.requireAlive(CALL);
        throw new IllegalStateException(CALL + " was ended by a reset");
    }

    private static String required(String pathOrUrl) {
        return Arguments.require(pathOrUrl, "the path or URL");
    }
}
