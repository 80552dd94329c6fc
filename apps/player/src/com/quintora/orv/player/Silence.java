// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;

/** Says why media that have sound make none. */
final class Silence {
    private Silence() {}

    /**
     * Writes one line to standard error where there is nothing that could make the media's sound.
     * The starting script looks for that and sets orv.sound: the engine plays on without a word.
     */
    static void explain(OrvMediaPlayer player) {
        if ("none".equals(System.getProperty("orv.sound")) && !player.tracks().audio().isEmpty()) {
            System.err.println(
                    "orv: there is no sound card and no sound server: this plays without sound");
        }
    }
}
