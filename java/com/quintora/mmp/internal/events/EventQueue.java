// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.base.Uncaught;
import java.lang.ref.WeakReference;
import java.util.ArrayDeque;
import java.util.Queue;
import java.util.concurrent.Executor;
import java.util.concurrent.Future;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.TimeUnit;
import java.util.function.IntPredicate;
import org.jetbrains.annotations.Nullable;

/**
 * Hands events to an executor, in order and one at a time, whatever the executor does: what it
 * rejects or drops is handed over again. Events whose epoch has ended are dropped. Thread-safe; no
 * lock is held while an event runs.
 */
final class EventQueue {
    private static final long CLEAR_WAIT_MS = 100;

    // How long an executor may leave events alone before they are handed over again, at first and
    // at most: an event thread may be busy for a while.
    private static final int FIRST_RETRY_MS = 250;
    private static final int LAST_RETRY_MS = 8000;

    private record Event(int epoch, Runnable action) {}

    private final Executor executor;
    private final IntPredicate isCurrent;
    private final Queue<Event> events = new ArrayDeque<>();
    private boolean handedOver;
    private int retryMillis = FIRST_RETRY_MS;
    private @Nullable Future<?> retry;
    private @Nullable Thread delivering;

    EventQueue(Executor executor, IntPredicate isCurrent) {
        this.executor = executor;
        this.isCurrent = isCurrent;
    }

    /** Queues an event for the next flush. */
    synchronized void add(int epoch, Runnable action) {
        events.add(new Event(epoch, action));
    }

    /** Has the queued events run. The executor may run them at once: hold no lock. */
    void flush() {
        synchronized (this) {
            if (handedOver || delivering != null || events.isEmpty()) {
                return;
            }
            handedOver = true;
            retryLater();
        }
        try {
            executor.execute(this::drain);
        } catch (RejectedExecutionException e) {
            // An executor that is full, or shut down: tried again.
        } catch (RuntimeException | Error e) {
            Uncaught.report(e);
        }
    }

    /**
     * Drops what is queued and waits for an event that is running on another thread, for a limited
     * time: one that takes longer may itself be waiting for the caller.
     */
    synchronized void clear() {
        events.clear();
        begun();
        long end = System.nanoTime() + TimeUnit.MILLISECONDS.toNanos(CLEAR_WAIT_MS);
        long left = end - System.nanoTime();
        while (delivering != null && delivering != Thread.currentThread() && left > 0) {
            try {
                TimeUnit.NANOSECONDS.timedWait(this, left);
            } catch (InterruptedException e) {
                Thread.currentThread().interrupt();
                return;
            }
            left = end - System.nanoTime();
        }
    }

    private void drain() {
        for (Event event = next(null); event != null; event = next(event)) {
            try {
                event.action().run();
            } catch (RuntimeException | Error e) {
                Uncaught.report(e);
            }
        }
    }

    /** The next event to run; null when there is none, or another thread runs them. */
    private synchronized @Nullable Event next(@Nullable Event last) {
        if (last == null) {
            begun();
            if (delivering != null) {
                return null;
            }
        }
        delivering = null;
        notifyAll();
        while (!events.isEmpty()) {
            Event event = events.remove();
            if (isCurrent.test(event.epoch())) {
                delivering = Thread.currentThread();
                return event;
            }
        }
        return null;
    }

    private synchronized void begun() {
        handedOver = false;
        retryMillis = FIRST_RETRY_MS;
        if (retry != null) {
            retry.cancel(false);
            retry = null;
        }
    }

    // Weakly: a player that nobody holds must not stay for an executor that is gone.
    private void retryLater() {
        WeakReference<EventQueue> queue = new WeakReference<>(this);
        retry = PlayerThreads.later(() -> PlayerThreads.run(() -> retry(queue)), retryMillis);
        retryMillis = Math.min(2 * retryMillis, LAST_RETRY_MS);
    }

    private static void retry(WeakReference<EventQueue> reference) {
        EventQueue queue = reference.get();
        if (queue != null) {
            queue.takeBack();
            queue.flush();
        }
    }

    private synchronized void takeBack() {
        handedOver = false;
        events.removeIf(event -> !isCurrent.test(event.epoch()));
    }
}
