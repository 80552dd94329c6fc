// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

/** The fields of a player that the native half reads. */
public interface SharedFields {
    /**
     * Describes the stream that is played next, at its start.
     *
     * @param size bytes, 0 when unknown
     * @param seekable whether it can be sought
     * @param mayStall whether reads may pause for long
     * @param durationMillis milliseconds, 0 when unknown
     */
    void describeStream(long size, boolean seekable, boolean mayStall, long durationMillis);

    /**
     * The buffer from which the native half takes the bytes of a read.
     *
     * @param length how many bytes it must have room for
     * @return the same buffer while it is large enough
     */
    byte[] streamBuffer(int length);

    /** Frees the buffer. */
    void dropStreamBuffer();

    /**
     * Says where the stream stands.
     *
     * @param position bytes from the start
     */
    void setStreamPosition(long position);

    /** Forgets the address of a surface whose reference the native half has given up. */
    void forgetSurface();
}
