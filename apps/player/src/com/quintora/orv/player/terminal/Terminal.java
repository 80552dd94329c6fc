// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.terminal;

import java.io.PrintStream;

/** Standard output: a terminal with a line that is drawn again and again, or a log of lines. */
public final class Terminal {
    private static final String HIDE_CURSOR = "\033[?25l";
    private static final String SHOW_CURSOR = "\033[?25h";
    private static final String CLEAR_LINE = "\r\033[K";

    private final PrintStream out;
    private final int columns;
    private boolean drawing;
    private boolean closed;

    Terminal(PrintStream out, int columns) {
        this.out = out;
        this.columns = columns;
    }

    /** Standard output; orv.columns is set by the starting script where that is a terminal. */
    public static Terminal standard() {
        return new Terminal(System.out, Integer.getInteger("orv.columns", 0));
    }

    boolean isInteractive() {
        return columns > 0;
    }

    int columns() {
        return columns;
    }

    /** Draws over the line that was drawn before. */
    synchronized void draw(String line) {
        if (closed) {
            return;
        }
        out.print((drawing ? "" : HIDE_CURSOR) + CLEAR_LINE + line);
        out.flush();
        drawing = true;
    }

    /** Ends the drawn line, and writes one of its own. */
    public synchronized void line(String line) {
        restore();
        if (!closed) {
            out.println(line);
        }
    }

    /** Leaves the terminal as it was found; may be called at any time. */
    public synchronized void restore() {
        if (drawing) {
            out.println(SHOW_CURSOR);
            out.flush();
            drawing = false;
        }
    }

    /** Restores the terminal, and writes nothing more. */
    public synchronized void close() {
        restore();
        closed = true;
    }
}
