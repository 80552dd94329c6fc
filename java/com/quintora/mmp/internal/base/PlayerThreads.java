// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import java.util.concurrent.ExecutorService;
import java.util.concurrent.Future;
import java.util.concurrent.LinkedBlockingQueue;
import java.util.concurrent.ScheduledThreadPoolExecutor;
import java.util.concurrent.SynchronousQueue;
import java.util.concurrent.ThreadFactory;
import java.util.concurrent.ThreadPoolExecutor;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicInteger;

/**
 * The threads of the Java side, all of them daemons that start with their first work. What all
 * players share is one thread that knows when something is due, and as many more as have something
 * to do at the same time: what one player waits for holds up no other.
 */
public final class PlayerThreads {
    // Longer than any watcher's rest: while one watches, the threads do not come and go.
    private static final int KEEP_SECONDS = 10;

    private static final ScheduledThreadPoolExecutor CLOCK =
            new ScheduledThreadPoolExecutor(1, named("OrvMediaPlayers-clock-"));
    private static final ThreadPoolExecutor WORKERS = new ThreadPoolExecutor(
            0, Integer.MAX_VALUE, KEEP_SECONDS, TimeUnit.SECONDS, new SynchronousQueue<>(),
            named("OrvMediaPlayers-watch-"));
    private static final ThreadFactory LISTENERS = named("OrvMediaPlayer-");

    static {
        CLOCK.setKeepAliveTime(KEEP_SECONDS, TimeUnit.SECONDS);
        CLOCK.allowCoreThreadTimeOut(true);
        CLOCK.setRemoveOnCancelPolicy(true);
    }

    private PlayerThreads() {}

    /** Runs something on a shared thread, at once. */
    public static void run(Runnable action) {
        WORKERS.execute(action);
    }

    /** Runs something that takes no time, on the thread that everybody waits for. */
    public static Future<?> later(Runnable action, int millis) {
        return CLOCK.schedule(action, millis, TimeUnit.MILLISECONDS);
    }

    /** A thread of one player's own, on which its listeners are called. */
    public static ExecutorService forListeners() {
        return new ThreadPoolExecutor(
                1, 1, 0, TimeUnit.SECONDS, new LinkedBlockingQueue<>(), LISTENERS);
    }

    private static ThreadFactory named(String prefix) {
        AtomicInteger number = new AtomicInteger();
        return work -> {
            Thread thread = new Thread(work, prefix + number.incrementAndGet());
            thread.setDaemon(true);
            return thread;
        };
    }
}
