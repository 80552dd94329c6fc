// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.List;
import java.util.Queue;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicInteger;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;

/** The order of actions on threads that others use, too. */
class TurnsTest {
    private final Queue<Runnable> given = new ArrayDeque<>();
    private final List<String> ran = new ArrayList<>();
    private final Turns turns = new Turns(given::add);

    @Test
    void actionsRunInTheirOrder() {
        turns.execute(() -> ran.add("first"));
        turns.execute(() -> ran.add("second"));
        assertEquals(List.of(), ran);
        runWhatWasGiven();
        assertEquals(List.of("first", "second"), ran);
    }

    @Test
    void oneThreadIsAskedForAtATime() {
        turns.execute(() -> turns.execute(() -> ran.add("from inside")));
        turns.execute(() -> ran.add("waiting"));
        assertEquals(1, given.size());
        runWhatWasGiven();
        assertEquals(List.of("waiting", "from inside"), ran);
        turns.execute(() -> ran.add("later"));
        assertEquals(1, given.size());
    }

    @Test
    void severalThreadsRunOneActionAtATime() throws Exception {
        ExecutorService threads = Executors.newFixedThreadPool(4);
        Turns shared = new Turns(threads);
        AtomicInteger inside = new AtomicInteger();
        List<Integer> order = new ArrayList<>(); // Without a lock: only one uses it.
        for (int i = 0; i < 10000; i++) {
            int number = i;
            shared.execute(() -> {
                if (inside.incrementAndGet() == 1) {
                    order.add(number);
                }
                inside.decrementAndGet();
            });
        }
        CountDownLatch last = new CountDownLatch(1);
        shared.execute(last::countDown);
        assertTrue(last.await(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        threads.shutdown();
        assertEquals(IntStream.range(0, 10000).boxed().toList(), order);
    }

    @Test
    void whatThrowsDisturbsNoOther() {
        List<Throwable> caught = new ArrayList<>();
        Thread thread = Thread.currentThread();
        thread.setUncaughtExceptionHandler((t, e) -> caught.add(e));
        IllegalStateException thrown = new IllegalStateException("on purpose");
        turns.execute(() -> {
            throw thrown;
        });
        turns.execute(() -> ran.add("next"));
        runWhatWasGiven();
        thread.setUncaughtExceptionHandler(null);
        assertEquals(List.of(thrown), caught);
        assertEquals(List.of("next"), ran);
    }

    @Test
    void onceStoppedNothingRuns() {
        turns.execute(() -> ran.add("waiting"));
        turns.stop();
        turns.execute(() -> ran.add("late"));
        runWhatWasGiven();
        assertEquals(List.of(), ran);
    }

    @Test
    void whatFoundNoThreadRunsWithTheNextAction() {
        boolean[] refuses = {true};
        Turns other = new Turns(action -> {
            if (refuses[0]) {
                throw new RejectedExecutionException("no thread");
            }
            given.add(action);
        });
        assertThrows(RejectedExecutionException.class, () -> other.execute(() -> ran.add("first")));
        refuses[0] = false;
        other.execute(() -> ran.add("second"));
        runWhatWasGiven();
        assertEquals(List.of("first", "second"), ran);
    }

    private void runWhatWasGiven() {
        for (Runnable action = given.poll(); action != null; action = given.poll()) {
            action.run();
        }
    }
}
