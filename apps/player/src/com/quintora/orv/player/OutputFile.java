// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.file.AccessDeniedException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.StandardCopyOption;
import java.nio.file.StandardOpenOption;

/** Where a command writes what it makes: a file, whole or not at all, or standard output. */
final class OutputFile {
    private static final Path STANDARD_OUTPUT = Path.of("-");

    private OutputFile() {}

    static boolean isStandardOutput(Path file) {
        return STANDARD_OUTPUT.equals(file);
    }

    /** Writes all of it. A file that was there stays as it was when that fails. */
    static void write(Path file, byte[] content) throws Failure {
        try {
            if (isStandardOutput(file)) {
                // Main looks whether it could be written.
                System.out.write(content, 0, content.length);
            } else if (Files.exists(file) && !Files.isRegularFile(file)) {
                Files.write(file, content);
            } else {
                replace(target(file), content);
            }
        } catch (IOException e) {
            throw Failure.writing(file, e);
        }
    }

    // A link stays one: what it leads to is replaced.
    private static Path target(Path file) throws IOException {
        return Files.isSymbolicLink(file) && Files.exists(file)
                ? file.toRealPath()
                : file.toAbsolutePath();
    }

    private static void replace(Path file, byte[] content) throws IOException {
        Path draft = file.resolveSibling(".orv-" + ProcessHandle.current().pid() + ".part");
        try {
            Files.write(draft, content, StandardOpenOption.CREATE_NEW, StandardOpenOption.WRITE);
            if (Files.exists(file)) {
                Files.setPosixFilePermissions(draft, Files.getPosixFilePermissions(file));
            }
            Files.move(draft, file, StandardCopyOption.ATOMIC_MOVE);
        } catch (AccessDeniedException e) {
            // A file of a folder in which none can be made may be written all the same.
            if (!Files.isWritable(file)) {
                throw e;
            }
            Files.write(file, content);
        } finally {
            Files.deleteIfExists(draft);
        }
    }
}
