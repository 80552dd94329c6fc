// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.failure.Failures;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.atomic.AtomicReference;
import org.jetbrains.annotations.Nullable;

/**
 * The future of an asynchronous prepare that has not ended. It is completed on a thread that holds
 * no lock, as code of the program follows it. Thread-safe.
 */
final class PendingPrepare {
    private record Waiting(int epoch, String source, CompletableFuture<Void> future) {}

    private final AtomicReference<@Nullable Waiting> waiting = new AtomicReference<>();

    CompletableFuture<Void> begin(int epoch, String source) {
        CompletableFuture<Void> future = new CompletableFuture<>();
        waiting.set(new Waiting(epoch, source, future));
        return future;
    }

    void succeeded(int epoch) {
        Waiting mine = take(epoch);
        if (mine != null) {
            PlayerThreads.run(() -> mine.future().complete(null));
        }
    }

    void failed(int epoch, MediaException error) {
        Waiting mine = take(epoch);
        if (mine != null) {
            PlayerThreads.run(() -> mine.future().completeExceptionally(error));
        }
    }

    void abort() {
        Waiting mine = waiting.getAndSet(null);
        if (mine != null) {
            MediaException error = Failures.aborted(mine.source(), null);
            PlayerThreads.run(() -> mine.future().completeExceptionally(error));
        }
    }

    private @Nullable Waiting take(int epoch) {
        Waiting present = waiting.get();
        boolean isMine = present != null && present.epoch() == epoch
                && waiting.compareAndSet(present, null);
        return isMine ? present : null;
    }
}
