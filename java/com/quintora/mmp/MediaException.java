// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;

/** Media could not be opened, read or played. The message says which and why. */
public class MediaException extends IOException {
    private static final long serialVersionUID = 1;

    /** The address names a host that is not known. */
    public static final int STATUS_UNKNOWN_HOST = -1002;

    /** The server refuses the connection. */
    public static final int STATUS_CANNOT_CONNECT = -1003;

    /** The source could not be opened or read. */
    public static final int STATUS_IO = -1004;

    /** The connection broke. */
    public static final int STATUS_CONNECTION_LOST = -1005;

    /** Unknown format. */
    public static final int STATUS_MALFORMED = -1007;

    /** A known format without a track that the engine can play. */
    public static final int STATUS_UNSUPPORTED = -1010;

    /** Addresses of this scheme are not opened. */
    public static final int STATUS_SCHEME = -1101;

    /** Media that lead to a local file and must not, as those from a server. */
    public static final int STATUS_LOCAL_REFERENCE = -1102;

    /** The server does not answer in time. */
    public static final int STATUS_NO_ANSWER = -1103;

    /** The server redirects without end. */
    public static final int STATUS_REDIRECTS = -1104;

    /** The server's certificate is not trusted. */
    public static final int STATUS_CERTIFICATE = -1105;

    /** The server sends less than it announces. */
    public static final int STATUS_CUT_SHORT = -1106;

    /** A format that needs byte ranges, which the server does not have. */
    public static final int STATUS_NEEDS_RANGES = -1107;

    /** Not a single byte. */
    public static final int STATUS_EMPTY = -1108;

    /**
     * A known format in which nothing can be played: this minus the format's number, from 0 to 99.
     */
    public static final int STATUS_NOTHING_INSIDE = -1200;

    /** An HTTP status other than success: this minus that status, as in -2404. */
    public static final int STATUS_HTTP = -2000;

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
