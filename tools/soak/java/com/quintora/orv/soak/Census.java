// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.Map;
import java.util.TreeMap;
import java.util.regex.Pattern;
import java.util.stream.Collectors;
import java.util.stream.Stream;

/** How many threads and open files of each name the process has, as an object of JSON. */
final class Census {
    private static final Pattern NUMBERS = Pattern.compile("[0-9]+");
    private static final Pattern NOT_PLAIN = Pattern.compile("[\"\\\\\\p{Cntrl}]");

    private Census() {}

    static String ofThreads() throws IOException {
        return count(Path.of("/proc/self/task"),
                task -> Files.readString(task.resolve("comm")).strip());
    }

    static String ofDescriptors() throws IOException {
        return count(Path.of("/proc/self/fd"),
                descriptor -> Files.readSymbolicLink(descriptor).toString());
    }

    /** Finds out what something of the process is called. */
    private interface Name {
        String of(Path entry) throws IOException;
    }

    private static String count(Path folder, Name name) throws IOException {
        List<Path> entries;
        try (Stream<Path> list = Files.list(folder)) {
            entries = list.toList();
        }
        Map<String, Integer> counts = new TreeMap<>();
        for (Path entry : entries) {
            try {
                counts.merge(plain(name.of(entry)), 1, Integer::sum);
            } catch (IOException e) {
                continue; // It is gone meanwhile.
            }
        }
        return counts.entrySet().stream()
                .map(count -> "\"" + count.getKey() + "\": " + count.getValue())
                .collect(Collectors.joining(", ", "{", "}"));
    }

    /** Names that differ by a number alone are one. */
    private static String plain(String name) {
        return NUMBERS.matcher(NOT_PLAIN.matcher(name).replaceAll("?")).replaceAll("N");
    }
}
