// SPDX-License-Identifier: Apache-2.0
package android.os;

/**
 * A thread with a {@link Looper}: start it, then make a {@link Handler} of {@link #getLooper()}. It
 * keeps the virtual machine running until it quits.
 */
public class HandlerThread extends Thread {
    private Looper mLooper;

    /**
     * Makes a thread, which is not started.
     *
     * @param name the thread's
     */
    public HandlerThread(String name) {
        super(name);
    }

    /** Called on the thread before it does its first work; here it does nothing. */
    protected void onLooperPrepared() {}

    @Override
    public void run() {
        Looper.prepare();
        synchronized (this) {
            mLooper = Looper.myLooper();
            notifyAll();
        }
        onLooperPrepared();
        Looper.loop();
    }

    /**
     * The thread's looper; waits for it while the thread starts.
     *
     * @return null if the thread was not started or has ended
     */
    public synchronized Looper getLooper() {
        boolean interrupted = false;
        while (isAlive() && mLooper == null) {
            try {
                wait();
            } catch (InterruptedException e) {
                interrupted = true;
            }
        }
        if (interrupted) {
            Thread.currentThread().interrupt();
        }
        return isAlive() ? mLooper : null;
    }

    /**
     * Ends the thread after the work under way; see {@link Looper#quit()}.
     *
     * @return false if it was not running
     */
    public boolean quit() {
        Looper looper = getLooper();
        if (looper != null) {
            looper.quit();
        }
        return looper != null;
    }

    /**
     * Ends the thread once the work that was posted so far is done; see
     * {@link Looper#quitSafely()}.
     *
     * @return false if it was not running
     */
    public boolean quitSafely() {
        Looper looper = getLooper();
        if (looper != null) {
            looper.quitSafely();
        }
        return looper != null;
    }
}
