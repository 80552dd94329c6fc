// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.file.AccessDeniedException;
import java.nio.file.FileSystemException;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;

/** A failure that one sentence explains to the user; the message is that sentence. */
public final class Failure extends Exception {
    public Failure(String message) {
        super(message);
    }

    public Failure(String message, Throwable cause) {
        super(message, cause);
    }

    /**
     * A time that the media does not have.
     *
     * @param durationMs where the media ends, in milliseconds
     * @param what what comes after that
     */
    static Failure endsBefore(String source, int durationMs, String what) {
        return new Failure(
                "'" + source + "' ends at " + Times.clock(durationMs) + ", before " + what);
    }

    /** A file that cannot be written. */
    public static Failure writing(Path file, IOException cause) {
        String reason = cause.getMessage();
        if (cause instanceof NoSuchFileException) {
            reason = "its folder does not exist";
        } else if (cause instanceof AccessDeniedException) {
            reason = "that is not allowed";
        } else if (cause instanceof FileSystemException e && e.getReason() != null) {
            reason = e.getReason();
        }
        return new Failure("cannot write '" + file + "': " + reason, cause);
    }
}
