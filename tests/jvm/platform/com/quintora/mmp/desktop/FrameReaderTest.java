// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.os.PlatformNatives;
import java.nio.ByteBuffer;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicInteger;
import java.util.concurrent.atomic.AtomicReference;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

class FrameReaderTest {
    private static final int NO_INIT = -19;
    private static final long LONG_WAIT_MS = 20_000;

    private final FrameReader reader = new FrameReader();
    private final long player = PlatformNatives.holdProducer(reader.getSurface());

    @AfterEach
    void close() {
        PlatformNatives.dropProducer(player);
        reader.close();
    }

    private void draw(int width, int height, int color, long timestampUs) {
        assertEquals(0, PlatformNatives.draw(player, width, height, color, timestampUs));
    }

    @Test
    void handsOverAFrameWithItsPixels() {
        draw(17, 3, 0x00123456, 40_000);
        try (VideoFrame frame = reader.acquireLatestFrame()) {
            assertEquals(17, frame.getWidth());
            assertEquals(3, frame.getHeight());
            assertEquals(40_000_000, frame.getTimestamp());
            assertEquals(128, frame.getRowStride());
            ByteBuffer pixels = frame.getPixels();
            assertTrue(pixels.isDirect() && pixels.isReadOnly());
            assertEquals(3 * 128, pixels.remaining());
            assertEquals(0x56, pixels.get(2 * 128));
            assertEquals(0x34, pixels.get(2 * 128 + 1));
            assertEquals(0x12, pixels.get(2 * 128 + 2));
            assertEquals(0x00123456, pixels.getInt(2 * 128 + 16 * 4));
        }
    }

    @Test
    void theNewestFrameWinsAndTheOthersAreCounted() {
        assertNull(reader.acquireLatestFrame());
        for (int i = 1; i <= 5; i++) {
            draw(8, 8, i, i);
        }
        try (VideoFrame frame = reader.acquireLatestFrame()) {
            assertEquals(5, frame.getPixels().getInt(0));
        }
        assertNull(reader.acquireLatestFrame());
        assertEquals(5, reader.getFrameCount());
        assertEquals(4, reader.getDroppedFrameCount());
    }

    @Test
    void oneFrameAtATime() {
        draw(8, 8, 1, 1);
        VideoFrame first = reader.acquireLatestFrame();
        draw(8, 8, 2, 2);
        assertThrows(IllegalStateException.class, reader::acquireLatestFrame);
        first.close();
        first.close();
        try (VideoFrame second = reader.acquireLatestFrame()) {
            assertEquals(2000, second.getTimestamp());
        }
    }

    @Test
    void aClosedFrameRefusesButItsBufferStaysReadable() {
        draw(64, 64, 1, 1);
        VideoFrame frame = reader.acquireLatestFrame();
        ByteBuffer pixels = frame.getPixels();
        frame.close();
        assertThrows(IllegalStateException.class, frame::getWidth);
        assertThrows(IllegalStateException.class, frame::getHeight);
        assertThrows(IllegalStateException.class, frame::getTimestamp);
        assertThrows(IllegalStateException.class, frame::getRowStride);
        assertThrows(IllegalStateException.class, frame::getPixels);
        for (int size = 2000; size > 1; size /= 4) {
            draw(size, size, 7, 7);
        }
        reader.close();
        System.gc();
        assertEquals(64 * 64 * 4, pixels.duplicate().get(new byte[64 * 64 * 4]).position());
    }

    @Test
    void thePlayerSeesTheWantedSize() {
        assertArrayEquals(new int[] {0, 0}, PlatformNatives.defaultSize(player));
        reader.setFrameSize(320, 180);
        assertArrayEquals(new int[] {320, 180}, PlatformNatives.defaultSize(player));
        assertThrows(IllegalArgumentException.class, () -> reader.setFrameSize(0, 1));
        assertThrows(IllegalArgumentException.class, () -> new FrameReader(-1, -1));
        assertArrayEquals(new int[] {320, 180}, PlatformNatives.defaultSize(player));
    }

    @Test
    void waitingEndsWithAFrame() throws Exception {
        assertNull(reader.awaitFrame(1));
        Thread drawer = new Thread(() -> draw(8, 8, 9, 9));
        drawer.start();
        try (VideoFrame frame = reader.awaitFrame(LONG_WAIT_MS)) {
            assertNotNull(frame);
            assertEquals(9000, frame.getTimestamp());
        }
        drawer.join();
    }

    @Test
    void waitingEndsWithClosing() throws InterruptedException {
        AtomicReference<Throwable> thrown = new AtomicReference<>();
        Thread waiter = new Thread(() -> {
            try {
                reader.awaitFrame(LONG_WAIT_MS);
            } catch (IllegalStateException | InterruptedException e) {
                thrown.set(e);
            }
        });
        waiter.start();
        reader.close();
        waiter.join(LONG_WAIT_MS / 2);
        assertFalse(waiter.isAlive());
        assertEquals(IllegalStateException.class, thrown.get().getClass());
    }

    @Test
    void waitingEndsWithAnInterruption() throws InterruptedException {
        AtomicReference<Throwable> thrown = new AtomicReference<>();
        Thread waiter = new Thread(() -> {
            try {
                reader.awaitFrame(LONG_WAIT_MS);
            } catch (InterruptedException e) {
                thrown.set(e);
            }
        });
        waiter.start();
        waiter.interrupt();
        waiter.join(LONG_WAIT_MS / 2);
        assertFalse(waiter.isAlive());
        assertNotNull(thrown.get());
    }

    @Test
    void theListenerHearsOfFramesUntilItIsReplaced() throws InterruptedException {
        AtomicInteger first = new AtomicInteger();
        CountDownLatch notified = new CountDownLatch(1);
        reader.setOnFrameAvailable(() -> {
            first.incrementAndGet();
            notified.countDown();
        }, null);
        draw(8, 8, 1, 1);
        assertTrue(notified.await(LONG_WAIT_MS, TimeUnit.MILLISECONDS));

        CountDownLatch replacement = new CountDownLatch(1);
        reader.setOnFrameAvailable(replacement::countDown, Runnable::run);
        int before = first.get();
        draw(8, 8, 2, 2);
        assertTrue(replacement.await(LONG_WAIT_MS, TimeUnit.MILLISECONDS));
        assertEquals(before, first.get());
    }

    @Test
    void aClosedReaderTakesNothingAndThePlayerSeesIt() {
        draw(8, 8, 1, 1);
        VideoFrame frame = reader.acquireLatestFrame();
        reader.close();
        reader.close();
        assertEquals(8, frame.getWidth());
        assertFalse(reader.getSurface().isValid());
        assertEquals(NO_INIT, PlatformNatives.draw(player, 8, 8, 1, 1));
        assertThrows(IllegalStateException.class, reader::acquireLatestFrame);
        frame.close();
    }
}
