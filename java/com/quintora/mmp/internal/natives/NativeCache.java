// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.nio.file.DirectoryStream;
import java.nio.file.Files;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;
import java.nio.file.StandardCopyOption;
import java.nio.file.StandardOpenOption;
import java.time.Duration;
import java.time.Instant;

/**
 * A folder that native libraries are unpacked into, for each bundle a folder in it. Any number of
 * processes may use it at the same time: a file comes to its name whole, by a rename, and one that
 * is intact is left alone.
 */
final class NativeCache {
    /** Writes a new file. */
    interface Writer {
        void write(Path file, byte[] bytes) throws IOException;
    }

    static final Writer TO_DISK =
            (file, bytes) -> Files.write(file, bytes, StandardOpenOption.CREATE_NEW);

    private static final String UNFINISHED = ".part";
    /** Nobody takes so long to write a file: its writer has ended before it was done. */
    private static final Duration ABANDONED = Duration.ofHours(1);

    private final Path root;
    private final Writer writer;

    NativeCache(Path root, Writer writer) {
        this.root = root;
        this.writer = writer;
    }

    /**
     * Gives the folder with the bundle's libraries, after it has written those that are missing or
     * are not what the bundle's list says. Writes nothing when all are there.
     */
    Path unpack(NativeBundle bundle) throws IOException {
        Path folder = root.resolve(bundle.identity());
        for (NativeBundle.Entry entry : bundle.entries()) {
            if (!isIntact(folder.resolve(entry.name()), entry)) {
                replace(folder, entry.name(), bundle.read(entry));
            }
        }
        return folder;
    }

    private static boolean isIntact(Path file, NativeBundle.Entry entry) {
        try {
            return Files.size(file) == entry.size() && entry.isOf(Files.readAllBytes(file));
        } catch (IOException e) {
            return false;
        }
    }

    private void replace(Path folder, String name, byte[] bytes) throws IOException {
        Files.createDirectories(folder);
        removeAbandoned(folder);
        Path part = folder.resolve(name + "." + ProcessHandle.current().pid() + "-"
                + Long.toHexString(System.nanoTime()) + UNFINISHED);
        try {
            writer.write(part, bytes);
            Files.move(part, folder.resolve(name), StandardCopyOption.ATOMIC_MOVE);
        } finally {
            Files.deleteIfExists(part);
        }
    }

    private static void removeAbandoned(Path folder) throws IOException {
        Instant limit = Instant.now().minus(ABANDONED);
        try (DirectoryStream<Path> parts = Files.newDirectoryStream(folder, "*" + UNFINISHED)) {
            for (Path part : parts) {
                if (Files.getLastModifiedTime(part).toInstant().isBefore(limit)) {
                    Files.deleteIfExists(part);
                }
            }
        } catch (NoSuchFileException e) {
            // Another process has just finished or removed it.
        }
    }
}
