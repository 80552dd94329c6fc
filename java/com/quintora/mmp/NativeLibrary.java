// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** Finds the native half. */
final class NativeLibrary {
    private static final String NAME = "mediaplayer_orv";

    private NativeLibrary() {}

    static void load() {
        try {
            System.loadLibrary(NAME);
        } catch (UnsatisfiedLinkError e) {
            UnsatisfiedLinkError told = new UnsatisfiedLinkError(
                    "the player's native library " + System.mapLibraryName(NAME)
                            + " did not load from java.library.path="
                            + System.getProperty("java.library.path") + ": " + e.getMessage());
            told.initCause(e);
            throw told;
        }
    }
}
