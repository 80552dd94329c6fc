// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.stream.Stream;

/** What this process holds of the system. */
final class ProcessCounts {
    private ProcessCounts() {}

    /** How many threads it has that only the engine and its core have. */
    static long engineThreads() throws IOException {
        try (Stream<Path> tasks = Files.list(Path.of("/proc/self/task"))) {
            return tasks.filter(ProcessCounts::isOfTheEngine).count();
        }
    }

    /** How many descriptors are open, with that of this look. */
    static long descriptors() throws IOException {
        try (Stream<Path> open = Files.list(Path.of("/proc/self/fd"))) {
            return open.count();
        }
    }

    private static boolean isOfTheEngine(Path task) {
        try {
            String name = Files.readString(task.resolve("comm")).strip();
            return name.startsWith("orv-") || name.startsWith("mpv") || name.equals("core");
        } catch (IOException e) {
            return false; // It ended just now.
        }
    }
}
