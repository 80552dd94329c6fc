// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.PixelFormat;
import android.media.Image;
import android.media.ImageReader;
import android.os.Handler;
import android.os.HandlerThread;
import java.nio.ByteBuffer;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.Test;

/** A player that draws for a program as the program would have it drawn on a television. */
class ImagesTest extends PlayerFixture {
    private static final int WIDTH = 320;
    private static final int HEIGHT = 180;

    @Test
    void imagesHaveThePicturesThatAScreenShows() throws Exception {
        prepare("slides.mkv");
        Frame shown;
        try (Screen screen = new Screen()) {
            player.setSurface(screen.surface());
            shown = screen.await("a picture", frame -> frame.width() == WIDTH);
        }
        HandlerThread thread = new HandlerThread("images");
        thread.start();
        try (ImageReader reader =
                ImageReader.newInstance(WIDTH, HEIGHT, PixelFormat.RGBA_8888, 2)) {
            CompletableFuture<ImageReader> available = new CompletableFuture<>();
            reader.setOnImageAvailableListener(
                    available::complete, new Handler(thread.getLooper()));
            player.setSurface(reader.getSurface());
            try (Image image = available.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS)
                    .acquireLatestImage()) {
                assertEquals(WIDTH, image.getWidth());
                assertEquals(HEIGHT, image.getHeight());
                assertTrue(new Frame(WIDTH, HEIGHT, redGreenBlue(image)).psnr(shown) > 40);
            }
        } finally {
            thread.quit();
        }
    }

    private static int[] redGreenBlue(Image image) {
        Image.Plane plane = image.getPlanes()[0];
        ByteBuffer bytes = plane.getBuffer();
        int[] pixels = new int[WIDTH * HEIGHT];
        for (int i = 0; i < pixels.length; i++) {
            int at = i / WIDTH * plane.getRowStride() + i % WIDTH * plane.getPixelStride();
            pixels[i] = (bytes.get(at) & 0xff) << 16 | (bytes.get(at + 1) & 0xff) << 8
                    | bytes.get(at + 2) & 0xff;
        }
        return pixels;
    }
}
