// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import com.quintora.mmp.platform.internal.PlatformLibrary;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.List;

/**
 * Reads what the native libraries of this process log from now on, of every priority, whatever the
 * terminal shows of it. It keeps the newest 4096 lines that were not read yet; an open reader costs
 * the time to make and keep them, a closed one nothing. All methods may be called from any thread;
 * none blocks. Close the reader after use.
 */
public final class LogReader implements AutoCloseable {
    /** How much a line matters. */
    public enum Priority {
        /** What is of use to who mends the libraries alone. */
        VERBOSE,
        /** What explains how something came. */
        DEBUG,
        /** What happens. */
        INFO,
        /** What may be the cause of a failure. */
        WARN,
        /** What failed. */
        ERROR,
        /** What ends the process. */
        FATAL;

        // As the platform numbers them.
        private static final int FIRST = 2;

        private static Priority of(int number) {
            int last = values().length - 1;
            return values()[Math.max(0, Math.min(last, number - FIRST))];
        }
    }

    /**
     * A line.
     *
     * @param priority how much it matters
     * @param timeMillis when it was logged, as {@link System#currentTimeMillis} has it
     * @param tag who logged it; may be empty
     * @param text what was logged, as far as it is UTF-8; its first 2048 bytes
     */
    public record Line(Priority priority, long timeMillis, String tag, String text) {}

    static {
        PlatformLibrary.load();
    }

    private static final int FIELD_COUNT = 4;

    private long mReader;

    /** Begins to keep lines. */
    public LogReader() {
        mReader = nativeOpen();
        if (mReader == 0) {
            throw new OutOfMemoryError("native log reader");
        }
    }

    /**
     * Takes the lines that came since the last call.
     *
     * @return the lines, the oldest first; none after {@link #close()}
     */
    public synchronized List<Line> read() {
        return mReader == 0 ? List.of() : linesOf(nativeTake(mReader));
    }

    /**
     * How many lines found no room because they were not read in time.
     *
     * @return the number since the reader was made; 0 after {@link #close()}
     */
    public synchronized long getLostCount() {
        return mReader == 0 ? 0 : nativeLost(mReader);
    }

    private static List<Line> linesOf(byte[] bytes) {
        List<Line> lines = new ArrayList<>();
        List<String> fields = new ArrayList<>(FIELD_COUNT);
        int start = 0;
        for (int end = 0; end < bytes.length; end++) {
            if (bytes[end] != 0) {
                continue;
            }
            fields.add(new String(bytes, start, end - start, StandardCharsets.UTF_8));
            start = end + 1;
            if (fields.size() == FIELD_COUNT) {
                lines.add(lineOf(fields));
                fields.clear();
            }
        }
        return lines;
    }

    private static Line lineOf(List<String> fields) {
        return new Line(
                Priority.of(Integer.parseInt(fields.get(0))),
                Long.parseLong(fields.get(1)),
                fields.get(2),
                fields.get(3));
    }

    /** Keeps no more lines, and forgets those that were not read. */
    @Override
    public synchronized void close() {
        if (mReader != 0) {
            nativeClose(mReader);
            mReader = 0;
        }
    }

    private static native long nativeOpen();

    private static native void nativeClose(long reader);

    private static native byte[] nativeTake(long reader);

    private static native long nativeLost(long reader);
}
