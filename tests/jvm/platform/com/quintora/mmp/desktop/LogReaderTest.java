// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.Wait;
import java.util.ArrayList;
import java.util.List;
import org.junit.jupiter.api.Test;

class LogReaderTest {
    private static final int ROOM = 4096;

    private final OrvMediaPlayer player = new OrvMediaPlayer();

    private static boolean has(List<LogReader.Line> lines, String part) {
        return lines.stream().anyMatch(line -> line.text().contains(part));
    }

    @Test
    void linesOfEachPriorityAreReadOnce() {
        long before = System.currentTimeMillis();
        try (var reader = new LogReader()) {
            player.setLooping(true);
            player.engine().unlock(1);
            List<LogReader.Line> lines = reader.read();
            assertTrue(has(lines, "setUnLockPin"), lines::toString);
            assertTrue(
                    lines.stream().anyMatch(line -> line.priority() == LogReader.Priority.ERROR),
                    lines::toString);
            assertTrue(
                    lines.stream()
                            .anyMatch(line -> line.priority().compareTo(
                                            LogReader.Priority.INFO) <= 0),
                    lines::toString);
            assertTrue(lines.stream().allMatch(line -> line.timeMillis() >= before));
            assertTrue(lines.stream().allMatch(
                    line -> line.timeMillis() <= System.currentTimeMillis()));
            assertFalse(lines.stream().allMatch(line -> line.tag().isEmpty()));
            assertFalse(has(reader.read(), "setUnLockPin"));
            assertEquals(0, reader.getLostCount());
        }
        player.close();
    }

    @Test
    void eachReaderHasLinesOfItsOwn() {
        try (var one = new LogReader()) {
            player.engine().unlock(1);
            try (var other = new LogReader()) {
                player.engine().unlock(2);
                assertTrue(has(other.read(), "setUnLockPin"));
            }
            player.engine().unlock(3);
            long lines =
                    one.read().stream()
                            .filter(line -> line.text().contains("setUnLockPin: nothing"))
                            .count();
            assertEquals(3, lines);
        }
        player.close();
    }

    @Test
    void theOldestLinesGoFirst() {
        try (var reader = new LogReader()) {
            player.engine().setTransportStream(5);
            while (reader.getLostCount() < 100) {
                player.engine().unlock(1);
            }
            List<LogReader.Line> lines = reader.read();
            assertTrue(lines.size() <= ROOM && lines.size() > ROOM / 2, "" + lines.size());
            assertFalse(has(lines, "setTS"), "the first ones are lost");
            assertTrue(has(lines, "setUnLockPin"));
        }
        player.close();
    }

    @Test
    void manyThreadsMayLogReadAndClose() throws Exception {
        List<Thread> threads = new ArrayList<>();
        for (int i = 0; i < 4; i++) {
            threads.add(new Thread(() -> {
                for (int j = 0; j < 200; j++) {
                    try (var reader = new LogReader()) {
                        player.engine().unlock(1);
                        assertTrue(has(reader.read(), "setUnLockPin"));
                    }
                }
            }));
        }
        List<Throwable> failures = new ArrayList<>();
        threads.forEach(thread -> thread.setUncaughtExceptionHandler((of, e) -> failures.add(e)));
        threads.forEach(Thread::start);
        for (Thread thread : threads) {
            thread.join(Wait.LIMIT.toMillis());
            assertFalse(thread.isAlive());
        }
        assertEquals(List.of(), failures);
        player.close();
    }

    @Test
    void aClosedReaderHasNoLines() {
        var reader = new LogReader();
        player.engine().unlock(1);
        reader.close();
        reader.close();
        assertEquals(List.of(), reader.read());
        assertEquals(0, reader.getLostCount());
        player.close();
    }
}
