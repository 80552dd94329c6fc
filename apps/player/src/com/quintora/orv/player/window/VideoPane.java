// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.awt.EventQueue;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.Rectangle;
import java.awt.RenderingHints;
import java.awt.geom.AffineTransform;
import java.awt.geom.Rectangle2D;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.nio.ByteBuffer;
import javax.swing.JPanel;

/**
 * Shows the newest frame, as large as fits with its proportions kept. Pixels are the screen's own,
 * of which there are more than the window's where the screen is scaled.
 */
final class VideoPane extends JPanel {
    // The one that is painted and the one that is filled; they change places under the lock.
    private final Object lock = new Object();
    private BufferedImage front;
    private BufferedImage back;

    private final Runnable onRoomChanged;
    private Dimension room = new Dimension();

    /** Calls back when there is more or less room than before, on the window's thread. */
    VideoPane(Runnable onRoomChanged) {
        this.onRoomChanged = onRoomChanged;
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

    /** The pixels that there are for the picture; none before it was painted first. */
    Dimension room() {
        return new Dimension(room);
    }

    /** The pixels of the newest frame; none before there is one. */
    Dimension pictureSize() {
        synchronized (lock) {
            return front == null
                    ? new Dimension()
                    : new Dimension(front.getWidth(), front.getHeight());
        }
    }

    // Only here it is certain on which screen, and how large, the picture shows.
    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = (Graphics2D) graphics.create();
        Rectangle pixels = pixelsOf(g.getTransform());
        g.setTransform(new AffineTransform());
        g.setColor(Theme.STAGE);
        g.fill(pixels);
        synchronized (lock) {
            paintFrame(g, pixels);
        }
        g.dispose();
        if (!room.equals(pixels.getSize())) {
            room = pixels.getSize();
            EventQueue.invokeLater(onRoomChanged);
        }
    }

    private Rectangle pixelsOf(AffineTransform toPixels) {
        Rectangle2D place = new Rectangle(0, 0, getWidth(), getHeight());
        Rectangle2D exact = toPixels.createTransformedShape(place).getBounds2D();
        int left = pixelAt(exact.getMinX());
        int top = pixelAt(exact.getMinY());
        return new Rectangle(
                left, top, pixelAt(exact.getMaxX()) - left, pixelAt(exact.getMaxY()) - top);
    }

    // As Java itself rounds what it clips and fills: a pixel belongs to whom its centre does.
    private static int pixelAt(double place) {
        return (int) Math.ceil(place - 0.5);
    }

    private void paintFrame(Graphics2D g, Rectangle pixels) {
        if (front == null || pixels.isEmpty()) {
            return;
        }
        Rectangle place = fit(front.getWidth(), front.getHeight(), pixels.width, pixels.height);
        g.setRenderingHint(
                RenderingHints.KEY_INTERPOLATION, RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        g.drawImage(
                front, pixels.x + place.x, pixels.y + place.y, place.width, place.height, null);
    }

    /** The largest centred place of those proportions in a room. */
    static Rectangle fit(int width, int height, int roomWidth, int roomHeight) {
        double scale = Math.min((double) roomWidth / width, (double) roomHeight / height);
        int w = Math.max(1, (int) Math.round(width * scale));
        int h = Math.max(1, (int) Math.round(height * scale));
        return new Rectangle((roomWidth - w) / 2, (roomHeight - h) / 2, w, h);
    }
}
