// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.ArrayDeque;
import java.util.Queue;
import java.util.concurrent.Executor;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.TimeUnit;
import java.util.function.IntPredicate;

/**
 * Hands events to an executor, in order and one at a time, whatever the executor does. Events whose
 * epoch has ended are dropped. Thread-safe; no lock is held while an event runs.
 */
final class EventQueue {
    private static final long CLEAR_WAIT_MS = 100;

    private record Event(int epoch, Runnable action) {}

    private final Executor executor;
    private final IntPredicate isCurrent;
    private final Queue<Event> events = new ArrayDeque<>();
    private boolean drainPending;
    private Thread delivering;

    EventQueue(Executor executor, IntPredicate isCurrent) {
        this.executor = executor;
        this.isCurrent = isCurrent;
    }

    /** Queues an event for the next flush. */
    synchronized void add(int epoch, Runnable action) {
        events.add(new Event(epoch, action));
    }

    /**
     * Has the queued events run; they are lost when the executor throws. It may run them at once:
     * hold no lock.
     */
    void flush() {
        synchronized (this) {
            if (drainPending || events.isEmpty()) {
                return;
            }
            drainPending = true;
        }
        try {
            executor.execute(this::drain);
        } catch (RejectedExecutionException e) {
            dropAll();
        } catch (RuntimeException | Error e) {
            dropAll();
            uncaught(e);
        }
    }

    /**
     * Drops what is queued and waits for an event that is running on another thread, for a limited
     * time: one that takes longer may itself be waiting for the caller.
     */
    synchronized void clear() {
        events.clear();
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

    /** What foreign code threw where it disturbs nothing else. */
    static void uncaught(Throwable thrown) {
        Thread thread = Thread.currentThread();
        try {
            thread.getUncaughtExceptionHandler().uncaughtException(thread, thrown);
        } catch (RuntimeException | Error e) {
            // A handler's own failures are ignored, as the virtual machine does.
        }
    }

    private synchronized void dropAll() {
        events.clear();
        drainPending = false;
    }

    private void drain() {
        for (Runnable action = next(); action != null; action = next()) {
            try {
                action.run();
            } finally {
                delivered();
            }
        }
    }

    private synchronized Runnable next() {
        while (!events.isEmpty()) {
            Event event = events.remove();
            if (isCurrent.test(event.epoch())) {
                delivering = Thread.currentThread();
                return event.action();
            }
        }
        drainPending = false;
        return null;
    }

    private synchronized void delivered() {
        delivering = null;
        notifyAll();
    }
}
