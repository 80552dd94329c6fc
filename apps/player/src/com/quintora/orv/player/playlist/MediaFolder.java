// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import java.io.IOException;
import java.nio.file.FileVisitResult;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.SimpleFileVisitor;
import java.nio.file.attribute.BasicFileAttributes;
import java.util.ArrayList;
import java.util.List;
import java.util.Locale;
import java.util.Set;

/** The media files of a folder and the folders in it, in the order of their names. */
final class MediaFolder {
    private static final Set<String> EXTENSIONS =
            Set.of(
                    "3g2", "3gp", "aac", "ac3", "aif", "aiff", "amr", "ape", "asf", "au", "avi",
                    "caf", "divx", "dts", "dv", "eac3", "f4v", "flac", "flv", "gif", "h264",
                    "hevc", "ivf", "m1v", "m2ts", "m2v", "m4a", "m4b", "m4v", "mka", "mkv", "mov",
                    "mp2", "mp3", "mp4", "mpa", "mpc", "mpe", "mpeg", "mpg", "mts", "mxf", "nut",
                    "oga", "ogg", "ogm", "ogv", "opus", "ra", "rm", "rmvb", "spx", "tak", "ts",
                    "tta", "vob", "wav", "webm", "wma", "wmv", "wv", "y4m");

    private MediaFolder() {}

    /** Hidden files and folders, and those that may not be read, are left out. */
    static List<Entry> list(Path folder) throws IOException {
        List<Path> files = new ArrayList<>();
        Files.walkFileTree(folder, new Collector(folder, files));
        files.sort((a, b) -> NaturalOrder.compare(a.toString(), b.toString()));
        return files.stream().map(file -> new Entry(file.toString())).toList();
    }

    private static boolean isMedia(Path file) {
        String name = file.getFileName().toString();
        String extension = name.substring(name.lastIndexOf('.') + 1).toLowerCase(Locale.ROOT);
        return EXTENSIONS.contains(extension);
    }

    private static final class Collector extends SimpleFileVisitor<Path> {
        private final Path root;
        private final List<Path> files;

        Collector(Path root, List<Path> files) {
            this.root = root;
            this.files = files;
        }

        @Override
        public FileVisitResult preVisitDirectory(Path folder, BasicFileAttributes attributes) {
            return folder.equals(root) || !isHidden(folder)
                    ? FileVisitResult.CONTINUE
                    : FileVisitResult.SKIP_SUBTREE;
        }

        @Override
        public FileVisitResult visitFile(Path file, BasicFileAttributes attributes) {
            if (isMedia(file) && !isHidden(file) && Files.isRegularFile(file)) {
                files.add(file);
            }
            return FileVisitResult.CONTINUE;
        }

        // Only what was asked for has to be readable.
        @Override
        public FileVisitResult visitFileFailed(Path file, IOException problem)
                throws IOException {
            if (file.equals(root)) {
                throw problem;
            }
            return FileVisitResult.CONTINUE;
        }

        @Override
        public FileVisitResult postVisitDirectory(Path folder, IOException problem)
                throws IOException {
            if (problem != null && folder.equals(root)) {
                throw problem;
            }
            return FileVisitResult.CONTINUE;
        }

        private static boolean isHidden(Path path) {
            return path.getFileName().toString().startsWith(".");
        }
    }
}
