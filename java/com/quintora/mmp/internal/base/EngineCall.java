// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import java.io.IOException;

/** A call of the native half. */
@FunctionalInterface
public interface EngineCall {
    /**
     * Calls it.
     *
     * @throws IOException when the native half throws it
     */
    void run() throws IOException;
}
