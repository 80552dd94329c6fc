// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;

/** Brings pictures to other sizes, with every pixel counted. */
final class Scaling {
    private Scaling() {}

    /** The shape follows the size. The picture itself when it has that size. */
    static BufferedImage to(BufferedImage picture, Size wanted) {
        BufferedImage image = picture;
        // By more than half, bilinear scaling would leave pixels out.
        while (image.getWidth() >= 2 * wanted.width() || image.getHeight() >= 2 * wanted.height()) {
            int width = Math.max(wanted.width(), (image.getWidth() + 1) / 2);
            int height = Math.max(wanted.height(), (image.getHeight() + 1) / 2);
            image = draw(image, width, height, RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        }
        boolean isThere =
                image.getWidth() == wanted.width() && image.getHeight() == wanted.height();
        return isThere
                ? image
                : draw(
                        image,
                        wanted.width(),
                        wanted.height(),
                        RenderingHints.VALUE_INTERPOLATION_BICUBIC);
    }

    private static BufferedImage draw(BufferedImage image, int width, int height, Object way) {
        var scaled = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        Graphics2D g = scaled.createGraphics();
        g.setRenderingHint(RenderingHints.KEY_INTERPOLATION, way);
        g.drawImage(image, 0, 0, width, height, null);
        g.dispose();
        return scaled;
    }
}
