// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.ChannelStreamSource;
import com.quintora.mmp.MediaStreamSource;
import java.io.FileDescriptor;
import java.io.FileInputStream;
import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.channels.FileChannel;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.nio.file.StandardOpenOption;

/** Media that can be read only once, from the start on: standard input, pipes and sockets. */
final class StandardInput {
    private static final String NAME = "-";
    private static final String PATH = "/dev/stdin";

    // Of the mode in stat(2).
    private static final int FILE_TYPE = 0170000;
    private static final int PIPE = 0010000;
    private static final int SOCKET = 0140000;
    private static final int CHARACTER_DEVICE = 0020000;

    private static final int COPY_BYTES = 64 * 1024;

    private StandardInput() {}

    /** Whether that is how commands call standard input. */
    static boolean isNamed(String source) {
        return NAME.equals(source);
    }

    /** The path of what is named; a redirected file is as good as any other. */
    static String path(String source) {
        return isNamed(source) ? PATH : source;
    }

    /** Whether only its bytes in their order can be had. False for what is no path. */
    static boolean isPipe(String source) {
        try {
            int mode = (int) Files.getAttribute(Path.of(path(source)), "unix:mode");
            return switch (mode & FILE_TYPE) {
                case PIPE, SOCKET, CHARACTER_DEVICE -> true;
                default -> false;
            };
        } catch (IOException | InvalidPathException e) {
            return false;
        }
    }

    /** What is read while it plays. */
    static MediaStreamSource streamed(String source) throws IOException {
        return new PipeSource(open(source));
    }

    /**
     * What can be sought, because all of it is read into a temporary file first, which blocks.
     * Nothing is left of that file when the source is closed or the program ends.
     */
    static MediaStreamSource kept(String source) throws IOException {
        Path file = Files.createTempFile("orv-", null);
        FileChannel kept =
                FileChannel.open(
                        file,
                        StandardOpenOption.READ,
                        StandardOpenOption.WRITE,
                        StandardOpenOption.DELETE_ON_CLOSE);
        try (FileChannel pipe = open(source)) {
            copy(pipe, kept);
            return new ChannelStreamSource(kept.position(0));
        } catch (IOException e) {
            kept.close();
            throw e;
        }
    }

    // The streams of Java 21 ask a pipe for its position when they copy, and fail.
    private static void copy(FileChannel from, FileChannel to) throws IOException {
        ByteBuffer buffer = ByteBuffer.allocateDirect(COPY_BYTES);
        while (from.read(buffer) >= 0) {
            buffer.flip();
            while (buffer.hasRemaining()) {
                to.write(buffer);
            }
            buffer.clear();
        }
    }

    // A socket cannot be opened by a path.
    private static FileChannel open(String source) throws IOException {
        return isNamed(source)
                ? new FileInputStream(FileDescriptor.in).getChannel()
                : FileChannel.open(Path.of(source), StandardOpenOption.READ);
    }
}
