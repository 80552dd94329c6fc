// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;

/** A call of the native half. */
@FunctionalInterface
interface EngineCall {
    void run() throws IOException;
}
