// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * Is told what happens to a player: each thing once, in order, one call at a time, by the executor
 * that the player was made with. Calls may call the player, {@link OrvMediaPlayer#release()}
 * included. What a call throws goes to its thread's uncaught exception handler and disturbs nothing
 * else.
 */
public interface PlayerListener {
    /** {@link #onInfo}: the picture or sound began to run for the first time. */
    int INFO_RENDERING_STARTED = 3;

    /** {@link #onInfo}: playing waits for data. */
    int INFO_BUFFERING_STARTED = 701;

    /** {@link #onInfo}: playing goes on. */
    int INFO_BUFFERING_ENDED = 702;

    /**
     * The media is ready: {@link PlayerState#PREPARED}.
     *
     * @param player the player
     */
    default void onPrepared(OrvMediaPlayer player) {}

    /**
     * The end of the media was reached: {@link PlayerState#COMPLETED}. A looping player goes on
     * instead.
     *
     * @param player the player
     */
    default void onCompletion(OrvMediaPlayer player) {}

    /**
     * A seek is done.
     *
     * @param player the player
     */
    default void onSeekComplete(OrvMediaPlayer player) {}

    /**
     * The picture has a size for the first time, or another one.
     *
     * @param player the player
     * @param width pixels
     * @param height rows
     */
    default void onVideoSizeChanged(OrvMediaPlayer player, int width, int height) {}

    /**
     * The amount of buffered media changed.
     *
     * @param player the player
     * @param percent 0 to 100
     */
    default void onBufferingUpdate(OrvMediaPlayer player, int percent) {}

    /**
     * The media failed outside any call: {@link PlayerState#ERROR}. Failures of a call are thrown
     * by it and not told here.
     *
     * @param player the player
     * @param error what happened, in a sentence and as the engine's status
     */
    default void onError(OrvMediaPlayer player, MediaException error) {}

    /**
     * Something worth knowing.
     *
     * @param player the player
     * @param what one of the INFO constants, or a number of the engine's own
     * @param extra the engine's further number, or 0
     */
    default void onInfo(OrvMediaPlayer player, int what, int extra) {}

    /**
     * A text of a timed-text track, on engines that deliver them.
     *
     * @param player the player
     * @param payload the engine's bytes, null when it sent none
     */
    default void onTimedText(OrvMediaPlayer player, byte[] payload) {}
}
