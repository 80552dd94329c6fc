// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.ArrayDeque;
import java.util.List;
import java.util.Queue;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.atomic.AtomicBoolean;
import java.util.concurrent.atomic.AtomicInteger;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;

class EventQueueTest {
    private final AtomicInteger epoch = new AtomicInteger();
    private final List<String> ran = new CopyOnWriteArrayList<>();

    @Test
    void eventsRunInOrderOneAtATimeOnAPoolOfThreads() throws Exception {
        ExecutorService pool = Executors.newFixedThreadPool(4);
        EventQueue queue = new EventQueue(pool, any -> true);
        AtomicInteger running = new AtomicInteger();
        AtomicBoolean overlapped = new AtomicBoolean();
        for (int i = 0; i < 1000; i++) {
            String name = Integer.toString(i);
            queue.add(0, () -> {
                overlapped.compareAndSet(false, running.incrementAndGet() != 1);
                ran.add(name);
                running.decrementAndGet();
            });
            queue.flush();
        }
        Wait.until("all ran", () -> ran.size() == 1000);
        pool.shutdown();
        assertEquals(IntStream.range(0, 1000).mapToObj(Integer::toString).toList(), ran);
        assertFalse(overlapped.get());
    }

    @Test
    void nothingRunsBeforeTheFlush() {
        EventQueue queue = new EventQueue(Runnable::run, any -> true);
        queue.add(0, () -> ran.add("a"));
        assertEquals(List.of(), ran);
        queue.flush();
        assertEquals(List.of("a"), ran);
    }

    @Test
    void eventsOfAnEndedEpochAreDropped() {
        EventQueue queue = new EventQueue(Runnable::run, e -> e == epoch.get());
        queue.add(0, () -> {
            ran.add("old");
            epoch.set(1);
        });
        queue.add(0, () -> ran.add("stale"));
        queue.add(1, () -> ran.add("new"));
        queue.flush();
        assertEquals(List.of("old", "new"), ran);
    }

    @Test
    void anEventMayAddAndClear() {
        EventQueue queue = new EventQueue(Runnable::run, any -> true);
        queue.add(0, () -> {
            queue.add(0, () -> ran.add("dropped"));
            queue.clear();
            queue.add(0, () -> ran.add("kept"));
            queue.flush();
        });
        queue.flush();
        assertEquals(List.of("kept"), ran);
    }

    @Test
    void clearWaitsForTheEventThatRuns() throws Exception {
        ExecutorService other = Executors.newSingleThreadExecutor();
        EventQueue queue = new EventQueue(other, any -> true);
        CountDownLatch entered = new CountDownLatch(1);
        AtomicBoolean left = new AtomicBoolean();
        queue.add(0, () -> {
            entered.countDown();
            sleep(20);
            left.set(true);
        });
        queue.flush();
        entered.await();
        queue.clear();
        assertTrue(left.get());
        other.shutdown();
    }

    @Test
    void clearDoesNotWaitForEverForAnEventThatWaitsForItsCaller() throws Exception {
        ExecutorService other = Executors.newSingleThreadExecutor();
        EventQueue queue = new EventQueue(other, any -> true);
        CountDownLatch entered = new CountDownLatch(1);
        CountDownLatch cleared = new CountDownLatch(1);
        queue.add(0, () -> {
            entered.countDown();
            awaitUninterrupted(cleared);
            ran.add("went on");
        });
        queue.flush();
        entered.await();
        queue.clear();
        cleared.countDown();
        Wait.until("the event went on", () -> ran.contains("went on"));
        other.shutdown();
    }

    @Test
    void anExecutorThatRefusesLosesTheEventsAndNothingElse() {
        AtomicBoolean refuses = new AtomicBoolean(true);
        Queue<Runnable> accepted = new ArrayDeque<>();
        EventQueue queue = new EventQueue(task -> {
            if (refuses.get()) {
                throw new RejectedExecutionException();
            }
            accepted.add(task);
        }, any -> true);
        queue.add(0, () -> ran.add("lost"));
        queue.flush();
        refuses.set(false);
        queue.add(0, () -> ran.add("next"));
        queue.flush();
        accepted.remove().run();
        assertEquals(List.of("next"), ran);
    }

    @Test
    void anExecutorThatFailsLosesTheEventsAndIsReported() {
        List<Throwable> uncaught = new CopyOnWriteArrayList<>();
        Thread.currentThread().setUncaughtExceptionHandler((thread, e) -> uncaught.add(e));
        RuntimeException idle = new IllegalStateException("the toolkit does not run");
        AtomicBoolean fails = new AtomicBoolean(true);
        EventQueue queue = new EventQueue(task -> {
            if (fails.get()) {
                throw idle;
            }
            task.run();
        }, any -> true);
        queue.add(0, () -> ran.add("lost"));
        queue.flush();
        fails.set(false);
        queue.add(0, () -> ran.add("next"));
        queue.flush();
        Thread.currentThread().setUncaughtExceptionHandler(null);
        assertEquals(List.of("next"), ran);
        assertEquals(List.of(idle), uncaught);
    }

    private static void sleep(long millis) {
        try {
            Thread.sleep(millis);
        } catch (InterruptedException e) {
            throw new AssertionError(e);
        }
    }

    private static void awaitUninterrupted(CountDownLatch latch) {
        try {
            latch.await();
        } catch (InterruptedException e) {
            throw new AssertionError(e);
        }
    }
}
