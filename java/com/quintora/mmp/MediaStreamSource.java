// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.Closeable;
import java.io.IOException;

/**
 * Media bytes that a program produces itself.
 *
 * <p>The player calls {@link #read}, {@link #seek} and {@link #seekTime} on the engine's threads,
 * never two of them at a time; they may block. {@link #cancel} comes from any thread, also while
 * one of those three blocks, and must not block. The descriptive methods are called on any thread,
 * the first time while the data source is set. {@link #close} is called once, when the player has
 * no more use for the source: at its reset or release, after a cancel if a read still blocks.
 *
 * <p>No method may call the player, nor wait for a thread that does: the player's reset and release
 * wait for the method that is running.
 *
 * <p>What a method throws ends the media with an error whose cause it is; see {@link
 * PlayerListener#onError}.
 *
 * <p>A player that was given a source must be released or closed by its owner: the native half
 * keeps hold of it, so it is never collected.
 */
public interface MediaStreamSource extends Closeable {
    /**
     * Reads from the current position and moves it on. Blocks until there is at least one byte.
     *
     * @param buffer where to put the bytes, from its first element on
     * @param length how many at most, 1 to {@code buffer.length}
     * @return how many, 1 to {@code length}; 0 or -1 at the end of the media
     * @throws IOException when the bytes cannot be had
     */
    int read(byte[] buffer, int length) throws IOException;

    /**
     * Moves the position. Called only for sources that are {@link #isSeekable() seekable}.
     *
     * @param position bytes from the start, 0 to {@link #size()} where that is known
     * @throws IOException when the position cannot be reached; reading goes on where it was
     */
    void seek(long position) throws IOException;

    /**
     * The media's length.
     *
     * @return bytes, or -1 when unknown
     * @throws IOException when it cannot be asked
     */
    long size() throws IOException;

    /**
     * Whether {@link #seek} works.
     *
     * @return true by default
     */
    default boolean isSeekable() {
        return true;
    }

    /**
     * The media's duration, for engines that cannot find it out from the bytes.
     *
     * @return milliseconds, or 0, the default, when unknown
     */
    default long durationMillis() {
        return 0;
    }

    /**
     * Whether reads may pause in mid-stream for long, as those of a download do.
     *
     * @return false by default
     */
    default boolean mayStall() {
        return false;
    }

    /**
     * How the source would like to be sought.
     *
     * @return a number of the engine's own; 0, the default, for by bytes
     */
    default int seekType() {
        return 0;
    }

    /**
     * Moves the position by time, for engines that seek so.
     *
     * @param first the engine's first number, passed on as it is
     * @param second its second number
     * @return the new position in bytes, or -1, the default, when this is not possible
     * @throws IOException when it failed
     */
    default long seekTime(long first, long second) throws IOException {
        return -1;
    }

    /**
     * Asks a {@link #read} that blocks on another thread to end at once, with -1 or an exception.
     * Later reads work as before. Does nothing by default, which is right for sources that never
     * block for long.
     */
    default void cancel() {}

    /**
     * Gives up what the source holds.
     *
     * @throws IOException when that fails; the player goes on regardless
     */
    @Override
    default void close() throws IOException {}
}
