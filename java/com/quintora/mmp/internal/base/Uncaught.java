// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

/** What foreign code throws where it must disturb nothing else. */
public final class Uncaught {
    private Uncaught() {}

    /** Hands it to the thread's uncaught exception handler. */
    public static void report(Throwable thrown) {
        Thread thread = Thread.currentThread();
        try {
            thread.getUncaughtExceptionHandler().uncaughtException(thread, thrown);
        } catch (RuntimeException | Error e) {
            // A handler's own failures are ignored, as the virtual machine does.
        }
    }
}
