// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import android.view.Surface;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.nio.IntBuffer;

/** Takes the picture that a player shows, at any size, by way of a surface of its own. */
final class FrameGrabber {
    // Of a surface's frames.
    private static final int MAX_SIDE = 16_384;

    private static final int WAIT_MS = 10_000;
    private static final int NANOS_PER_MILLI = 1_000_000;

    private FrameGrabber() {}

    /**
     * Blocks until the player has drawn the picture. Its proportions stay: what the size has more
     * is black.
     *
     * @param back the surface that the player has afterwards, or null for none
     * @throws Failure when none comes
     */
    static Still take(OrvMediaPlayer player, Size size, Surface back) throws Failure {
        if (Math.max(size.width(), size.height()) > MAX_SIDE) {
            throw new Failure("a picture of " + size + " is too large to be drawn");
        }
        try (FrameReader reader = new FrameReader(size.width(), size.height())) {
            try {
                player.setSurface(reader.getSurface());
                return await(reader);
            } finally {
                player.setSurface(back);
            }
        }
    }

    private static Still await(FrameReader reader) throws Failure {
        try (VideoFrame frame = reader.awaitFrame(WAIT_MS)) {
            if (frame == null) {
                throw new Failure("no picture came");
            }
            long millis = Math.round((double) frame.getTimestamp() / NANOS_PER_MILLI);
            return new Still(copy(frame), (int) millis);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
            throw new Failure("interrupted", e);
        }
    }

    private static BufferedImage copy(VideoFrame frame) {
        int width = frame.getWidth();
        int height = frame.getHeight();
        var image = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        int[] pixels = ((DataBufferInt) image.getRaster().getDataBuffer()).getData();
        IntBuffer rows = frame.getPixels().asIntBuffer();
        for (int y = 0; y < height; y++) {
            rows.get(y * (frame.getRowStride() / Integer.BYTES), pixels, y * width, width);
        }
        return image;
    }
}
