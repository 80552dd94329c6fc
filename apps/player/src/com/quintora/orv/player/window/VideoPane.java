// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.Rectangle;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;
import javax.swing.JComponent;

/** Shows the newest frame, as large as fits with its proportions kept. */
final class VideoPane extends JComponent {
    private BufferedImage frame;

    VideoPane() {
        setOpaque(true);
        getAccessibleContext().setAccessibleName("Video");
    }

    /** Call on the window's thread; the image must not change while it is shown. */
    void show(BufferedImage frame) {
        this.frame = frame;
        repaint();
    }

    @Override
    public Dimension getMinimumSize() {
        return new Dimension(160, 90);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        graphics.setColor(Theme.STAGE);
        graphics.fillRect(0, 0, getWidth(), getHeight());
        if (frame == null) {
            return;
        }
        Rectangle place = fit(frame.getWidth(), frame.getHeight(), getWidth(), getHeight());
        ((Graphics2D) graphics)
                .setRenderingHint(
                        RenderingHints.KEY_INTERPOLATION,
                        RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        graphics.drawImage(frame, place.x, place.y, place.width, place.height, null);
    }

    /** The largest centred place of those proportions in a room. */
    static Rectangle fit(int width, int height, int roomWidth, int roomHeight) {
        double scale = Math.min((double) roomWidth / width, (double) roomHeight / height);
        int w = Math.max(1, (int) Math.round(width * scale));
        int h = Math.max(1, (int) Math.round(height * scale));
        return new Rectangle((roomWidth - w) / 2, (roomHeight - h) / 2, w, h);
    }
}
