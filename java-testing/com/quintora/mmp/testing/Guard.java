// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import java.util.Queue;
import java.util.concurrent.ConcurrentLinkedQueue;
import java.util.concurrent.locks.ReentrantLock;

/**
 * Runs the calls of one player one at a time, and what foreign code is to see of them when no lock
 * is held any more. Thread-safe.
 */
final class Guard {
    /** A call with a result and a kind of failure. */
    interface Action<T, E extends Exception> {
        T run() throws E;
    }

    /** A call without a result. */
    interface Command<E extends Exception> {
        void run() throws E;
    }

    private final ReentrantLock lock = new ReentrantLock();
    private final Queue<Runnable> later = new ConcurrentLinkedQueue<>();
    private final FakeEvents events;

    Guard(FakeEvents events) {
        this.events = events;
    }

    <T, E extends Exception> T ask(Action<T, E> action) throws E {
        lock.lock();
        try {
            return action.run();
        } finally {
            lock.unlock();
            settle();
        }
    }

    <E extends Exception> void run(Command<E> command) throws E {
        ask(() -> {
            command.run();
            return null;
        });
    }

    /** Completes a future, say, once the events of before were handed over. */
    void later(Runnable action) {
        later.add(action);
    }

    private void settle() {
        if (lock.isHeldByCurrentThread()) {
            return;
        }
        events.flush();
        for (Runnable action = later.poll(); action != null; action = later.poll()) {
            action.run();
        }
    }
}
