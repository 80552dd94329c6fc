// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Dimension;
import java.awt.Graphics2D;
import java.util.OptionalInt;
import java.util.function.IntConsumer;

/** The place in the media, what is buffered, and the chapters' starts. */
final class SeekBar extends LevelBar {
    private int durationMs;
    private Chapters chapters = Chapters.NONE;
    private RepeatMarks section = RepeatMarks.NONE;

    SeekBar(IntConsumer onSeek, IntConsumer onStep) {
        this(new Target(onSeek), onStep);
    }

    private SeekBar(Target target, IntConsumer onStep) {
        super("Position", 200, target::seek, onStep);
        target.bar = this;
        getAccessibleContext().setAccessibleDescription("Seconds from the start");
        setMaximumSize(new Dimension(Integer.MAX_VALUE, Theme.px(HEIGHT)));
    }

    /** In seconds. */
    @Override
    int maximum() {
        return durationMs / 1000;
    }

    void showChapters(Chapters chapters) {
        this.chapters = chapters;
        repaint();
    }

    void showSection(RepeatMarks section) {
        this.section = section;
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

    /** The time at a column of the bar, in milliseconds; 0 while there is none. */
    int timeAt(int x) {
        return (int) Math.round(levelAt(x) * durationMs);
    }

    /** What the chapter of that time is called, or nothing. */
    String chapterAt(int millis) {
        OptionalInt chapter = chapters.at(millis);
        return chapter.isPresent() ? chapters.name(chapter.getAsInt()) : "";
    }

    @Override
    void paintMarks(Graphics2D g) {
        g.setColor(Theme.PANEL);
        for (int i = 0; i < chapters.count(); i++) {
            paintMark(g, chapters.start(i));
        }
        paintSection(g);
    }

    private void paintSection(Graphics2D g) {
        g.setColor(Theme.SECTION);
        if (section.hasEnd()) {
            int left = (int) xOfTime(section.from());
            int width = Math.max(1, (int) xOfTime(section.to()) - left);
            g.fillRect(left, getHeight() / 2 - Theme.px(1), width, Theme.px(2));
        }
        if (section.hasStart()) {
            paintMark(g, section.from());
        }
        if (section.hasEnd()) {
            paintMark(g, section.to());
        }
    }

    private void paintMark(Graphics2D g, int atMs) {
        if (atMs > 0 && atMs < durationMs) {
            g.fillRect((int) xOfTime(atMs) - Theme.px(1), 0, Theme.px(2), getHeight());
        }
    }

    private double xOfTime(int atMs) {
        return xOf((double) atMs / Math.max(1, durationMs));
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
