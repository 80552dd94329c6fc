// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Graphics2D;
import java.awt.Rectangle;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;

/**
 * Paints frames. Java paints from its own memory alone, so a frame is copied there: in bands that
 * are still in the processor's cache when they go on to the screen. For one thread.
 */
final class FramePainter {
    private static final int BAND_PIXELS = 256 * 1024;

    private BufferedImage band = new BufferedImage(1, 1, BufferedImage.TYPE_INT_RGB);
    private long copiedPixels;

    /** Into a place of the screen's own pixels. */
    void paint(Graphics2D g, Frame frame, Rectangle place) {
        if (place.width != frame.width() || place.height != frame.height()) {
            fill(frame, 0, frame.height(), frame.height());
            paintScaled(g, band, place);
            return;
        }
        int rows = Math.max(1, BAND_PIXELS / frame.width());
        for (int first = 0; first < frame.height(); first += rows) {
            int count = Math.min(rows, frame.height() - first);
            int top = place.y + first;
            if (g.hitClip(place.x, top, frame.width(), count)) {
                fill(frame, first, count, rows);
                g.drawImage(
                        band, place.x, top, place.x + frame.width(), top + count,
                        0, 0, frame.width(), count, null);
            }
        }
    }

    static void paintScaled(Graphics2D g, BufferedImage picture, Rectangle place) {
        g.setRenderingHint(
                RenderingHints.KEY_INTERPOLATION, RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        g.drawImage(picture, place.x, place.y, place.width, place.height, null);
    }

    /** How many pixels were copied so far. */
    long copiedPixels() {
        return copiedPixels;
    }

    private void fill(Frame frame, int first, int count, int rows) {
        if (band.getWidth() != frame.width() || band.getHeight() != rows) {
            band = new BufferedImage(frame.width(), rows, BufferedImage.TYPE_INT_RGB);
        }
        frame.copyRows(first, count, ((DataBufferInt) band.getRaster().getDataBuffer()).getData());
        copiedPixels += (long) count * frame.width();
    }
}
