// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.failure.Failures;
import com.quintora.mmp.internal.source.CurrentSource;
import java.io.IOException;
import java.util.EnumSet;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ExecutorService;

/** Resets and releases a player. Thread-safe. */
public final class Lifetime {
    private final NativePlayer natives;
    private final Commands commands;
    private final CurrentSource source;
    private final SurfaceBinding surface;
    private final ExecutorService listening;
    private final CompletableFuture<Void> released = new CompletableFuture<>();

    public Lifetime(
            NativePlayer natives, Commands commands, CurrentSource source, SurfaceBinding surface,
            ExecutorService listening) {
        this.natives = natives;
        this.commands = commands;
        this.source = source;
        this.surface = surface;
        this.listening = listening;
    }

    public CompletableFuture<Void> reset() {
        int epoch = commands.states.beginReset("reset()");
        CompletableFuture<Void> future = new CompletableFuture<>();
        PlayerThreads.run(() -> {
            try {
                finishReset("reset()", epoch);
                future.complete(null);
            } catch (IOException | RuntimeException | Error e) {
                future.completeExceptionally(e);
            }
        });
        return future;
    }

    public void resetAndWait() throws IOException {
        finishReset("resetAndWait()", commands.states.beginReset("resetAndWait()"));
    }

    private void finishReset(String call, int epoch) throws IOException {
        try {
            natives.reset();
        } catch (IOException e) {
            throw new MediaException(call + " failed", MediaError.UNKNOWN, e);
        } catch (IllegalStateException e) {
            throw commands.refusal(call, e);
        } finally {
            forgetMedia();
        }
        commands.states.move(epoch, EnumSet.of(PlayerState.ERROR), PlayerState.IDLE);
    }

    public CompletableFuture<Void> release() {
        if (begins()) {
            PlayerThreads.run(this::free);
        }
        return released;
    }

    /** Does nothing once a release has begun, also on another thread. */
    public void close() {
        if (!begins()) {
            return;
        }
        Optional<IllegalStateException> refusal = free();
        if (refusal.isPresent()) {
            throw refusal.get();
        }
    }

    private boolean begins() {
        return commands.states.endEpoch(PlayerState.RELEASED) != PlayerState.RELEASED;
    }

    /** Frees everything also when the engine fails, and returns that failure. */
    private Optional<IllegalStateException> free() {
        Optional<IllegalStateException> refusal = Optional.empty();
        try {
            surface.release();
        } catch (IllegalStateException e) {
            refusal = Optional.of(Failures.refused("release()", e));
        } finally {
            forgetMedia();
            commands.events.removeAllListeners();
            commands.watcher.stop();
            listening.shutdown();
        }
        refusal.ifPresentOrElse(released::completeExceptionally, () -> released.complete(null));
        return refusal;
    }

    private void forgetMedia() {
        commands.events.forget();
        source.forget();
    }
}
