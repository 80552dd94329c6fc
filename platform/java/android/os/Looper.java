// SPDX-License-Identifier: Apache-2.0
package android.os;

import java.util.ArrayDeque;
import java.util.Queue;

/**
 * The queue of work of one thread, which gives it work through a {@link Handler}. All methods but
 * {@link #prepare}, {@link #loop} and {@link #myLooper} may be called from any thread. There is no
 * main looper on the desktop.
 */
public final class Looper {
    private static final ThreadLocal<Looper> CURRENT = new ThreadLocal<>();

    private final Thread mThread = Thread.currentThread();
    private final Queue<Runnable> mWork = new ArrayDeque<>();
    private boolean mQuits;

    private Looper() {}

    /**
     * Gives the calling thread a looper.
     *
     * @throws RuntimeException if it has one
     */
    public static void prepare() {
        if (CURRENT.get() != null) {
            throw new RuntimeException("Only one Looper may be created per thread");
        }
        CURRENT.set(new Looper());
    }

    /**
     * Does the calling thread's work, in order, until its looper quits; waits while there is none.
     * What a piece of work throws leaves this method.
     *
     * @throws RuntimeException if the thread has no looper
     */
    public static void loop() {
        Looper looper = myLooper();
        if (looper == null) {
            throw new RuntimeException("No Looper; Looper.prepare() wasn't called on this thread.");
        }
        for (Runnable next = looper.take(); next != null; next = looper.take()) {
            next.run();
        }
    }

    /**
     * The calling thread's looper.
     *
     * @return null when it has none
     */
    public static Looper myLooper() {
        return CURRENT.get();
    }

    /**
     * The thread whose work this is.
     *
     * @return the thread that called {@link #prepare}
     */
    public Thread getThread() {
        return mThread;
    }

    /**
     * Whether the calling thread is this looper's.
     *
     * @return true on {@link #getThread()}
     */
    public boolean isCurrentThread() {
        return Thread.currentThread() == mThread;
    }

    /** Ends {@link #loop} after the work under way; what waits is never done. Does not block. */
    public synchronized void quit() {
        mWork.clear();
        quitSafely();
    }

    /** Ends {@link #loop} once the work that was posted so far is done. Does not block. */
    public synchronized void quitSafely() {
        mQuits = true;
        notifyAll();
    }

    // Whether the work will be done.
    synchronized boolean post(Runnable work) {
        if (mQuits) {
            return false;
        }
        mWork.add(work);
        notifyAll();
        return true;
    }

    // Null at the end. Interruptions are for the work, which finds them pending.
    private synchronized Runnable take() {
        boolean interrupted = false;
        while (mWork.isEmpty() && !mQuits) {
            try {
                wait();
            } catch (InterruptedException e) {
                interrupted = true;
            }
        }
        if (interrupted) {
            mThread.interrupt();
        }
        return mWork.poll();
    }
}
