// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.FileAlreadyExistsException;
import java.nio.file.Files;
import java.nio.file.Path;

/** Writes pictures of a media file, named after it and their times. Any thread; calls block. */
public final class Screenshots {
    // A file's name has 255 bytes at most, and time, number and ending come behind this.
    private static final int TITLE_BYTES = 200;

    private final Path folder;
    private final String title;

    /** Into that folder, or the user's folder for pictures when it is null. */
    public Screenshots(Path folder, String source) {
        this.folder = folder;
        title = fileName(MediaName.withoutExtension(source));
    }

    /**
     * Writes a PNG file of a new name. It is there as a whole or not at all.
     *
     * @return where it is
     */
    public Path save(Still still) throws Failure {
        byte[] content = PngFile.encode(still.image());
        Path file = reserve(nameOf(still.timeMs()));
        try {
            OutputFile.write(file, content);
            return file;
        } catch (Failure e) {
            deleteEmpty(file);
            throw e;
        }
    }

    private String nameOf(int millis) {
        int seconds = Math.max(0, millis) / 1000;
        return String.format(
                "%s-%04dh%02dm%02ds%03d",
                title, seconds / 3600, seconds / 60 % 60, seconds % 60, Math.max(0, millis) % 1000);
    }

    // An empty file, which nobody else writes to.
    private Path reserve(String name) throws Failure {
        Path place = folder == null ? PicturesFolder.find() : folder;
        for (int number = 1; ; number++) {
            Path file = place.resolve(name + (number > 1 ? "-" + number : "") + ".png");
            try {
                return Files.createFile(file);
            } catch (FileAlreadyExistsException e) {
                // The next number, then.
            } catch (IOException e) {
                throw Failure.writing(file, e);
            }
        }
    }

    private static void deleteEmpty(Path file) {
        try {
            Files.deleteIfExists(file);
        } catch (IOException e) {
            // It could not be written either, which is what is reported.
        }
    }

    /** What may be in a file's name, of which a leading dot would hide it. */
    private static String fileName(String title) {
        String name = title.replaceAll("[\\p{Cntrl}/\\\\]", "_").replaceFirst("^\\.+", "_").strip();
        while (name.getBytes(StandardCharsets.UTF_8).length > TITLE_BYTES) {
            name = name.substring(0, name.offsetByCodePoints(name.length(), -1));
        }
        return name.isEmpty() ? "video" : name;
    }
}
