// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.IOException;
import java.io.UncheckedIOException;
import java.lang.management.ManagementFactory;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Locale;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import java.util.stream.Stream;
import javax.management.JMException;
import javax.management.ObjectName;

/** What the process holds while no player lives, as a line of JSON. */
final class Checkpoint {
    private static final int PAGE = 4096;
    /** How long nothing may have become less for the process to be at rest. */
    private static final long REST_NANOS = 300_000_000L;
    private static final long PAUSE_MILLIS = 20;
    private static final Pattern REFERENCES = Pattern.compile("JNI global refs: (\\d+), weak");

    private Checkpoint() {}

    static String take(int cycles, double seconds, Tally tally) throws Exception {
        int[] least = awaitRest();
        System.gc();
        Runtime runtime = Runtime.getRuntime();
        long heap = runtime.totalMemory() - runtime.freeMemory();
        long references = references();
        NativeMemory.trim();
        return String.format(Locale.ROOT,
                "{\"cycles\": %d, \"seconds\": %.3f, %s, \"rss\": %d, \"native\": %d, \"heap\": %d,"
                        + " \"threads\": %d, \"descriptors\": %d, \"references\": %d,"
                        + " \"thread_names\": %s, \"descriptor_names\": %s}",
                cycles, seconds, tally.takeJson(), residentBytes(), NativeMemory.inUse(), heap,
                least[0], least[1], references, Census.ofThreads(), Census.ofDescriptors());
    }

    /** {threads, descriptors}: the fewest that there are before they stay the same for a while. */
    private static int[] awaitRest() throws InterruptedException {
        int[] least = {Integer.MAX_VALUE, Integer.MAX_VALUE};
        long since = System.nanoTime();
        while (System.nanoTime() - since < REST_NANOS) {
            int[] now = {entries("/proc/self/task"), entries("/proc/self/fd")};
            int[] both = {Math.min(now[0], least[0]), Math.min(now[1], least[1])};
            if (!Arrays.equals(both, least)) {
                least = both;
                since = System.nanoTime();
            }
            Thread.sleep(PAUSE_MILLIS);
        }
        return least;
    }

    private static int entries(String folder) {
        try (Stream<Path> list = Files.list(Path.of(folder))) {
            return (int) list.count();
        } catch (IOException e) {
            throw new UncheckedIOException(e);
        }
    }

    private static long residentBytes() throws IOException {
        String[] fields = Files.readString(Path.of("/proc/self/statm")).split(" ");
        return Long.parseLong(fields[1]) * PAGE;
    }

    /** The virtual machine counts them for its own list of threads alone; -1 if it does not. */
    private static long references() throws JMException {
        Matcher found = REFERENCES.matcher(threads());
        return found.find() ? Long.parseLong(found.group(1)) : -1;
    }

    /** All threads with their stacks and locks, as jstack prints them. */
    static String threads() throws JMException {
        return (String) ManagementFactory.getPlatformMBeanServer().invoke(
                new ObjectName("com.sun.management:type=DiagnosticCommand"), "threadPrint",
                new Object[] {new String[] {"-l"}}, new String[] {String[].class.getName()});
    }
}
