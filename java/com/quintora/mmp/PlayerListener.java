// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import org.jetbrains.annotations.Nullable;

/**
 * Receives what happens to a player: each event once, in order, one call at a time, by the executor
 * that the player was made with. Calls may call the player, {@link MediaPlayer#close()} included.
 * What a call throws goes to its thread's uncaught exception handler and disturbs nothing else.
 *
 * <p>An executor that rejects a call, or drops one silently, only delays it: it is handed over
 * again with the next event and after a while, in the same order.
 */
public interface PlayerListener {
    /**
     * The media is ready: {@link PlayerState#PREPARED}.
     *
     * @param player the player
     */
    default void onPrepared(MediaPlayer player) {}

    /**
     * The end of the media was reached: {@link PlayerState#COMPLETED}. A looping player goes on
     * instead.
     *
     * @param player the player
     */
    default void onCompletion(MediaPlayer player) {}

    /**
     * A seek is done.
     *
     * @param player the player
     */
    default void onSeekComplete(MediaPlayer player) {}

    /**
     * The picture has a size for the first time, or another one.
     *
     * @param player the player
     * @param width pixels
     * @param height rows
     */
    default void onVideoSizeChanged(MediaPlayer player, int width, int height) {}

    /**
     * The amount of buffered media changed.
     *
     * @param player the player
     * @param percent 0 to 100
     */
    default void onBufferingUpdate(MediaPlayer player, int percent) {}

    /**
     * The media failed outside any call that blocks: {@link PlayerState#ERROR}. Failures of a call
     * are thrown by it and not reported here.
     *
     * @param player the player
     * @param error what happened, in a sentence, with its kind and advice
     */
    default void onError(MediaPlayer player, MediaException error) {}

    /**
     * Something worth knowing about playing, such as that it waits for data.
     *
     * @param player the player
     * @param info what it is
     */
    default void onInfo(MediaPlayer player, PlaybackInfo info) {}

    /**
     * A text of a timed-text track, on engines that deliver them.
     *
     * @param player the player
     * @param payload the engine's bytes, null when it sent none
     */
    default void onTimedText(MediaPlayer player, byte @Nullable [] payload) {}
}
