// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** Something the user can be told in one sentence; the message is that sentence. */
public final class Failure extends Exception {
    private static final long serialVersionUID = 1;

    public Failure(String message) {
        super(message);
    }

    public Failure(String message, Throwable cause) {
        super(message, cause);
    }
}
