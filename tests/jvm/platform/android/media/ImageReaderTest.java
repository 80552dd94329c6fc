// SPDX-License-Identifier: Apache-2.0
package android.media;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.PixelFormat;
import android.os.Handler;
import android.os.HandlerThread;
import android.os.PlatformNatives;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

class ImageReaderTest {
    private static final int NO_INIT = -19;
    private static final long LONG_WAIT_MS = 20_000;

    private final ImageReader reader = ImageReader.newInstance(17, 3, PixelFormat.RGBX_8888, 2);
    private final long player = PlatformNatives.holdProducer(reader.getSurface());

    @AfterEach
    void close() {
        PlatformNatives.dropProducer(player);
        reader.close();
    }

    private void draw(int color, long timestampUs) {
        int[] size = PlatformNatives.defaultSize(player);
        assertEquals(0, PlatformNatives.draw(player, size[0], size[1], color, timestampUs));
    }

    private static int firstPixel(Image image) {
        return image.getPlanes()[0].getBuffer().duplicate().order(ByteOrder.BIG_ENDIAN).getInt(0);
    }

    @Test
    void saysWhatItWasMadeWith() {
        assertEquals(17, reader.getWidth());
        assertEquals(3, reader.getHeight());
        assertEquals(PixelFormat.RGBX_8888, reader.getImageFormat());
        assertEquals(2, reader.getMaxImages());
    }

    @Test
    void anImageIsTheFrameInRedGreenAndBlue() {
        draw(0x00123456, 40_000);
        try (Image image = reader.acquireNextImage()) {
            assertEquals(17, image.getWidth());
            assertEquals(3, image.getHeight());
            assertEquals(PixelFormat.RGBX_8888, image.getFormat());
            assertEquals(40_000_000, image.getTimestamp());
            assertEquals(1, image.getPlanes().length);
            Image.Plane plane = image.getPlanes()[0];
            ByteBuffer pixels = plane.getBuffer();
            assertTrue(pixels.isDirect());
            assertEquals(ByteOrder.nativeOrder(), pixels.order());
            assertEquals(3 * plane.getRowStride(), pixels.remaining());
            int last = 2 * plane.getRowStride() + 16 * plane.getPixelStride();
            assertEquals(0x12, pixels.get(last));
            assertEquals(0x34, pixels.get(last + 1));
            assertEquals(0x56, pixels.get(last + 2));
            assertEquals((byte) 0xff, pixels.get(last + 3));
        }
    }

    @Test
    void theNewestFrameWins() {
        assertNull(reader.acquireLatestImage());
        draw(1, 1);
        draw(2, 2);
        try (Image image = reader.acquireLatestImage()) {
            assertEquals(2000, image.getTimestamp());
        }
        assertNull(reader.acquireNextImage());
    }

    @Test
    void asManyImagesAsWereAskedForAreOpenAtATime() {
        draw(0x010000, 1);
        Image first = reader.acquireLatestImage();
        draw(0x020000, 2);
        Image second = reader.acquireLatestImage();
        draw(0x030000, 3);
        assertEquals(
                "maxImages (2) has already been acquired, call #close before acquiring more.",
                assertThrows(IllegalStateException.class, reader::acquireLatestImage).getMessage());
        assertEquals(0x010000ff, firstPixel(first));
        assertEquals(0x020000ff, firstPixel(second));
        first.close();
        first.close();
        Image third = reader.acquireLatestImage();
        assertEquals(0x030000ff, firstPixel(third));
        assertEquals(0x020000ff, firstPixel(second));
        draw(4, 4);
        assertThrows(IllegalStateException.class, reader::acquireNextImage);
    }

    @Test
    void aClosedImageRefuses() {
        draw(1, 1);
        Image image = reader.acquireLatestImage();
        Image.Plane plane = image.getPlanes()[0];
        image.close();
        assertThrows(IllegalStateException.class, image::getWidth);
        assertThrows(IllegalStateException.class, image::getHeight);
        assertThrows(IllegalStateException.class, image::getFormat);
        assertThrows(IllegalStateException.class, image::getTimestamp);
        assertThrows(IllegalStateException.class, image::getPlanes);
        assertThrows(IllegalStateException.class, plane::getBuffer);
        assertThrows(IllegalStateException.class, plane::getRowStride);
        assertThrows(IllegalStateException.class, plane::getPixelStride);
    }

    @Test
    void aClosedReaderClosesItsImagesAndThePlayerSeesIt() {
        draw(1, 1);
        Image image = reader.acquireLatestImage();
        reader.close();
        reader.close();
        assertThrows(IllegalStateException.class, image::getWidth);
        image.close();
        assertThrows(IllegalStateException.class, reader::acquireLatestImage);
        assertFalse(reader.getSurface().isValid());
        assertEquals(NO_INIT, PlatformNatives.draw(player, 17, 3, 1, 1));
    }

    @Test
    void refusesSizesFormatsAndCountsThatCannotBe() {
        int format = PixelFormat.RGBA_8888;
        ImageReader.newInstance(1, 16384, format, 1).close();
        int[][] refused = {{0, 0, format, 1}, {0, 1, format, 1}, {1, 0, format, 1},
            {16385, 1, format, 1}, {1, 1, 35, 1}, {1, 1, format, 0}};
        for (int[] wanted : refused) {
            assertThrows(IllegalArgumentException.class,
                    () -> ImageReader.newInstance(wanted[0], wanted[1], wanted[2], wanted[3]));
        }
    }

    @Test
    void theListenerRunsOnItsHandlersThread() throws Exception {
        HandlerThread thread = new HandlerThread("images");
        thread.start();
        CompletableFuture<Thread> notified = new CompletableFuture<>();
        CompletableFuture<ImageReader> source = new CompletableFuture<>();
        reader.setOnImageAvailableListener(r -> {
            source.complete(r);
            notified.complete(Thread.currentThread());
        }, new Handler(thread.getLooper()));
        draw(1, 1);
        assertSame(thread, notified.get(LONG_WAIT_MS, TimeUnit.MILLISECONDS));
        assertSame(reader, source.getNow(null));
        assertTrue(thread.quitSafely());
        thread.join(LONG_WAIT_MS);
        assertFalse(thread.isAlive());
    }

    @Test
    void withoutAHandlerTheThreadsLooperTakesTheListener() throws Exception {
        assertThrows(IllegalArgumentException.class,
                () -> reader.setOnImageAvailableListener(r -> { }, null));
        reader.setOnImageAvailableListener(null, null);
        HandlerThread thread = new HandlerThread("images");
        thread.start();
        CompletableFuture<Thread> notified = new CompletableFuture<>();
        CompletableFuture<Void> set = new CompletableFuture<>();
        new Handler(thread.getLooper()).post(() -> {
            reader.setOnImageAvailableListener(
                    r -> notified.complete(Thread.currentThread()), null);
            set.complete(null);
        });
        set.get(LONG_WAIT_MS, TimeUnit.MILLISECONDS);
        draw(1, 1);
        assertSame(thread, notified.get(LONG_WAIT_MS, TimeUnit.MILLISECONDS));
        thread.quit();
    }
}
