// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.sun.jna.Native;
import com.sun.jna.NativeLibrary;

/** Calls a C function by JNA's quicker way, direct mapping. */
final class JnaWorkload extends Workload {
    static {
        Native.register(JnaWorkload.class, NativeLibrary.getProcess());
    }

    private static native int orv_bench_nothing();

    @Override
    void run(int times) {
        for (int i = 0; i < times; i++) {
            orv_bench_nothing();
        }
    }
}
