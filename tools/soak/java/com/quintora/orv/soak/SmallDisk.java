// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.IOException;
import java.io.OutputStream;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Comparator;
import java.util.List;
import java.util.stream.Stream;

/** The file system with this process's home, caches and temporary files: emptied, then filled. */
final class SmallDisk {
    private static final int MOST = 64 << 20;

    private final Path root;

    SmallDisk(Path root) {
        this.root = root;
    }

    /** Without caches, and without room to make them anew. */
    void fill() throws IOException {
        clear();
        byte[] block = new byte[4096];
        try (OutputStream out = Files.newOutputStream(root.resolve("filler"))) {
            for (int written = 0; written < MOST; written += block.length) {
                out.write(block);
            }
        } catch (IOException e) {
            return; // It is full.
        }
        throw new IOException(root + " has more room than " + MOST + " bytes");
    }

    void clear() throws IOException {
        List<Path> all;
        try (Stream<Path> tree = Files.walk(root)) {
            all = tree.sorted(Comparator.reverseOrder()).toList();
        }
        for (Path path : all) {
            if (!path.equals(root)) {
                Files.deleteIfExists(path);
            }
        }
    }
}
