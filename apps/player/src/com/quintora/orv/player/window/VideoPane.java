// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.desktop.VideoFrame;
import java.awt.Dimension;
import java.awt.EventQueue;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.Rectangle;
import java.awt.geom.AffineTransform;
import java.awt.geom.Rectangle2D;
import java.awt.image.BufferedImage;
import java.lang.reflect.InvocationTargetException;
import java.nio.ByteBuffer;
import java.util.function.Consumer;
import javax.swing.JPanel;

/**
 * Shows the newest frame, as large as fits with its proportions kept. Pixels are the screen's own,
 * of which there are more than the window's where the screen is scaled.
 */
final class VideoPane extends JPanel {
    private final FramePainter painter = new FramePainter();
    private final Runnable onRoomChanged;
    // One of them is shown; on the window's thread.
    private Frame frame;
    private BufferedImage still;
    // Frames of before must not come back: their memory is no longer theirs.
    private volatile int content;
    private Dimension room = new Dimension();
    private long paintings;
    private long scalings;

    /** How many pixels were copied, pictures painted, and of those in another size. */
    record Work(long copiedPixels, long paintings, long scalings) {}

    /** Calls back when there is more or less room than before, on the window's thread. */
    VideoPane(Runnable onRoomChanged) {
        this.onRoomChanged = onRoomChanged;
        getAccessibleContext().setAccessibleName("Video");
    }

    /**
     * Shows a frame from now on, and returns when it is painted, so that its memory may have other
     * content then: what is painted again later, as after another window was in front, is what is
     * there at that time. Any thread but the window's.
     *
     * @param pixels rows of 32-bit pixels that read 0xXXRRGGBB
     * @param stride bytes from row to row
     */
    void draw(ByteBuffer pixels, int width, int height, int stride) {
        draw(new Frame(pixels, width, height, stride), content);
    }

    private void draw(Frame next, int its) {
        try {
            EventQueue.invokeAndWait(
                    () -> {
                        if (its == content) {
                            show(next, null);
                        }
                    });
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt(); // The window is closing.
        } catch (InvocationTargetException e) {
            Thread thread = Thread.currentThread();
            thread.getUncaughtExceptionHandler().uncaughtException(thread, e.getCause());
        }
    }

    /**
     * Forgets what is shown; on the window's thread.
     *
     * @return what shows frames from now on, until this is called again: called on any thread but
     *     the window's, and returns when the frame is painted or left out
     */
    Consumer<VideoFrame> begin() {
        content++;
        show(null, null);
        repaint();
        return screen();
    }

    /** The same for what is shown at present. */
    Consumer<VideoFrame> screen() {
        int its = content;
        return frame ->
                draw(
                        new Frame(
                                frame.getPixels(),
                                frame.getWidth(),
                                frame.getHeight(),
                                frame.getRowStride()),
                        its);
    }

    /** Shows a still picture, which must not change any more; on the window's thread. */
    void draw(BufferedImage picture) {
        show(null, picture);
    }

    private void show(Frame nextFrame, BufferedImage nextStill) {
        frame = nextFrame;
        still = nextStill;
        if (!isShowing()) {
            return; // It is painted when it shows again.
        }
        if (Covering.isOver(this)) {
            paintImmediately(0, 0, getWidth(), getHeight());
        } else {
            paintAlone();
        }
    }

    // Straight onto the screen: with nothing over it, there is nothing to flicker. Asking for the
    // graphics also ends that Swing keeps the window's content to put it back where the window
    // was covered, which would be an older picture.
    private void paintAlone() {
        Graphics graphics = getGraphics();
        if (graphics != null) {
            paintComponent(graphics);
            graphics.dispose();
            getToolkit().sync();
        }
    }

    /** What was done since the pane was made; on the window's thread. */
    Work work() {
        return new Work(painter.copiedPixels(), paintings, scalings);
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
        if (frame != null) {
            return new Dimension(frame.width(), frame.height());
        }
        return still == null ? new Dimension() : new Dimension(still.getWidth(), still.getHeight());
    }

    // Only here it is certain on which screen, and how large, the picture shows.
    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = (Graphics2D) graphics.create();
        Rectangle pixels = pixelsOf(g.getTransform());
        g.setTransform(new AffineTransform());
        paintPicture(g, pixels);
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

    private void paintPicture(Graphics2D g, Rectangle pixels) {
        g.setColor(Theme.STAGE);
        Dimension size = pictureSize();
        if (size.width == 0 || pixels.isEmpty()) {
            g.fill(pixels);
            return;
        }
        Rectangle place = fit(size.width, size.height, pixels.width, pixels.height);
        place.translate(pixels.x, pixels.y);
        fillAround(g, pixels, place);
        paintings++;
        boolean isScaled = !place.getSize().equals(size);
        scalings += isScaled ? 1 : 0;
        if (frame != null) {
            painter.paint(g, frame, place);
        } else if (isScaled) {
            FramePainter.paintScaled(g, still, place);
        } else {
            g.drawImage(still, place.x, place.y, null);
        }
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
