// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.source;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.internal.base.SharedFields;
import java.io.IOException;
import java.util.concurrent.atomic.AtomicBoolean;
import org.jetbrains.annotations.Nullable;

/**
 * A program's stream source as the native half calls it: counts instead of exceptions, seek types
 * instead of positions. Nothing that the source throws reaches native code; it is remembered.
 */
public final class StreamAdapter {
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
    private final SharedFields fields;
    private long size;
    private long position;
    private final AtomicBoolean closed = new AtomicBoolean();
    private volatile boolean reading;
    private volatile boolean cancelled;
    private volatile @Nullable Throwable failure;

    public StreamAdapter(MediaStreamSource source, SharedFields fields) {
        this.source = source;
        this.fields = fields;
    }

    /** Stands in where a player has no source: an empty one. */
    static StreamAdapter none(SharedFields fields) {
        return new StreamAdapter(new EmptySource(), fields);
    }

    /** Writes the fields of the player that the native half reads. */
    public void describe() throws MediaException {
        try {
            size = source.size();
            fields.describeStream(size > 0 && size < SIZE_LIMIT ? size : 0,
                    source.isSeekable(), source.mayStall(), source.durationMillis());
        } catch (IOException | RuntimeException e) {
            throw new MediaException(
                    "the stream source cannot describe itself: " + e, MediaError.IO, e);
        }
    }

    /** The count of bytes put into the player's buffer, END or FAILED. */
    public synchronized int read(int length) {
        cancelled = false;
        reading = true;
        try {
            int count = closed.get() || length <= 0
                    ? END : source.read(fields.streamBuffer(length), length);
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
    public boolean isReading() {
        return reading;
    }

    /** The new position, or FAILED. */
    public synchronized long seek(int type, long offset) {
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

    public synchronized long seekTime(long first, long second) {
        try {
            long target = closed.get() ? FAILED : source.seekTime(first, second);
            return target < 0 ? FAILED : moveTo(target);
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
            return FAILED;
        }
    }

    public int seekType() {
        try {
            return source.seekType();
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
            return SEEKS_BY_BYTES;
        }
    }

    // Not synchronized: it ends a read that holds the lock.
    public void cancel() {
        cancelled = true;
        try {
            source.cancel();
        } catch (Throwable e) { // Native code must not meet it.
            remember(e);
        }
    }

    // Not synchronized either: a read that ignores its cancellation may hold the lock.
    public void close() {
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
    public @Nullable Throwable failure() {
        return failure;
    }

    private void remember(Throwable thrown) {
        if (!cancelled && failure == null) {
            failure = thrown;
        }
    }

    private long moveTo(long newPosition) {
        position = newPosition;
        fields.setStreamPosition(newPosition);
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
