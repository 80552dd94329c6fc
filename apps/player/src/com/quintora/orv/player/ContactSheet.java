// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.Color;
import java.awt.Font;
import java.awt.FontMetrics;
import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;

/** Pictures from all over a video, each above its time, below a line about the video. */
final class ContactSheet {
    private static final int GAP = 8;
    private static final int TITLE = 36; // Rows.
    private static final int TIME = 20;
    private static final int ABOVE_TIME = 2;
    private static final Color GROUND = new Color(0x17191E);
    private static final Color TEXT = new Color(0xE9EBEF);
    private static final Color MUTED = new Color(0x98A0AD);
    private static final Font TITLE_FONT = new Font(Font.SANS_SERIF, Font.BOLD, 15);
    private static final Font SMALL_FONT = new Font(Font.SANS_SERIF, Font.PLAIN, 12);

    // Encoding them takes some four times as many bytes.
    private static final long MOST_PIXELS = 100_000_000;

    private final String source;
    private final Stills stills;
    private final SheetGrid grid;
    private final Size picture;

    ContactSheet(String source, Stills stills, SheetGrid grid, Size picture) {
        this.source = source;
        this.stills = stills;
        this.grid = grid;
        this.picture = picture;
    }

    /** Blocks while the pictures are made. */
    BufferedImage draw() throws Failure {
        if (stills.durationMs() == 0) {
            throw new Failure(
                    "how long '" + source + "' is cannot be known, so there is no sheet of it");
        }
        long width = GAP + (long) grid.columns() * cellWidth();
        long height = TITLE + (long) grid.rows() * cellHeight();
        if (width * height > MOST_PIXELS) {
            throw new Failure(
                    "a sheet of " + grid.pictures() + " pictures of " + picture + " is too large");
        }
        var sheet =
                new BufferedImage((int) width, (int) height, BufferedImage.TYPE_INT_RGB);
        Graphics2D ink = sheet.createGraphics();
        ink.setRenderingHint(
                RenderingHints.KEY_TEXT_ANTIALIASING, RenderingHints.VALUE_TEXT_ANTIALIAS_ON);
        ink.setColor(GROUND);
        ink.fillRect(0, 0, sheet.getWidth(), sheet.getHeight());
        drawTitle(ink, sheet.getWidth());
        for (int i = 0; i < grid.pictures(); i++) {
            drawPicture(ink, i);
        }
        ink.dispose();
        return sheet;
    }

    private int cellWidth() {
        return picture.width() + GAP;
    }

    private int cellHeight() {
        return picture.height() + TIME + GAP;
    }

    private void drawTitle(Graphics2D ink, int width) {
        String about = stills.size() + "  " + Times.clock(stills.durationMs());
        int baseline = TITLE - GAP - ink.getFontMetrics(TITLE_FONT).getDescent();
        ink.setFont(SMALL_FONT);
        ink.setColor(MUTED);
        int right = width - GAP - ink.getFontMetrics().stringWidth(about);
        if (right > width / 2) {
            ink.drawString(about, right, baseline);
        } else {
            right = width; // No room for it.
        }
        ink.setFont(TITLE_FONT);
        ink.setColor(TEXT);
        String name =
                Ellipsis.atEnd(MediaName.of(source), ink.getFontMetrics(), right - 2 * GAP);
        ink.drawString(name, GAP, baseline);
    }

    private void drawPicture(Graphics2D ink, int index) throws Failure {
        // In the middle of its part of the video: the very start is often black.
        double share = (index + 0.5) / grid.pictures();
        Still still = stills.at((int) (stills.durationMs() * share), picture);
        int x = GAP + index % grid.columns() * cellWidth();
        int y = TITLE + index / grid.columns() * cellHeight();
        ink.drawImage(still.image(), x, y, null);
        ink.setFont(SMALL_FONT);
        ink.setColor(TEXT);
        FontMetrics metrics = ink.getFontMetrics();
        ink.drawString(
                timeOf(still), x, y + picture.height() + ABOVE_TIME + metrics.getAscent());
    }

    // Several of one second are told apart.
    private String timeOf(Still still) {
        String clock = Times.clock(still.timeMs());
        boolean isDense = stills.durationMs() / grid.pictures() < 1000;
        return isDense ? clock + String.format(".%03d", still.timeMs() % 1000) : clock;
    }
}
