// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.Rectangle;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.nio.ByteBuffer;
import javax.swing.JPanel;

/** Shows the newest frame, as large as fits with its proportions kept. */
final class VideoPane extends JPanel {
    // The one that is painted and the one that is filled; they change places under the lock.
    private final Object lock = new Object();
    private BufferedImage front;
    private BufferedImage back;

    VideoPane() {
        getAccessibleContext().setAccessibleName("Video");
    }

    /**
     * Shows a frame from now on; may be called on any one thread.
     *
     * @param pixels rows of 32-bit pixels that read 0xXXRRGGBB
     * @param stride bytes from row to row
     */
    void draw(ByteBuffer pixels, int width, int height, int stride) {
        if (back == null || back.getWidth() != width || back.getHeight() != height) {
            back = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        }
        int[] target = ((DataBufferInt) back.getRaster().getDataBuffer()).getData();
        var source = pixels.asIntBuffer();
        for (int y = 0; y < height; y++) {
            source.get(y * (stride / 4), target, y * width, width);
        }
        draw(back);
    }

    /** Shows a still picture, which must not change any more. */
    void draw(BufferedImage picture) {
        synchronized (lock) {
            back = front;
            front = picture;
        }
        repaint();
    }

    @Override
    public Dimension getMinimumSize() {
        return new Dimension(160, 90);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        synchronized (lock) {
            paintFrame((Graphics2D) graphics);
        }
    }

    private void paintFrame(Graphics2D g) {
        g.setColor(Theme.STAGE);
        g.fillRect(0, 0, getWidth(), getHeight());
        if (front == null) {
            return;
        }
        Rectangle place = fit(front.getWidth(), front.getHeight(), getWidth(), getHeight());
        g.setRenderingHint(
                RenderingHints.KEY_INTERPOLATION, RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        g.drawImage(front, place.x, place.y, place.width, place.height, null);
    }

    /** The largest centred place of those proportions in a room. */
    static Rectangle fit(int width, int height, int roomWidth, int roomHeight) {
        double scale = Math.min((double) roomWidth / width, (double) roomHeight / height);
        int w = Math.max(1, (int) Math.round(width * scale));
        int h = Math.max(1, (int) Math.round(height * scale));
        return new Rectangle((roomWidth - w) / 2, (roomHeight - h) / 2, w, h);
    }
}
