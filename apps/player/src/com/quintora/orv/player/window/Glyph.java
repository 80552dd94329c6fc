// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Font;
import java.awt.Graphics2D;
import java.awt.Shape;
import java.awt.geom.Arc2D;
import java.awt.geom.Path2D;
import java.awt.geom.RoundRectangle2D;
import java.util.function.Consumer;

/** The controls' pictures, drawn on a square of 24 units. */
enum Glyph {
    PLAY(g -> g.fill(polygon(7, 4, 20, 12, 7, 20))),
    PAUSE(
            g -> {
                g.fill(new RoundRectangle2D.Double(6, 4, 4.5, 16, 1.5, 1.5));
                g.fill(new RoundRectangle2D.Double(13.5, 4, 4.5, 16, 1.5, 1.5));
            }),
    BACK(g -> skip(g, true)),
    FORWARD(g -> skip(g, false)),
    VOLUME(
            g -> {
                speaker(g);
                g.draw(new Arc2D.Double(10, 8, 8, 8, -50, 100, Arc2D.OPEN));
                g.draw(new Arc2D.Double(7, 5, 14, 14, -50, 100, Arc2D.OPEN));
            }),
    MUTED(
            g -> {
                speaker(g);
                g.draw(lines(16, 9.5, 21, 14.5, 21, 9.5, 16, 14.5));
            }),
    AUDIO(
            g -> {
                for (int i = 0; i < 5; i++) {
                    double half = new double[] {3, 7, 4.5, 8, 2.5}[i];
                    double x = 4 + 4 * i;
                    g.draw(lines(x, 12 - half, x, 12 + half));
                }
            }),
    SUBTITLES(
            g -> {
                g.draw(new RoundRectangle2D.Double(2.5, 5, 19, 14, 4, 4));
                g.draw(lines(6, 12, 11, 12, 14, 12, 18, 12, 6, 15.5, 9, 15.5, 12, 15.5, 18, 15.5));
            }),
    FULL_SCREEN(g -> g.draw(corners(4, 9))),
    WINDOWED(g -> g.draw(corners(9, 4))),
    MENU(g -> g.draw(lines(4, 6.5, 20, 6.5, 4, 12, 20, 12, 4, 17.5, 20, 17.5))),
    SUBMENU(g -> g.draw(lines(9, 5, 16, 12, 16, 12, 9, 19))),
    LIST(
            g -> {
                g.draw(lines(4, 6.5, 15, 6.5, 4, 12, 15, 12, 4, 17.5, 11, 17.5));
                g.fill(polygon(15, 13, 22, 17.5, 15, 22));
            }),
    PREVIOUS(
            g -> {
                g.fill(polygon(19, 5, 8, 12, 19, 19));
                g.draw(lines(5.5, 5.5, 5.5, 18.5));
            }),
    NEXT(
            g -> {
                g.fill(polygon(5, 5, 16, 12, 5, 19));
                g.draw(lines(18.5, 5.5, 18.5, 18.5));
            }),
    CLOSE(g -> g.draw(lines(6, 6, 18, 18, 18, 6, 6, 18))),
    CHECK(g -> g.draw(lines(5, 13, 10, 18, 10, 18, 20, 7))),
    ALERT(
            g -> {
                g.draw(new Arc2D.Double(2.5, 2.5, 19, 19, 0, 360, Arc2D.OPEN));
                g.draw(lines(12, 7, 12, 13));
                g.fill(new Arc2D.Double(10.9, 15.4, 2.2, 2.2, 0, 360, Arc2D.OPEN));
            });

    private final Consumer<Graphics2D> drawing;

    Glyph(Consumer<Graphics2D> drawing) {
        this.drawing = drawing;
    }

    void paint(Graphics2D target, double x, double y, double size, Color color) {
        Graphics2D g = Theme.smooth(target);
        g.translate(x, y);
        g.scale(size / 24, size / 24);
        g.setColor(color);
        g.setStroke(new BasicStroke(1.9f, BasicStroke.CAP_ROUND, BasicStroke.JOIN_ROUND));
        drawing.accept(g);
        g.dispose();
    }

    private static void speaker(Graphics2D g) {
        g.fill(polygon(3, 9, 7, 9, 12, 4.5, 12, 19.5, 7, 15, 3, 15));
    }

    /** An arrow round the number of seconds that a skip takes. */
    private static void skip(Graphics2D g, boolean back) {
        g.draw(new Arc2D.Double(3, 4, 18, 18, back ? 130 : 50, back ? 280 : -280, Arc2D.OPEN));
        g.fill(back ? polygon(8, 1, 8, 9.5, 2.5, 5.2) : polygon(16, 1, 16, 9.5, 21.5, 5.2));
        g.setFont(new Font(Font.SANS_SERIF, Font.BOLD, 8));
        g.drawString("10", 7f, 16f);
    }

    private static Shape polygon(double... points) {
        Path2D path = new Path2D.Double();
        path.moveTo(points[0], points[1]);
        for (int i = 2; i < points.length; i += 2) {
            path.lineTo(points[i], points[i + 1]);
        }
        path.closePath();
        return path;
    }

    private static Shape lines(double... points) {
        Path2D path = new Path2D.Double();
        for (int i = 0; i < points.length; i += 4) {
            path.moveTo(points[i], points[i + 1]);
            path.lineTo(points[i + 2], points[i + 3]);
        }
        return path;
    }

    /** Four corner brackets: their bend at one distance from the edge, their ends at another. */
    private static Shape corners(double bend, double ends) {
        Path2D path = new Path2D.Double();
        for (double[] sign : new double[][] {{0, 0}, {1, 0}, {0, 1}, {1, 1}}) {
            double bx = sign[0] == 0 ? bend : 24 - bend;
            double by = sign[1] == 0 ? bend : 24 - bend;
            double ex = sign[0] == 0 ? ends : 24 - ends;
            double ey = sign[1] == 0 ? ends : 24 - ends;
            path.moveTo(ex, by);
            path.lineTo(bx, by);
            path.lineTo(bx, ey);
        }
        return path;
    }
}
