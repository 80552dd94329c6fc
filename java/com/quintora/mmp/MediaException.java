// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;

/** Media could not be opened, read or played. The message says which and why. */
public class MediaException extends IOException {
    private static final long serialVersionUID = 1;

    /** The source could not be opened or read. */
    public static final int STATUS_IO = -1004;

    /** No media format that the engine knows. */
    public static final int STATUS_MALFORMED = -1007;

    /** A known format without a track that the engine can play. */
    public static final int STATUS_UNSUPPORTED = -1010;

    /** Something took too long. */
    public static final int STATUS_TIMED_OUT = -110;

    /** No such file. */
    public static final int STATUS_NOT_FOUND = -2;

    /** A value that is not acceptable: a directory, a closed descriptor, a negative offset. */
    public static final int STATUS_BAD_VALUE = -22;

    /** The engine gave no status. */
    public static final int STATUS_UNKNOWN = Integer.MIN_VALUE;

    /** The engine's status. */
    private final int status;

    /**
     * A failure.
     *
     * @param message what happened, in a sentence
     * @param status the engine's status, one of the constants or another negative number
     * @param cause what was thrown, or null
     */
    public MediaException(String message, int status, Throwable cause) {
        super(message, cause);
        this.status = status;
    }

    /**
     * The engine's status.
     *
     * @return one of the constants or another negative number
     */
    public int status() {
        return status;
    }
}
