// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.platform.internal;

import java.lang.reflect.InvocationTargetException;

/** Loads the native half of the desktop's android classes. */
public final class PlatformLibrary {
    private static final String NAME = "orv_platform";
    /** By its name, as the player's classes need these and not the other way round. */
    private static final String LOADER = "com.quintora.mmp.internal.natives.NativeLibrary";

    private PlatformLibrary() {}

    /**
     * Loads it from java.library.path or else, where the player's classes are, in the way that they
     * load theirs.
     *
     * @throws UnsatisfiedLinkError when neither has it
     */
    public static void load() {
        try {
            System.loadLibrary(NAME);
        } catch (UnsatisfiedLinkError e) {
            loadAsThePlayerDoes(e);
        }
    }

    private static void loadAsThePlayerDoes(UnsatisfiedLinkError otherwise) {
        try {
            Class.forName(LOADER).getMethod("load", String.class).invoke(null, NAME);
        } catch (InvocationTargetException e) {
            throw e.getCause() instanceof UnsatisfiedLinkError reasons ? reasons : otherwise;
        } catch (ReflectiveOperationException e) {
            throw otherwise;
        }
    }
}
