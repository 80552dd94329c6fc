// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

/**
 * What the desktop's media keys and panels ask of the player. Called on any thread; none blocks.
 */
public interface Remote {
    void setPlaying(boolean plays);

    void togglePlaying();

    void next();

    void previous();

    /** Moves by milliseconds, negative for back. */
    void skip(long millis);

    void seekTo(long millis);

    /** From 0 to 1. */
    void setVolume(double level);

    void setSpeed(double speed);

    void setShuffled(boolean shuffled);

    /** One of MPRIS's words: None, Track, Playlist. */
    void setLoop(String loop);

    void setFullScreen(boolean fills);

    void open(String url);

    void raise();

    void quit();
}
