// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.control;

import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.base.Turns;
import java.util.concurrent.Callable;
import java.util.concurrent.CompletableFuture;

/**
 * Runs what must not block its caller, one call after the other, on the threads that all players
 * share. What was asked for in an epoch that has ended meanwhile fails. Thread-safe.
 */
public final class Background {
    private final Commands commands;
    private final Turns turns = new Turns(PlayerThreads::run);

    public Background(Commands commands) {
        this.commands = commands;
    }

    /** Runs a call that is for players with media; the caller's state is checked at once. */
    public <T> CompletableFuture<T> submit(String name, Callable<T> call) {
        return submit(name, commands.requireMedia(name), call);
    }

    /** Runs a call of any state but RELEASED. */
    public <T> CompletableFuture<T> submitAlways(String name, Callable<T> call) {
        commands.requireAlive(name);
        return submit(name, commands.states.epoch(), call);
    }

    private <T> CompletableFuture<T> submit(String name, int epoch, Callable<T> call) {
        CompletableFuture<T> future = new CompletableFuture<>();
        turns.execute(() -> complete(future, commands, name, epoch, call));
        return future;
    }

    /** Completes a future with what a call returns or throws, while that epoch runs. */
    static <T> void complete(
            CompletableFuture<T> future, Commands commands, String name, int epoch,
            Callable<T> call) {
        T result;
        try {
            commands.requireCurrent(name, epoch);
            result = call.call();
        } catch (Exception | Error e) {
            future.completeExceptionally(e);
            return;
        }
        future.complete(result);
    }
}
