// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.log;

import com.quintora.mmp.desktop.LogReader;
import java.time.Instant;
import java.time.ZoneId;
import java.time.format.DateTimeFormatter;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.Deque;
import java.util.List;
import java.util.Locale;

/** The newest lines of the native log, of which a filter lets some through. Not thread-safe. */
public final class LogLines {
    /** How many lines are kept at most. */
    public static final int MOST = 5000;

    private static final DateTimeFormatter CLOCK =
            DateTimeFormatter.ofPattern("HH:mm:ss.SSS").withZone(ZoneId.systemDefault());

    private final Deque<LogReader.Line> lines = new ArrayDeque<>();
    private LogReader.Priority least = LogReader.Priority.INFO;
    private String part = "";

    /** Keeps them, the oldest first, in place of the oldest ones where there are too many. */
    public void add(List<LogReader.Line> newer) {
        lines.addAll(newer);
        while (lines.size() > MOST) {
            lines.removeFirst();
        }
    }

    public void clear() {
        lines.clear();
    }

    public LogReader.Priority least() {
        return least;
    }

    /** Lets only lines through that matter that much. */
    public void setLeast(LogReader.Priority least) {
        this.least = least;
    }

    /** Lets only lines through that have this in them, in letters of any size. */
    public void setPart(String part) {
        this.part = part.toLowerCase(Locale.ROOT);
    }

    /** The lines that get through, as text. */
    public List<String> shown() {
        List<String> shown = new ArrayList<>();
        for (LogReader.Line line : lines) {
            if (line.priority().compareTo(least) >= 0) {
                String text = text(line);
                if (text.toLowerCase(Locale.ROOT).contains(part)) {
                    shown.add(text);
                }
            }
        }
        return shown;
    }

    private static String text(LogReader.Line line) {
        return CLOCK.format(Instant.ofEpochMilli(line.timeMillis()))
                + " "
                + line.priority().name().charAt(0)
                + " "
                + line.tag()
                + ": "
                + line.text().strip().replaceAll("\\p{Cntrl}+", " ");
    }
}
