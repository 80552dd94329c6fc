// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.util.List;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.ScheduledExecutorService;
import java.util.concurrent.ThreadFactory;
import java.util.concurrent.TimeUnit;

/**
 * The threads on which the player is called, so that what takes no time never waits for what takes
 * long. Thread-safe; once ended, nothing more is run.
 */
final class Workers {
    private static final int POLL_MS = 80;

    // The longest wait for files at the end.
    private static final int FILES_MS = 10_000;

    private final ExecutorService slow = Executors.newSingleThreadExecutor(threads("player"));
    private final ExecutorService quick = Executors.newSingleThreadExecutor(threads("controls"));
    private final ExecutorService files = Executors.newSingleThreadExecutor(threads("files"));
    private final ScheduledExecutorService poller =
            Executors.newSingleThreadScheduledExecutor(threads("poller"));
    private final CountDownLatch ready = new CountDownLatch(1);

    Workers() {
        quick.execute(this::awaitReady);
    }

    /** Runs what may take long, such as opening and seeking, in turn. */
    void later(Runnable task) {
        execute(slow, task);
    }

    /** Runs what takes no time, in turn, from when there is something to control. */
    void soon(Runnable task) {
        execute(quick, task);
    }

    /** Runs, in turn, what the end waits for, such as writing a file. */
    void completely(Runnable task) {
        execute(files, task);
    }

    /** There is something to control; runs this again and again from now on. */
    void begin(Runnable poll) {
        ready.countDown();
        try {
            poller.scheduleWithFixedDelay(poll, 0, POLL_MS, TimeUnit.MILLISECONDS);
        } catch (RejectedExecutionException e) {
            // The window is closing.
        }
    }

    void endPolling() {
        poller.shutdown();
    }

    void end() {
        List.of(slow, quick, poller).forEach(ExecutorService::shutdownNow);
        files.shutdown();
        try {
            files.awaitTermination(FILES_MS, TimeUnit.MILLISECONDS);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }

    private void awaitReady() {
        try {
            ready.await();
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt(); // The window is closing.
        }
    }

    private static void execute(ExecutorService thread, Runnable task) {
        try {
            thread.execute(task);
        } catch (RejectedExecutionException e) {
            // The window is closing.
        }
    }

    private static ThreadFactory threads(String name) {
        return task -> {
            Thread thread = new Thread(task, name);
            thread.setDaemon(true);
            return thread;
        };
    }
}
