// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** Ends a playback cleanly when the program is asked to stop, by Ctrl-C or otherwise. */
public final class Interruption implements AutoCloseable {
    /** What a shell says of a program that Ctrl-C ended. */
    public static final int EXIT_STATUS = 130;

    private final Thread hook;
    private volatile boolean happened;

    /** The last words come after the session is closed. */
    public Interruption(Session session, Runnable lastWords) {
        hook =
                new Thread(
                        () -> {
                            happened = true;
                            session.close();
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
