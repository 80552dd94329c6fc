// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CompletionException;

/**
 * The player's native libraries, more than two hundred with those that they need: they are loaded on
 * a thread of their own while Java reads the arguments and, for a window, sets up the display.
 */
final class NativeHalf {
    private static volatile CompletableFuture<Void> loading =
            CompletableFuture.completedFuture(null);

    private NativeHalf() {}

    /** Returns at once. A program that never calls this loads them with its first player. */
    static void beginLoading() {
        CompletableFuture<Void> ended = new CompletableFuture<>();
        Thread thread = new Thread(() -> load(ended), "native libraries");
        thread.setDaemon(true);
        loading = ended;
        linkBeforehand();
        thread.start();
    }

    /** Waits until loading has ended, in whatever way: libraries are not to go while others come. */
    static void endLoading() {
        loading.handle((nothing, problem) -> null).join();
    }

    /**
     * A player, once the libraries are loaded, for which this waits.
     *
     * @throws UnsatisfiedLinkError when they cannot be
     */
    static OrvMediaPlayer newPlayer() {
        try {
            loading.join();
        } catch (CompletionException e) {
            if (e.getCause() instanceof Error problem) {
                throw problem;
            }
            throw e;
        }
        return new OrvMediaPlayer();
    }

    // The first call of a native method is linked under the lock that is held while libraries are
    // loaded: what reading the arguments calls of Java's own would wait for all of them. That is
    // what the first exception needs, and the first lambda without a variable and with one, as the
    // thread's.
    private static void linkBeforehand() {
        new Throwable().fillInStackTrace();
        Runnable nothing = () -> {};
        nothing.run();
    }

    private static void load(CompletableFuture<Void> ended) {
        try {
            Class.forName(OrvMediaPlayer.class.getName());
            ended.complete(null);
        } catch (ClassNotFoundException | LinkageError e) {
            ended.completeExceptionally(e);
        }
    }
}
