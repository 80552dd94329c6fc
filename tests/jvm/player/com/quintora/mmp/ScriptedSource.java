// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.util.concurrent.Semaphore;
import java.util.concurrent.atomic.AtomicInteger;

/** A stream source over bytes in memory that can be made to misbehave. */
public class ScriptedSource implements MediaStreamSource {
    /** What a read does instead of reading. */
    public interface Misread {
        int read(byte[] buffer, int length) throws IOException;
    }

    public final byte[] bytes;
    public final AtomicInteger reads = new AtomicInteger();
    public final AtomicInteger cancels = new AtomicInteger();
    public final AtomicInteger closes = new AtomicInteger();
    public final Semaphore blockedReads = new Semaphore(0);
    public volatile boolean seekable = true;
    public volatile boolean failsToSeek;
    public volatile boolean sizeKnown = true;
    public volatile Misread misread;
    public volatile int misreadFrom = Integer.MAX_VALUE;
    private int position;

    public ScriptedSource(byte[] bytes) {
        this.bytes = bytes;
    }

    /** From that position on, reads do something else. */
    public ScriptedSource misreading(int from, Misread instead) {
        misreadFrom = from;
        misread = instead;
        return this;
    }

    @Override
    public synchronized int read(byte[] buffer, int length) throws IOException {
        reads.incrementAndGet();
        if (position >= misreadFrom) {
            return misread.read(buffer, length);
        }
        int count = Math.min(length, Math.min(bytes.length, misreadFrom) - position);
        System.arraycopy(bytes, position, buffer, 0, count);
        position += count;
        return count == 0 ? -1 : count;
    }

    @Override
    public synchronized void seek(long target) throws IOException {
        if (failsToSeek) {
            throw new IOException("the reel is stuck");
        }
        position = (int) Math.min(target, bytes.length);
    }

    @Override
    public long size() {
        return sizeKnown ? bytes.length : -1;
    }

    @Override
    public boolean isSeekable() {
        return seekable;
    }

    @Override
    public void cancel() {
        cancels.incrementAndGet();
        blockedReads.release();
    }

    @Override
    public void close() {
        closes.incrementAndGet();
    }

    /** A misread that blocks until it is cancelled. */
    public int block(byte[] buffer, int length) throws IOException {
        blockedReads.acquireUninterruptibly();
        throw new IOException("cancelled");
    }
}
