// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * Where a player stands.
 *
 * <p>The usual way is {@link #IDLE}, {@link #INITIALIZED}, {@link #PREPARING}, {@link #PREPARED},
 * {@link #STARTED}, {@link #COMPLETED}. {@link MediaPlayer#reset()} leads back to {@link #IDLE}
 * from everywhere but {@link #RELEASED}, which is final.
 */
public enum PlayerState {
    /** No media. */
    IDLE,
    /** A data source is set; nothing is known of it yet. */
    INITIALIZED,
    /** The media is being opened. */
    PREPARING,
    /** Ready to start; length, size and tracks are known. */
    PREPARED,
    /** Playing, or waiting for data to go on playing. */
    STARTED,
    /** Halted at a position. */
    PAUSED,
    /** The end of the media was reached. */
    COMPLETED,
    /** Stopped; must be prepared again. */
    STOPPED,
    /** The media failed, or are being reset just now; only reset and release are possible. */
    ERROR,
    /** Given up; every other call throws {@link IllegalStateException}. */
    RELEASED
}
