// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import org.jetbrains.annotations.Nullable;

/** Checks what programs pass in. */
public final class Arguments {
    private Arguments() {}

    /**
     * The value, if there is one.
     *
     * @param <T> its type
     * @param value the value
     * @param name what to call it in the exception's message
     * @return the value
     * @throws IllegalArgumentException naming the value when it is null
     */
    public static <T> T require(@Nullable T value, String name) {
        if (value == null) {
            throw new IllegalArgumentException(name + " is null");
        }
        return value;
    }
}
