// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.util.List;
import java.util.Queue;
import java.util.concurrent.ConcurrentLinkedQueue;
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
    void aFlushHandsOverOnceUntilTheExecutorBegins() {
        List<Runnable> tasks = new CopyOnWriteArrayList<>();
        EventQueue queue = new EventQueue(tasks::add, any -> true);
        queue.flush();
        assertEquals(0, tasks.size(), "of nothing");
        queue.add(0, () -> {
            queue.add(0, () -> ran.add("inner"));
            queue.flush();
            ran.add("outer");
        });
        queue.flush();
        queue.flush();
        assertEquals(1, tasks.size());
        tasks.get(0).run();
        assertEquals(List.of("outer", "inner"), ran);
        assertEquals(1, tasks.size(), "an event's own flush");
        queue.clear();
    }

    @Test
    void aFlushWaitsWhileAnotherThreadChangesTheQueue() throws Exception {
        AtomicInteger handedOver = new AtomicInteger();
        EventQueue queue = new EventQueue(task -> handedOver.incrementAndGet(), any -> true);
        queue.add(0, () -> ran.add("never"));
        Thread flushing = new Thread(queue::flush);
        synchronized (queue) {
            flushing.start();
            Wait.until("it waits or has ended",
                    () -> flushing.getState() == Thread.State.BLOCKED || !flushing.isAlive());
            assertEquals(0, handedOver.get());
        }
        flushing.join();
        assertEquals(1, handedOver.get());
        queue.clear();
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
        Thread clearing = Thread.currentThread();
        queue.add(0, () -> {
            entered.countDown();
            while (clearing.getState() != Thread.State.TIMED_WAITING) {
                Thread.onSpinWait();
            }
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
    void whatAnExecutorRejectsIsDeliveredOnceItAccepts() throws Exception {
        AtomicBoolean rejects = new AtomicBoolean(true);
        AtomicInteger rejections = new AtomicInteger();
        EventQueue queue = new EventQueue(task -> {
            if (rejects.get()) {
                rejections.incrementAndGet();
                throw new RejectedExecutionException();
            }
            task.run();
        }, any -> true);
        queue.add(0, () -> ran.add("first"));
        queue.flush();
        Wait.until("it was handed over again", () -> rejections.get() > 1);
        queue.add(0, () -> ran.add("second"));
        queue.flush();
        rejects.set(false);
        Wait.until("both ran", () -> ran.size() == 2);
        assertEquals(List.of("first", "second"), ran);
    }

    @Test
    void whatAnExecutorDropsIsDeliveredAfterAWhile() throws Exception {
        AtomicInteger handedOver = new AtomicInteger();
        EventQueue queue = new EventQueue(task -> {
            if (handedOver.incrementAndGet() > 2) {
                task.run();
            }
        }, any -> true);
        queue.add(0, () -> ran.add("first"));
        queue.flush();
        queue.add(0, () -> ran.add("second"));
        queue.flush();
        Wait.until("both ran", () -> ran.size() == 2);
        assertEquals(List.of("first", "second"), ran);
    }

    @Test
    void aTaskThatComesLateAfterAllDisturbsNothing() throws Exception {
        Queue<Runnable> late = new ConcurrentLinkedQueue<>();
        EventQueue queue = new EventQueue(late::add, any -> true);
        queue.add(0, () -> ran.add("once"));
        queue.flush();
        Wait.until("it was handed over again", () -> late.size() > 1);
        late.forEach(Runnable::run);
        assertEquals(List.of("once"), ran);
        queue.add(0, () -> ran.add("next"));
        late.clear();
        queue.flush();
        late.forEach(Runnable::run);
        assertEquals(List.of("once", "next"), ran);
    }

    @Test
    void anExecutorThatFailsIsReportedAndLosesNothing() throws Exception {
        List<Throwable> uncaught = new CopyOnWriteArrayList<>();
        Thread.currentThread().setUncaughtExceptionHandler((thread, e) -> uncaught.add(e));
        RuntimeException idle = new IllegalStateException("the toolkit does not run");
        AtomicBoolean fails = new AtomicBoolean(true);
        EventQueue queue = new EventQueue(task -> {
            if (fails.getAndSet(false)) {
                throw idle;
            }
            task.run();
        }, any -> true);
        queue.add(0, () -> ran.add("kept"));
        queue.flush();
        Thread.currentThread().setUncaughtExceptionHandler(null);
        Wait.until("it ran", () -> ran.contains("kept"));
        assertEquals(List.of(idle), uncaught);
    }

    @Test
    void nothingOfAnEndedEpochIsHandedOverAgain() throws Exception {
        AtomicInteger handedOver = new AtomicInteger();
        EventQueue queue = new EventQueue(task -> handedOver.incrementAndGet(),
                e -> e == epoch.get());
        queue.add(0, () -> ran.add("stale"));
        queue.flush();
        epoch.set(1);
        queue.clear();
        queue.add(1, () -> ran.add("new"));
        queue.flush();
        Wait.until("the new one was handed over again", () -> handedOver.get() > 2);
        assertEquals(List.of(), ran);
    }

    private static void awaitUninterrupted(CountDownLatch latch) {
        try {
            latch.await();
        } catch (InterruptedException e) {
            throw new AssertionError(e);
        }
    }
}
