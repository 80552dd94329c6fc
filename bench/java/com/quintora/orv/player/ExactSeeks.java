// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/**
 * Seeks as the player's window does, to the frame of a time: a program whose arguments are the film
 * and the times in milliseconds. Prints what each took, in milliseconds, a line each.
 */
final class ExactSeeks {
    private ExactSeeks() {}

    public static void main(String[] arguments) throws Failure {
        PlayOptions options = PlayOptions.of(arguments[0]);
        try (Session session = new Session(options, image -> {})) {
            session.open();
            for (int i = 1; i < arguments.length; i++) {
                long begin = System.nanoTime();
                session.seekTo(Integer.parseInt(arguments[i]));
                System.out.println((System.nanoTime() - begin) / 1e6);
            }
        }
    }
}
