// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import java.util.concurrent.CompletableFuture;
import org.jetbrains.annotations.Nullable;

/** Seeks, at once or when the test says so. Thread-safe, but for what says otherwise. */
final class FakeSeeking {
    private record Request(int millis, CompletableFuture<Boolean> future) {}

    private final FakeSession session;
    private boolean held;
    private @Nullable Request running;
    private @Nullable Request waiting;

    FakeSeeking(FakeSession session) {
        this.session = session;
    }

    CompletableFuture<Boolean> seekTo(int millis) {
        requirePosition(millis);
        return session.guard.ask(() -> {
            session.state.requireMedia("seekTo(" + millis + ")");
            Request request = new Request(millis, new CompletableFuture<>());
            if (running == null) {
                running = request;
            } else {
                overtake(waiting);
                waiting = request;
            }
            if (!held) {
                carryOut();
            }
            return request.future();
        });
    }

    void seekToAndWait(int millis) {
        requirePosition(millis);
        session.guard.run(() -> {
            session.state.requireMedia("seekToAndWait(" + millis + ")");
            session.seekTo(millis);
        });
    }

    void setHeld(boolean nowHeld) {
        session.guard.run(() -> {
            held = nowHeld;
            if (!held) {
                carryOut();
            }
        });
    }

    /** Ends what is under way after a reset or release; under the guard. */
    void abort(String how) {
        for (Request request : new Request[] {running, waiting}) {
            if (request != null) {
                IllegalStateException failure = new IllegalStateException(
                        "seekTo(" + request.millis() + ") " + how);
                session.guard.later(() -> request.future().completeExceptionally(failure));
            }
        }
        running = null;
        waiting = null;
    }

    private void carryOut() {
        for (; running != null; running = waiting, waiting = null) {
            Request request = running;
            session.seekTo(request.millis());
            session.guard.later(() -> request.future().complete(true));
        }
    }

    private void overtake(@Nullable Request request) {
        if (request != null) {
            session.guard.later(() -> request.future().complete(false));
        }
    }

    private static void requirePosition(int millis) {
        if (millis < 0) {
            throw new IllegalArgumentException("a position cannot be negative: " + millis);
        }
    }
}
