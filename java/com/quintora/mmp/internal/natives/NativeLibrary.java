// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

/**
 * Finds the native half and loads it: from java.library.path, else from the native JAR on the class
 * path or module path, whose libraries are unpacked into the user's cache.
 */
public final class NativeLibrary {
    static final String PLAYER = "mediaplayer_orv";

    private NativeLibrary() {}

    /**
     * Loads the player's library, for the class whose native methods it registers. Blocks while
     * files are read or written.
     *
     * @throws UnsatisfiedLinkError when there is none that fits; its sentences say what was looked
     *     for, where, and what to do
     */
    public static void load() {
        load(PLAYER);
    }

    /**
     * Loads another library of the native half in the same way.
     *
     * @param name as System.loadLibrary takes it, such as "orv_platform"
     * @throws UnsatisfiedLinkError when there is none that fits
     */
    public static void load(String name) {
        String fileName = System.mapLibraryName(name);
        String onPath = LibraryPath.find(System.getProperty("java.library.path"), fileName);
        if (onPath != null) {
            LibraryCheck.check(onPath, Machine.ofThisVm(), JavaVersion.read());
        }
        // Also without a file on the path: class loaders may know places of their own.
        if (!isLoadedByName(name, onPath)) {
            loadFile(NativeJar.library(fileName).toString());
        }
    }

    private static boolean isLoadedByName(String name, String onPath) {
        try {
            System.loadLibrary(name);
            return true;
        } catch (UnsatisfiedLinkError e) {
            String message = String.valueOf(e.getMessage());
            if (onPath == null && message.startsWith("no " + name + " in ")) {
                return false;
            }
            throw LoadFailures.refused(onPath, null, e);
        }
    }

    private static void loadFile(String file) {
        try {
            System.load(file);
        } catch (UnsatisfiedLinkError e) {
            throw LoadFailures.refused(file, NativeJar.system(), e);
        }
    }
}
