// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Ellipsis;
import java.awt.Dimension;
import java.awt.FontMetrics;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.image.BufferedImage;
import javax.swing.JPanel;

/** A small picture, or room for it, above a time and the name of a chapter. */
final class PreviewCard extends JPanel {
    private static final int EDGE = 4;
    private static final int MOST_WORDS = 260;

    private final int edge = Theme.px(EDGE);
    private Dimension room = new Dimension();
    private BufferedImage picture;
    private String time = "";
    private String chapter = "";

    void showPlace(String time, String chapter) {
        this.time = time;
        this.chapter = chapter;
        getAccessibleContext().setAccessibleName((time + "  " + chapter).strip());
        repaint();
    }

    void keepRoom(int width, int height) {
        room = new Dimension(width, height);
    }

    void showNoPictures() {
        room = new Dimension();
        picture = null;
    }

    /** Null while there is none. */
    void showPicture(BufferedImage picture) {
        this.picture = picture;
        repaint();
    }

    @Override
    public Dimension getPreferredSize() {
        FontMetrics metrics = getFontMetrics(Theme.small());
        int words = Math.max(metrics.stringWidth(time), metrics.stringWidth(chapter));
        int lines = chapter.isEmpty() ? 1 : 2;
        int width = room.width > 0 ? room.width : Math.min(Theme.px(MOST_WORDS), words) + 2 * edge;
        return new Dimension(
                width + 2 * edge, room.height + lines * metrics.getHeight() + 3 * edge);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D g = Theme.smooth(graphics);
        g.setColor(Theme.RAISED);
        g.fillRect(0, 0, getWidth(), getHeight());
        g.setColor(Theme.STAGE);
        g.fillRect(edge, edge, room.width, room.height);
        if (picture != null) {
            g.drawImage(picture, edge, edge, null);
        }
        g.setFont(Theme.small());
        g.setColor(Theme.TEXT);
        int line = room.height + 2 * edge + g.getFontMetrics().getAscent();
        paintWords(g, time, line);
        g.setColor(Theme.MUTED);
        paintWords(g, chapter, line + g.getFontMetrics().getHeight());
        g.dispose();
    }

    private void paintWords(Graphics2D g, String words, int baseline) {
        FontMetrics metrics = g.getFontMetrics();
        String shown = Ellipsis.atEnd(words, metrics, getWidth() - 2 * edge);
        g.drawString(shown, (getWidth() - metrics.stringWidth(shown)) / 2, baseline);
    }
}
