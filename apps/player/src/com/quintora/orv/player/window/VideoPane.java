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
import java.util.concurrent.atomic.AtomicBoolean;
import java.util.concurrent.atomic.AtomicLong;
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

    private final AtomicBoolean awaitsPainting = new AtomicBoolean();
    private final Runnable onRoomChanged;
    private Dimension room = new Dimension();
    private final AtomicLong copies = new AtomicLong();
    private long paintings;
    private long scalings;

    /** How often a frame was copied, the picture painted, and of those painted in another size. */
    record Work(long copies, long paintings, long scalings) {}

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
        copies.incrementAndGet();
        draw(back);
    }

    /** Shows a still picture, which must not change any more. */
    void draw(BufferedImage picture) {
        synchronized (lock) {
            back = front;
            front = picture;
        }
        if (!awaitsPainting.getAndSet(true)) {
            EventQueue.invokeLater(this::paintNewest);
        }
    }

    /** Straight onto the screen, if nothing lies over it: there is nothing to flicker. */
    private void paintNewest() {
        awaitsPainting.set(false);
        if (!isShowing()) {
            return; // It is painted when it shows again.
        }
        if (Covering.isOver(this)) {
            repaint();
            return;
        }
        // Asking for it also ends that Swing keeps the window's content to put it back where
        // the window was covered: that would be an older picture.
        Graphics graphics = getGraphics();
        if (graphics != null) {
            paintComponent(graphics);
            graphics.dispose();
            getToolkit().sync();
        }
    }

    /** What was done since the pane was made; on the window's thread. */
    Work work() {
        return new Work(copies.get(), paintings, scalings);
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
        g.setColor(Theme.STAGE);
        if (front == null || pixels.isEmpty()) {
            g.fill(pixels);
            return;
        }
        Rectangle place = fit(front.getWidth(), front.getHeight(), pixels.width, pixels.height);
        place.translate(pixels.x, pixels.y);
        fillAround(g, pixels, place);
        paintings++;
        if (place.width == front.getWidth() && place.height == front.getHeight()) {
            g.drawImage(front, place.x, place.y, null);
            return;
        }
        scalings++;
        g.setRenderingHint(
                RenderingHints.KEY_INTERPOLATION, RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        g.drawImage(front, place.x, place.y, place.width, place.height, null);
    }

    // Nothing is painted twice, which would flicker.
    private static void fillAround(Graphics2D g, Rectangle whole, Rectangle inner) {
        int above = inner.y - whole.y;
        int left = inner.x - whole.x;
        int below = whole.height - above - inner.height;
        int right = whole.width - left - inner.width;
        g.fillRect(whole.x, whole.y, whole.width, above);
        g.fillRect(whole.x, inner.y + inner.height, whole.width, below);
        g.fillRect(whole.x, inner.y, left, inner.height);
        g.fillRect(inner.x + inner.width, inner.y, right, inner.height);
    }

    /** The largest centred place of those proportions in a room. */
    static Rectangle fit(int width, int height, int roomWidth, int roomHeight) {
        double scale = Math.min((double) roomWidth / width, (double) roomHeight / height);
        int w = Math.max(1, (int) Math.round(width * scale));
        int h = Math.max(1, (int) Math.round(height * scale));
        return new Rectangle((roomWidth - w) / 2, (roomHeight - h) / 2, w, h);
    }
}
