// SPDX-License-Identifier: Apache-2.0
package android.os;

import java.util.Objects;

/**
 * Gives work to the thread of a {@link Looper}, which does it in order. Thread-safe, and nothing
 * blocks. Messages and delays of the platform are not here.
 */
public class Handler {
    private final Looper mLooper;

    /**
     * Makes a handler.
     *
     * @param looper whose thread does the work
     * @throws NullPointerException for null
     */
    public Handler(Looper looper) {
        mLooper = Objects.requireNonNull(looper, "looper");
    }

    /**
     * The looper whose thread does the work.
     *
     * @return that of the constructor, never null
     */
    public final Looper getLooper() {
        return mLooper;
    }

    /**
     * Adds work to the queue.
     *
     * @param r is run once on the looper's thread
     * @return false if it will not be run, because the looper quits
     * @throws NullPointerException for null
     */
    public final boolean post(Runnable r) {
        return mLooper.post(Objects.requireNonNull(r, "r"));
    }
}
