// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

/** What Java cannot ask or do about the process's native memory. */
final class NativeMemory {
    static {
        System.loadLibrary("orv_soak");
    }

    private NativeMemory() {}

    /** Gives free memory back to the system. */
    static native void trim();

    /** The bytes that are allocated now, over all of malloc's arenas and mappings. */
    static native long inUse();

    /** Allocates bytes that nobody frees. */
    static native void leak(int bytes);

    /** Makes a global reference that nobody deletes. */
    static native void leakReference(Object object);

    /** Ends the process by a write to no address. */
    static native void crash();
}
