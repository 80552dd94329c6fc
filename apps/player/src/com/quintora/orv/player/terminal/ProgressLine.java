// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.terminal;

import com.quintora.orv.player.Snapshot;
import com.quintora.orv.player.Times;
import java.util.Locale;

/** The words and the bar that show how far a playback is. */
final class ProgressLine {
    private static final int MIN_BAR = 10;
    private static final int MAX_BAR = 60;

    private ProgressLine() {}

    /** One line of at most the given number of columns. */
    static String bar(Snapshot now, int columns) {
        String state = now.playing() ? "▶ " : "⏸ ";
        String head = state + Times.clock(now.positionMs()) + " ";
        String tail = " " + Times.length(now.durationMs()) + "  " + details(now);
        int room = Math.min(MAX_BAR, columns - 1 - head.length() - tail.length());
        String line = room < MIN_BAR ? head + "/" + tail : head + drawBar(now, room) + tail;
        return line.length() < columns ? line : line.substring(0, Math.max(0, columns - 1));
    }

    /** One line for logs, in words. */
    static String plain(Snapshot now) {
        return seconds(now.positionMs())
                + " of "
                + (now.durationMs() > 0 ? seconds(now.durationMs()) : "unknown length")
                + ", "
                + details(now);
    }

    private static String seconds(int millis) {
        return String.format(Locale.ROOT, "%.1f s", millis / 1000.0);
    }

    private static String details(Snapshot now) {
        return String.format(
                Locale.ROOT,
                "%sx  %d%% buffered  %d shown, %d dropped",
                speed(now.speed()),
                now.bufferedPercent(),
                now.framesShown(),
                now.framesDropped());
    }

    private static String speed(double speed) {
        return speed == Math.rint(speed)
                ? String.valueOf((long) speed)
                : String.format(Locale.ROOT, "%.2f", speed);
    }

    private static String drawBar(Snapshot now, int width) {
        int played = part(now.positionMs(), now.durationMs(), width);
        int buffered = Math.max(played, part(now.bufferedPercent(), 100, width));
        return "━".repeat(played)
                + "╌".repeat(buffered - played)
                + " ".repeat(width - buffered);
    }

    private static int part(long value, long whole, int width) {
        return whole <= 0 ? 0 : (int) Math.max(0, Math.min(width, value * width / whole));
    }
}
