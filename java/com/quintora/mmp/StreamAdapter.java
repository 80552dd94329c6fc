// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.util.concurrent.atomic.AtomicBoolean;

/**
 * A program's stream source as the native half calls it: counts instead of exceptions, seek types
 * instead of positions. Nothing that the source throws reaches native code; it is remembered.
 */
final class StreamAdapter {
    private static final int FAILED = -1;
    private static final int END = 0;

    // Where an offset counts from.
    private static final int SEEK_SET = 0;
    private static final int SEEK_CUR = 1;
    private static final int SEEK_END = 2;

    // The kind of seeking that every source with positions can do.
    private static final int SEEKS_BY_BYTES = 0;

    // The native half carries 32 bits of a size, all set for an unknown one.
    private static final long SIZE_LIMIT = 0xFFFF_FFFFL;

    private final MediaStreamSource source;
    private OrvMediaPlayer player;
    private long size;
    private long position;
    private final AtomicBoolean closed = new AtomicBoolean();
    private volatile boolean reading;
    private volatile boolean cancelled;
    private volatile Throwable failure;

    StreamAdapter(MediaStreamSource source) {
        this.source = source;
    }

    /** Stands in where a player has no source: an empty one. */
    static StreamAdapter none() {
        return new StreamAdapter(new EmptySource());
    }

    /** Writes the fields of the player that the native half reads. */
    void describeTo(OrvMediaPlayer player) throws MediaException {
        this.player = player;
        try {
            size = source.size();
            player.mStreamSize = size > 0 && size < SIZE_LIMIT ? size : 0;
            player.mStreamCurPos = 0;
            player.mStreamSeekable = source.isSeekable();
            player.mStallingSupport = source.mayStall();
            player.mStreamDuration = source.durationMillis();
            player.mDataSourceType = 0;
        } catch (IOException | RuntimeException e) {
            throw new MediaException(
                    "the stream source cannot describe itself: " + e, MediaException.STATUS_IO, e);
        }
    }

    /** The count of bytes put into the player's buffer, END or FAILED. */
    synchronized int read(int length) {
        cancelled = false;
        reading = true;
        try {
            int count = closed.get() || length <= 0 ? END : source.read(buffer(length), length);
            if (count < -1 || count > length) {
                throw new IOException("the source read " + count + " bytes of " + length);
            }
            moveTo(position + Math.max(count, 0));
            return Math.max(count, END);
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
            return FAILED;
        } finally {
            reading = false;
        }
    }

    /** Whether the source is being read just now, as it is while it keeps the engine waiting. */
    boolean isReading() {
        return reading;
    }

    /** The new position, or FAILED. */
    synchronized long seek(int type, long offset) {
        long target = switch (type) {
            case SEEK_SET -> offset;
            case SEEK_CUR -> position + offset;
            case SEEK_END -> size < 0 ? FAILED : size + offset;
            default -> FAILED;
        };
        if (target == position) {
            return position;
        }
        if (target < 0 || closed.get()) {
            return FAILED;
        }
        try {
            if (!source.isSeekable()) {
                return FAILED;
            }
            source.seek(target);
            return moveTo(target);
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
            return FAILED;
        }
    }

    synchronized long seekTime(long first, long second) {
        try {
            long target = closed.get() ? FAILED : source.seekTime(first, second);
            return target < 0 ? FAILED : moveTo(target);
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
            return FAILED;
        }
    }

    int seekType() {
        try {
            return source.seekType();
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
            return SEEKS_BY_BYTES;
        }
    }

    // Not synchronized: it ends a read that holds the lock.
    void cancel() {
        cancelled = true;
        try {
            source.cancel();
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
        }
    }

    // Not synchronized either: a read that ignores its cancellation may hold the lock.
    void close() {
        if (closed.getAndSet(true)) {
            return;
        }
        try {
            source.close();
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
        }
    }

    /** The first thing that the source threw, or null, but for reads that were cancelled. */
    Throwable failure() {
        return failure;
    }

    private void remember(Throwable thrown) {
        if (!cancelled && failure == null) {
            failure = thrown;
        }
    }

    private byte[] buffer(int length) {
        if (player.mStreamReadBuffer == null || player.mStreamReadBuffer.length < length) {
            player.mStreamReadBuffer = new byte[length];
        }
        return player.mStreamReadBuffer;
    }

    private long moveTo(long newPosition) {
        position = newPosition;
        if (player != null) {
            player.mStreamCurPos = newPosition;
        }
        return newPosition;
    }

    private static final class EmptySource implements MediaStreamSource {
        @Override
        public int read(byte[] buffer, int length) {
            return END;
        }

        @Override
        public void seek(long position) throws IOException {
            throw new IOException("there is no source");
        }

        @Override
        public long size() {
            return 0;
        }
    }
}
