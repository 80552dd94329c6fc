// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.PlayerState;
import java.time.Duration;
import java.util.EnumSet;
import java.util.Set;
import java.util.concurrent.CompletableFuture;
import org.jetbrains.annotations.Nullable;

/** Opens the media, or fails as ordered. Thread-safe, but for what says otherwise. */
final class FakePreparation {
    private static final Set<PlayerState> CAN_PREPARE =
            EnumSet.of(PlayerState.INITIALIZED, PlayerState.STOPPED);

    private final FakeSession session;
    private final FakeSources sources;
    private @Nullable MediaException nextFailure;
    private @Nullable MediaError nextError;
    private @Nullable CompletableFuture<Void> pending;
    private Duration left = Duration.ZERO;

    FakePreparation(FakeSession session, FakeSources sources) {
        this.session = session;
        this.sources = sources;
    }

    void failNext(MediaError error) {
        nextError = error;
        nextFailure = null;
    }

    void failNext(MediaException failure) {
        nextFailure = failure;
        nextError = null;
    }

    void prepareAndWait() throws MediaException {
        session.guard.run(() -> {
            session.state.require("prepareAndWait()", CAN_PREPARE);
            MediaException failure = takeFailure();
            if (failure != null) {
                session.state.set(PlayerState.ERROR);
                throw failure;
            }
            session.open();
        });
    }

    CompletableFuture<Void> prepareAsync() {
        return session.guard.ask(() -> {
            session.state.require("prepareAsync()", CAN_PREPARE);
            session.state.set(PlayerState.PREPARING);
            CompletableFuture<Void> future = new CompletableFuture<>();
            pending = future;
            left = session.media.openingTime();
            pass(Duration.ZERO);
            return future;
        });
    }

    /** Lets time pass; under the guard. */
    void pass(Duration time) {
        if (!session.state.is(PlayerState.PREPARING)) {
            return;
        }
        left = left.minus(time);
        if (left.compareTo(Duration.ZERO) > 0) {
            return;
        }
        MediaException failure = takeFailure();
        if (failure != null) {
            session.fail("prepareAsync()", failure);
            failPending(failure);
            return;
        }
        session.open();
        CompletableFuture<Void> future = take();
        session.guard.later(() -> future.complete(null));
    }

    /** Ends what is under way with a failure; under the guard. */
    void failPending(MediaException failure) {
        CompletableFuture<Void> future = take();
        if (future != null) {
            session.guard.later(() -> future.completeExceptionally(failure));
        }
    }

    /** Ends what is under way after a reset or release; under the guard. */
    void abort() {
        failPending(FakeFailures.media(sources.name(), MediaError.ABORTED));
    }

    private @Nullable CompletableFuture<Void> take() {
        CompletableFuture<Void> future = pending;
        pending = null;
        return future;
    }

    private @Nullable MediaException takeFailure() {
        MediaException failure = nextError == null
                ? nextFailure
                : FakeFailures.media(sources.name(), nextError);
        nextError = null;
        nextFailure = null;
        return failure;
    }
}
