// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import java.util.ArrayDeque;
import java.util.Queue;
import java.util.concurrent.Executor;

/**
 * Runs actions one after the other, in the order in which they came, on threads that others use,
 * too. Thread-safe; no lock is held while an action runs.
 */
public final class Turns implements Executor {
    private final Executor threads;
    private final Queue<Runnable> waiting = new ArrayDeque<>();
    private boolean running;
    private boolean stopped;

    public Turns(Executor threads) {
        this.threads = threads;
    }

    /** Once stopped, nothing runs any more. */
    @Override
    public void execute(Runnable action) {
        synchronized (this) {
            if (stopped) {
                return;
            }
            waiting.add(action);
            if (running) {
                return;
            }
            running = true;
        }
        try {
            threads.execute(this::runAll);
        } catch (RuntimeException | Error e) {
            notRunning(); // What waits runs with the next action.
            throw e;
        }
    }

    /** Drops what waits; what runs goes on. */
    public synchronized void stop() {
        stopped = true;
        waiting.clear();
    }

    private void runAll() {
        for (Runnable action = next(); action != null; action = next()) {
            try {
                action.run();
            } catch (RuntimeException | Error e) {
                Uncaught.report(e);
            }
        }
    }

    private synchronized Runnable next() {
        Runnable action = waiting.poll();
        running = action != null;
        return action;
    }

    private synchronized void notRunning() {
        running = false;
    }
}
