// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;

/** What the window's buttons and keys do. Called on the window's thread; none blocks. */
interface Controls {
    void togglePlaying();

    /** Moves by milliseconds, negative for back. */
    void skip(int millis);

    void seekTo(int millis);

    /** Shows one frame more, or the one before. */
    void step(int frames);

    /** From 0 to 1. */
    void setVolume(double level);

    void changeVolume(double by);

    void toggleMuted();

    /** To the next of the offered speeds, or the one before. */
    void changeSpeed(int steps);

    void chooseSpeed(Component above);

    void chooseAudio(Component above);

    void chooseSubtitles(Component above);

    void toggleFullScreen();

    /** Closes the list of keys, or else leaves the full screen. */
    void leave();

    void toggleHelp();

    void quit();
}
