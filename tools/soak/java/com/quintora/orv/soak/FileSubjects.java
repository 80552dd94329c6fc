// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaPlayer;
import java.io.FileInputStream;
import java.io.IOException;
import java.nio.channels.FileChannel;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.StandardOpenOption;
import java.util.Arrays;
import java.util.EnumSet;
import java.util.Random;

/** Media in files: whole, damaged, and such that vanish or shrink. */
final class FileSubjects {
    /** A file's first bytes, which name its format. */
    private static final int HEAD = 64;

    private final Path folder;

    FileSubjects(Path folder) {
        this.folder = folder;
    }

    static Subject whole(Path media) {
        return new Subject("file", media.getFileName().toString(), Expectation.WELL) {
            @Override
            void open(MediaPlayer player) throws IOException {
                player.setDataSource(media);
            }
        };
    }

    /** Without a fault, but judged as if there were one. */
    static Subject takenForEmpty(Path media) {
        return new OwnFile("taken for empty", media, Expectation.opening(MediaError.EMPTY)) {
            @Override
            public void close() {}
        };
    }

    static Subject descriptor(Path media) {
        return new Subject("descriptor", media.getFileName().toString(), Expectation.WELL) {
            @Override
            void open(MediaPlayer player) throws IOException {
                try (FileInputStream file = new FileInputStream(media.toFile())) {
                    player.setDataSource(file.getFD());
                }
            }
        };
    }

    static Subject missing(Path folder) {
        return new OwnFile("missing", folder.resolve("missing.mkv"),
                Expectation.opening(MediaError.NOT_FOUND));
    }

    /** Some bytes differ, one in 200 up to 20,000. */
    Subject damaged(int cycle, Path media, Random random) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        int flips = 1 + bytes.length / (200 * (1 + random.nextInt(100)));
        for (int i = 0; i < flips; i++) {
            bytes[random.nextInt(bytes.length)] ^= (byte) (1 << random.nextInt(8));
        }
        return new OwnFile("damaged", write(cycle, media, bytes, bytes.length),
                Expectation.perhaps(Expectation.DAMAGE));
    }

    Subject truncated(int cycle, Path media, Random random) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        return new OwnFile("truncated", write(cycle, media, bytes,
                HEAD + random.nextInt(bytes.length - HEAD)),
                Expectation.perhaps(Expectation.DAMAGE));
    }

    Subject empty(int cycle, Path media) throws IOException {
        return new OwnFile("empty", write(cycle, media, new byte[0], 0),
                Expectation.opening(MediaError.EMPTY));
    }

    Subject noise(int cycle, Path media, Random random) throws IOException {
        byte[] bytes = new byte[1 + random.nextInt(100)];
        random.nextBytes(bytes);
        return new OwnFile("noise", write(cycle, media, bytes, bytes.length),
                new Expectation(Expectation.Notice.OPENING, Expectation.DAMAGE));
    }

    /** Removed after it was set and before it is opened. */
    Subject gone(int cycle, Path media) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        return new OwnFile("gone", write(cycle, media, bytes, bytes.length),
                Expectation.opening(MediaError.NOT_FOUND, MediaError.IO)) {
            @Override
            void open(MediaPlayer player) throws IOException {
                super.open(player);
                Files.delete(file);
            }
        };
    }

    /** Removed while it plays; what is open stays, but it is not opened again. */
    Subject vanishing(int cycle, Path media) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        return new OwnFile("vanishing", write(cycle, media, bytes, bytes.length),
                Expectation.perhaps(EnumSet.of(MediaError.NOT_FOUND, MediaError.IO))) {
            @Override
            void disturb() throws IOException {
                Files.deleteIfExists(file);
            }
        };
    }

    /** Cut while it plays. */
    Subject shrinking(int cycle, Path media, Random random) throws IOException {
        byte[] bytes = Files.readAllBytes(media);
        int rest = random.nextInt(bytes.length);
        return new OwnFile("shrinking", write(cycle, media, bytes, bytes.length),
                Expectation.perhaps(Expectation.DAMAGE)) {
            @Override
            void disturb() throws IOException {
                try (FileChannel channel = FileChannel.open(file, StandardOpenOption.WRITE)) {
                    channel.truncate(rest);
                }
            }
        };
    }

    private Path write(int cycle, Path media, byte[] bytes, int length) throws IOException {
        Path file = folder.resolve(cycle + "-" + media.getFileName());
        Files.write(file, Arrays.copyOf(bytes, length));
        return file;
    }

    /** A file of the cycle's own, by its path. */
    private static class OwnFile extends Subject {
        final Path file;

        OwnFile(String kind, Path file, Expectation expectation) {
            super(kind, file.getFileName().toString(), expectation);
            this.file = file;
        }

        @Override
        void open(MediaPlayer player) throws IOException {
            player.setDataSource(file);
        }

        @Override
        public void close() throws IOException {
            Files.deleteIfExists(file);
        }
    }
}
