// SPDX-License-Identifier: Apache-2.0
package android.media;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.os.PlatformNatives;
import java.nio.ByteBuffer;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicReference;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

class ImageReaderTest {
    private static final int NO_INIT = -19;
    private static final long LONG_WAIT_MS = 20_000;

    private final ImageReader reader = ImageReader.newInstance(0, 0);
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
        try (Image image = reader.acquireLatestImage()) {
            assertEquals(17, image.getWidth());
            assertEquals(3, image.getHeight());
            assertEquals(40_000_000, image.getTimestamp());
            Image.Plane plane = image.getPlanes()[0];
            assertEquals(128, plane.getRowStride());
            assertEquals(4, plane.getPixelStride());
            ByteBuffer pixels = plane.getBuffer();
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
        assertNull(reader.acquireLatestImage());
        for (int i = 1; i <= 5; i++) {
            draw(8, 8, i, i);
        }
        try (Image image = reader.acquireLatestImage()) {
            assertEquals(5, image.getPlanes()[0].getBuffer().getInt(0));
        }
        assertNull(reader.acquireLatestImage());
        assertEquals(5, reader.getFrameCount());
        assertEquals(4, reader.getDroppedFrameCount());
    }

    @Test
    void oneImageAtATime() {
        draw(8, 8, 1, 1);
        Image first = reader.acquireLatestImage();
        draw(8, 8, 2, 2);
        assertThrows(IllegalStateException.class, reader::acquireLatestImage);
        first.close();
        first.close();
        try (Image second = reader.acquireLatestImage()) {
            assertEquals(2000, second.getTimestamp());
        }
    }

    @Test
    void aClosedImageRefusesButItsBufferStaysReadable() {
        draw(64, 64, 1, 1);
        Image image = reader.acquireLatestImage();
        Image.Plane plane = image.getPlanes()[0];
        ByteBuffer pixels = plane.getBuffer();
        image.close();
        assertThrows(IllegalStateException.class, image::getWidth);
        assertThrows(IllegalStateException.class, image::getHeight);
        assertThrows(IllegalStateException.class, image::getTimestamp);
        assertThrows(IllegalStateException.class, image::getPlanes);
        assertThrows(IllegalStateException.class, plane::getBuffer);
        for (int size = 2000; size > 1; size /= 4) {
            draw(size, size, 7, 7);
        }
        reader.close();
        System.gc();
        assertEquals(64 * 64 * 4, pixels.duplicate().get(new byte[64 * 64 * 4]).position());
    }

    @Test
    void thePlayerIsToldTheWantedSize() {
        assertArrayEquals(new int[] {0, 0}, PlatformNatives.defaultSize(player));
        reader.setDefaultSize(320, 180);
        assertArrayEquals(new int[] {320, 180}, PlatformNatives.defaultSize(player));
        assertThrows(IllegalArgumentException.class, () -> reader.setDefaultSize(0, 1));
        assertThrows(IllegalArgumentException.class, () -> ImageReader.newInstance(-1, -1));
        assertArrayEquals(new int[] {320, 180}, PlatformNatives.defaultSize(player));
    }

    @Test
    void waitingEndsWithAFrame() throws Exception {
        assertNull(reader.awaitImage(1));
        Thread drawer = new Thread(() -> draw(8, 8, 9, 9));
        drawer.start();
        try (Image image = reader.awaitImage(LONG_WAIT_MS)) {
            assertNotNull(image);
            assertEquals(9000, image.getTimestamp());
        }
        drawer.join();
    }

    @Test
    void waitingEndsWithClosing() throws InterruptedException {
        AtomicReference<Throwable> thrown = new AtomicReference<>();
        Thread waiter = new Thread(() -> {
            try {
                reader.awaitImage(LONG_WAIT_MS);
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
                reader.awaitImage(LONG_WAIT_MS);
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
        CountDownLatch told = new CountDownLatch(1);
        AtomicReference<ImageReader> source = new AtomicReference<>();
        reader.setOnImageAvailableListener(r -> {
            source.set(r);
            told.countDown();
        }, null);
        draw(8, 8, 1, 1);
        assertTrue(told.await(LONG_WAIT_MS, TimeUnit.MILLISECONDS));
        assertSame(reader, source.get());

        CountDownLatch replacement = new CountDownLatch(1);
        source.set(null);
        reader.setOnImageAvailableListener(r -> replacement.countDown(), Runnable::run);
        draw(8, 8, 2, 2);
        assertTrue(replacement.await(LONG_WAIT_MS, TimeUnit.MILLISECONDS));
        assertNull(source.get());
    }

    @Test
    void aClosedReaderTakesNothingAndTellsThePlayer() {
        draw(8, 8, 1, 1);
        Image image = reader.acquireLatestImage();
        reader.close();
        reader.close();
        assertEquals(8, image.getWidth());
        assertFalse(reader.getSurface().isValid());
        assertEquals(NO_INIT, PlatformNatives.draw(player, 8, 8, 1, 1));
        assertThrows(IllegalStateException.class, reader::acquireLatestImage);
        image.close();
    }
}
