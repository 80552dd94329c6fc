// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Graphics2D;
import java.awt.Image;
import java.awt.geom.Line2D;
import java.awt.geom.RoundRectangle2D;
import java.awt.image.BufferedImage;
import java.util.List;
import java.util.stream.IntStream;

/** The player's icon in the sizes that desktops show, as its SVG file has it. */
final class AppIcon {
    private static final double UNITS = 128;
    private static final Color CASE = new Color(0x20344F);
    private static final Color SCREEN = new Color(0x3F74B5);

    private AppIcon() {}

    static List<Image> images() {
        return IntStream.of(16, 24, 32, 48, 64, 128).<Image>mapToObj(AppIcon::image).toList();
    }

    /** A square of that many pixels. */
    static BufferedImage image(int size) {
        BufferedImage image = new BufferedImage(size, size, BufferedImage.TYPE_INT_ARGB);
        Graphics2D g = Theme.smooth(image.getGraphics());
        g.scale(size / UNITS, size / UNITS);
        g.setColor(CASE);
        g.fill(new RoundRectangle2D.Double(8, 20, 112, 80, 20, 20));
        g.setStroke(new BasicStroke(8, BasicStroke.CAP_ROUND, BasicStroke.JOIN_ROUND));
        g.draw(new Line2D.Double(44, 112, 84, 112));
        g.setColor(SCREEN);
        g.fill(new RoundRectangle2D.Double(15, 27, 98, 66, 10, 10));
        Glyph.PLAY.paint(g, 40, 36, 48, Color.WHITE);
        g.dispose();
        return image;
    }
}
