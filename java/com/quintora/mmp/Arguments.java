// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** Checks what programs pass in. */
final class Arguments {
    private Arguments() {}

    /** The value, or an IllegalArgumentException that names it when it is null. */
    static <T> T require(T value, String name) {
        if (value == null) {
            throw new IllegalArgumentException(name + " is null");
        }
        return value;
    }
}
