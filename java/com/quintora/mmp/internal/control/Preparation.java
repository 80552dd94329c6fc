// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.EngineCall;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.failure.Failures;
import com.quintora.mmp.internal.source.CurrentSource;
import com.quintora.mmp.internal.source.StreamAdapter;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.CompletableFuture;
import org.jetbrains.annotations.Nullable;

/** Opens media. Thread-safe. */
public final class Preparation {
    private static final Set<PlayerState> CAN_PREPARE =
            EnumSet.of(PlayerState.INITIALIZED, PlayerState.STOPPED);

    private final NativePlayer natives;
    private final Commands commands;
    private final CurrentSource source;
    private final SurfaceBinding surface;

    public Preparation(
            NativePlayer natives, Commands commands, CurrentSource source,
            SurfaceBinding surface) {
        this.natives = natives;
        this.commands = commands;
        this.source = source;
        this.surface = surface;
    }

    public void prepareAndWait() throws IOException {
        int epoch = begin("prepareAndWait()");
        prepareWith(epoch, surface::prepare);
        if (commands.events.prepared(epoch)) {
            commands.watcher.wake();
        }
    }

    public CompletableFuture<Void> prepareAsync() throws IOException {
        int epoch = begin("prepareAsync()");
        CompletableFuture<Void> future = commands.events.awaitPrepared(epoch);
        prepareWith(epoch, natives::prepareAsync);
        commands.watcher.watchPreparing(epoch);
        return future;
    }

    private int begin(String call) {
        return commands.states.enter(call, CAN_PREPARE, PlayerState.PREPARING);
    }

    private void prepareWith(int epoch, EngineCall command) throws IOException {
        String name = source.name();
        StreamAdapter bytes = source.stream();
        try {
            command.run();
        } catch (IOException e) {
            fail(epoch, name, e);
            throw Failures.explain(name, e, bytes.failure());
        } catch (SecurityException e) {
            fail(epoch, name, e);
            throw Failures.denied(name, e);
        } catch (IllegalStateException e) {
            fail(epoch, name, e);
            throw Failures.refused("to prepare", e);
        }
        requireStill(epoch, name, null);
    }

    private void fail(int epoch, String name, Exception thrown) throws MediaException {
        requireStill(epoch, name, thrown);
        commands.states.move(epoch, EnumSet.of(PlayerState.PREPARING), PlayerState.ERROR);
    }

    private void requireStill(int epoch, String name, @Nullable Exception thrown)
            throws MediaException {
        if (!commands.states.isCurrent(epoch)) {
            throw Failures.aborted(name, thrown);
        }
    }
}
