// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.util.OptionalInt;
import org.jetbrains.annotations.Nullable;

/** Media cannot be opened, read or played. The message says which and why. */
public class MediaException extends IOException {
    private static final long serialVersionUID = 1;

    /** What kind of failure it is. */
    private final MediaError error;

    /** The engine's status. */
    private final int status;

    /**
     * A failure that an engine reports.
     *
     * @param message what happened, in a sentence
     * @param status the engine's status, negative
     * @param cause what was thrown, or null
     */
    public MediaException(String message, int status, @Nullable Throwable cause) {
        this(message, MediaError.of(status), status, cause);
    }

    /**
     * A failure of a kind.
     *
     * @param message what happened, in a sentence
     * @param error the kind
     * @param cause what was thrown, or null
     */
    public MediaException(String message, MediaError error, @Nullable Throwable cause) {
        this(message, error, error.status(), cause);
    }

    private MediaException(
            String message, MediaError error, int status, @Nullable Throwable cause) {
        super(message, cause);
        this.error = error;
        this.status = status;
    }

    /**
     * What kind of failure it is, with advice.
     *
     * @return the kind
     */
    public MediaError error() {
        return error;
    }

    /**
     * The engine's status.
     *
     * @return negative; {@link Integer#MIN_VALUE} when the engine gave none
     */
    public int status() {
        return status;
    }

    /**
     * The status that an HTTP server answered with.
     *
     * @return 400 to 999; empty when it is no {@link MediaError#HTTP} failure
     */
    public OptionalInt httpStatus() {
        return error == MediaError.HTTP && status != MediaError.HTTP.status()
                ? OptionalInt.of(MediaError.HTTP.status() - status)
                : OptionalInt.empty();
    }
}
