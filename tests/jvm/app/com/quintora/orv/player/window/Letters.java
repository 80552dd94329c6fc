// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.awt.Component;
import java.awt.Graphics2D;
import java.awt.image.BufferedImage;

/** Letters as pixels, to be compared with others. */
final class Letters {
    /** In front of letters that stand as they are seen, from left to right: forbids ordering. */
    static final char AS_THEY_STAND = '\u202D';

    private Letters() {}

    static BufferedImage drawn(String words) {
        var image = new BufferedImage(400, 40, BufferedImage.TYPE_INT_RGB);
        Graphics2D g = Theme.smooth(image.getGraphics());
        g.setFont(Theme.body());
        g.drawString(words, 10, 25);
        g.dispose();
        return cropped(image);
    }

    static BufferedImage inkOf(Component component) {
        var image = new BufferedImage(
                component.getWidth(), component.getHeight(), BufferedImage.TYPE_INT_RGB);
        component.paint(image.getGraphics());
        return cropped(image);
    }

    /** Without the ground around it. */
    private static BufferedImage cropped(BufferedImage image) {
        int ground = image.getRGB(0, 0);
        int left = image.getWidth();
        int right = 0;
        for (int x = 0; x < image.getWidth(); x++) {
            for (int y = 0; y < image.getHeight(); y++) {
                if (image.getRGB(x, y) != ground) {
                    left = Math.min(left, x);
                    right = x;
                }
            }
        }
        assertTrue(left < right, "nothing is drawn");
        return image.getSubimage(left, 0, right - left + 1, image.getHeight());
    }

    /** The last columns. */
    static BufferedImage right(BufferedImage image, int width) {
        return image.getSubimage(image.getWidth() - width, 0, width, image.getHeight());
    }

    static void assertSame(BufferedImage wanted, BufferedImage got) {
        assertEquals(wanted.getWidth(), got.getWidth(), "width");
        for (int y = 0; y < wanted.getHeight(); y++) {
            for (int x = 0; x < wanted.getWidth(); x++) {
                assertEquals(wanted.getRGB(x, y), got.getRGB(x, y), x + ", " + y);
            }
        }
    }
}
