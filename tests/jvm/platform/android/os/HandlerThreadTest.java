// SPDX-License-Identifier: Apache-2.0
package android.os;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

class HandlerThreadTest {
    private static final long LONG_WAIT_MS = 20_000;

    private final HandlerThread thread = new HandlerThread("work");
    private final CountDownLatch gate = new CountDownLatch(1);

    @AfterEach
    void quit() throws InterruptedException {
        gate.countDown();
        thread.quit();
        thread.join(LONG_WAIT_MS);
        assertFalse(thread.isAlive());
    }

    private Handler startedHandler() {
        thread.start();
        return new Handler(thread.getLooper());
    }

    private void passGate() {
        try {
            assertTrue(gate.await(LONG_WAIT_MS, TimeUnit.MILLISECONDS));
        } catch (InterruptedException e) {
            throw new AssertionError(e);
        }
    }

    private void awaitEnd() throws InterruptedException {
        thread.join(LONG_WAIT_MS);
        assertFalse(thread.isAlive());
    }

    @Test
    void workIsDoneInOrderOnTheThread() throws InterruptedException {
        Handler handler = startedHandler();
        assertSame(thread, handler.getLooper().getThread());
        assertFalse(handler.getLooper().isCurrentThread());
        List<Object> done = new ArrayList<>();
        assertTrue(handler.post(() -> done.add(Thread.currentThread())));
        assertTrue(handler.post(() -> done.add(Looper.myLooper())));
        assertTrue(handler.post(() -> done.add(handler.getLooper().isCurrentThread())));
        assertTrue(thread.quitSafely());
        awaitEnd();
        assertEquals(List.of(thread, handler.getLooper(), true), done);
    }

    @Test
    void quitDropsWhatWaitsAndQuitSafelyDoesIt() throws InterruptedException {
        Handler handler = startedHandler();
        List<String> done = new ArrayList<>();
        handler.post(this::passGate);
        handler.post(() -> done.add("dropped"));
        assertTrue(thread.quit());
        assertFalse(handler.post(() -> done.add("refused")));
        gate.countDown();
        awaitEnd();
        assertEquals(List.of(), done);
    }

    @Test
    void anInterruptedThreadGoesOnAndTheWorkSeesIt() throws InterruptedException {
        Handler handler = startedHandler();
        thread.interrupt();
        List<Boolean> seen = new ArrayList<>();
        handler.post(() -> seen.add(Thread.interrupted()));
        thread.quitSafely();
        awaitEnd();
        assertEquals(List.of(true), seen);
    }

    @Test
    void aThreadThatDoesNotRunHasNoLooper() throws InterruptedException {
        assertNull(thread.getLooper());
        assertFalse(thread.quit());
        Handler handler = startedHandler();
        assertNotNull(thread.getLooper());
        thread.quit();
        awaitEnd();
        assertNull(thread.getLooper());
        assertFalse(thread.quitSafely());
        assertFalse(handler.post(() -> { }));
    }

    @Test
    void aThreadHasOneLooperAtMost() throws InterruptedException {
        assertNull(Looper.myLooper());
        assertThrows(RuntimeException.class, Looper::loop);
        List<Throwable> thrown = new ArrayList<>();
        startedHandler().post(
                () -> thrown.add(assertThrows(RuntimeException.class, Looper::prepare)));
        thread.quitSafely();
        awaitEnd();
        assertEquals("Only one Looper may be created per thread", thrown.get(0).getMessage());
    }
}
