// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Times;
import java.awt.Dimension;
import java.awt.Graphics2D;
import java.awt.event.MouseEvent;
import java.util.List;
import java.util.function.IntConsumer;
import javax.swing.ToolTipManager;

/** The place in the media, what is buffered, and the chapters' starts. */
final class SeekBar extends LevelBar {
    /** A mark on the bar. */
    record Mark(int atMs, String title) {}

    private int durationMs;
    private List<Mark> marks = List.of();

    SeekBar(IntConsumer onSeek, IntConsumer onStep) {
        this(new Target(onSeek), onStep);
    }

    private SeekBar(Target target, IntConsumer onStep) {
        super("Position", 200, target::seek, onStep);
        target.bar = this;
        getAccessibleContext().setAccessibleDescription("Seconds from the start");
        setMaximumSize(new Dimension(Integer.MAX_VALUE, 20));
        ToolTipManager.sharedInstance().registerComponent(this);
    }

    /** In seconds. */
    @Override
    int maximum() {
        return durationMs / 1000;
    }

    void showMarks(List<Mark> marks) {
        this.marks = List.copyOf(marks);
        repaint();
    }

    void showPosition(int positionMs, int durationMs, int bufferedPercent) {
        if (durationMs != this.durationMs) {
            this.durationMs = durationMs;
            repaint(); // The marks move.
        }
        setEnabled(durationMs > 0);
        showLevel(
                durationMs > 0 ? (double) positionMs / durationMs : 0, bufferedPercent / 100.0);
    }

    @Override
    public String getToolTipText(MouseEvent event) {
        int at = (int) (levelAt(event.getX()) * durationMs);
        String title = "";
        for (Mark mark : marks) {
            if (mark.atMs <= at) {
                title = mark.title;
            }
        }
        return durationMs == 0 ? null : Times.clock(at) + (title.isEmpty() ? "" : "  " + title);
    }

    @Override
    void paintMarks(Graphics2D g) {
        g.setColor(Theme.PANEL);
        for (Mark mark : marks) {
            if (mark.atMs > 0 && mark.atMs < durationMs) {
                g.fillRect((int) xOf((double) mark.atMs / durationMs) - 1, 0, 2, getHeight());
            }
        }
    }

    /** Turns the bar's level into milliseconds. */
    private static final class Target {
        private final IntConsumer onSeek;
        private SeekBar bar;

        Target(IntConsumer onSeek) {
            this.onSeek = onSeek;
        }

        void seek(double level) {
            onSeek.accept((int) Math.round(level * bar.durationMs));
        }
    }
}
