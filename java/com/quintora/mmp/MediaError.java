// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.Arrays;

/** Why media cannot be opened, read or played, and what to do about it. */
public enum MediaError {
    /** The address names a host that is not known. */
    UNKNOWN_HOST(-1002, "check the spelling of the host's name, and the network"),
    /** The server refuses the connection. */
    CANNOT_CONNECT(-1003, "check the address and its port, and whether the server runs"),
    /** The source could not be opened or read. */
    IO(-1004, "check whether the source is readable; the exception's cause may say more"),
    /** The connection broke. */
    CONNECTION_LOST(-1005, "try again; reset and prepare anew, and seek to where it broke"),
    /** Unknown format. */
    MALFORMED(-1007, "check whether it is media at all; `orv info` describes what it is"),
    /** A known format without a track that the engine can play. */
    UNSUPPORTED(-1010, "convert its tracks to codecs that the engine has"),
    /** Addresses of this scheme are not opened. */
    SCHEME(-1101, "use a file, http or https, or feed the bytes by a MediaStreamSource"),
    /** Media that lead to a local file and must not, as those from a server. */
    LOCAL_REFERENCE(-1102, "download a playlist that names local files, and play it from there"),
    /** The server does not answer in time. */
    NO_ANSWER(-1103, "try again later"),
    /** The server redirects without end. */
    REDIRECTS(-1104, "find the media's final address"),
    /** The server's certificate is not trusted. */
    CERTIFICATE(-1105, "add the server's authority to the system's trusted ones"),
    /** The server sends less than it announces. */
    CUT_SHORT(-1106, "try again; if it stays so, the server's file is incomplete"),
    /** A format that needs byte ranges, which the server does not have. */
    NEEDS_RANGES(-1107, "download the file first, or move its index to its start"),
    /** Not a single byte. */
    EMPTY(-1108, "check what wrote the file"),
    /** A known format in which nothing can be played. */
    NOTHING_INSIDE(-1200, "get the file anew: it is empty, cut short or damaged"),
    /** An HTTP status other than success, see {@link MediaException#httpStatus()}. */
    HTTP(-2000, "check the address and the right to read it"),
    /** The media was not ready in time. */
    TIMED_OUT(-110, "try again"),
    /** No such file. */
    NOT_FOUND(-2, "check the path"),
    /** A value that is not acceptable: a directory, a closed descriptor, a negative offset. */
    BAD_VALUE(-22, "check what was given as the source"),
    /** Reset or released while the media was being opened. */
    ABORTED(Integer.MIN_VALUE, "nothing: the program asked for it"),
    /** A status of the engine's own, or none. */
    UNKNOWN(Integer.MIN_VALUE, "run with ORV_LOG=info and read the native log");

    private static final int HUNDRED = 100;
    private static final int THOUSAND = 1000;
    private static final int LOWEST_FAILURE = 400;

    private final int status;
    private final String advice;

    MediaError(int status, String advice) {
        this.status = status;
        this.advice = advice;
    }

    /**
     * The error of an engine's status.
     *
     * @param status negative
     * @return the error; {@link #UNKNOWN} for a status without one
     */
    public static MediaError of(int status) {
        if (status <= NOTHING_INSIDE.status && status > NOTHING_INSIDE.status - HUNDRED) {
            return NOTHING_INSIDE;
        }
        if (status <= HTTP.status - LOWEST_FAILURE && status > HTTP.status - THOUSAND) {
            return HTTP;
        }
        return Arrays.stream(values())
                .filter(error -> error.status == status && error != ABORTED)
                .findFirst()
                .orElse(UNKNOWN);
    }

    /**
     * The engine's status, for {@link #HTTP} and {@link #NOTHING_INSIDE} the first of several.
     *
     * @return negative; {@link Integer#MIN_VALUE} where the engine has none
     */
    public int status() {
        return status;
    }

    /**
     * What a user can do about it.
     *
     * @return a sentence without capital and full stop
     */
    public String advice() {
        return advice;
    }
}
