// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** Ends a playback cleanly when the program is asked to stop, by Ctrl-C or otherwise. */
public final class Interruption implements AutoCloseable {
    /** What a shell says of a program that Ctrl-C ended. */
    public static final int EXIT_STATUS = 130;

    private final Thread hook;
    private volatile boolean happened;

    /** The end releases what plays; the last words come after it. */
    public Interruption(Runnable end, Runnable lastWords) {
        hook =
                new Thread(
                        () -> {
                            happened = true;
                            end.run();
                            lastWords.run();
                        },
                        "interruption");
        Runtime.getRuntime().addShutdownHook(hook);
    }

    /** Whether the program is being stopped: what fails then is no failure. */
    public boolean happened() {
        return happened;
    }

    /** Nothing is left to end. */
    @Override
    public void close() {
        try {
            Runtime.getRuntime().removeShutdownHook(hook);
        } catch (IllegalStateException e) {
            // The program is being stopped at this moment, and the hook does its work.
        }
    }
}
