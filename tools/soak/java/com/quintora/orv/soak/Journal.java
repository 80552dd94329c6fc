// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.MappedByteBuffer;
import java.nio.channels.FileChannel;
import java.nio.charset.StandardCharsets;
import java.nio.file.Path;
import java.nio.file.StandardOpenOption;
import java.util.Arrays;
import java.util.Collection;
import java.util.Locale;
import java.util.Map;
import java.util.concurrent.ConcurrentHashMap;

/**
 * The last 200 actions, in a mapped file that outlives a crash of this process: a slot of fixed
 * length for each, which begins with the action's number. Thread-safe.
 */
final class Journal {
    static final int SLOTS = 200;
    static final int SLOT = 240;

    private final MappedByteBuffer ring;
    private final long from = System.nanoTime();
    private final Map<Long, Action> running = new ConcurrentHashMap<>();
    private long count;

    Journal(Path file) throws IOException {
        try (FileChannel channel = FileChannel.open(file, StandardOpenOption.CREATE,
                StandardOpenOption.READ, StandardOpenOption.WRITE)) {
            ring = channel.map(FileChannel.MapMode.READ_WRITE, 0, SLOTS * SLOT);
        }
    }

    /** Notes that something begins. */
    synchronized Action begin(int cycle, String what) {
        Action action = new Action(count++, cycle, what);
        running.put(action.number, action);
        write(action, "...");
        return action;
    }

    Collection<Action> running() {
        return running.values();
    }

    private synchronized void write(Action action, String outcome) {
        byte[] slot = new byte[SLOT];
        Arrays.fill(slot, (byte) ' ');
        byte[] text = String.format(Locale.ROOT, "%08d +%.3f s, cycle %d: %s: %s",
                action.number, (action.began - from) / 1e9, action.cycle, action.what,
                outcome.replace('\n', ' ')).getBytes(StandardCharsets.UTF_8);
        ByteBuffer.wrap(slot).put(text, 0, Math.min(text.length, SLOT - 1));
        slot[SLOT - 1] = '\n';
        ring.put((int) (action.number % SLOTS) * SLOT, slot);
    }

    /** Something that runs until it ends. */
    final class Action {
        final int cycle;
        final String what;
        private final long number;
        private final long began = System.nanoTime();

        private Action(long number, int cycle, String what) {
            this.number = number;
            this.cycle = cycle;
            this.what = what;
        }

        double seconds() {
            return (System.nanoTime() - began) / 1e9;
        }

        void end(String outcome) {
            running.remove(number);
            write(this, String.format(Locale.ROOT, "%s, %.0f ms", outcome, seconds() * 1000));
        }
    }
}
