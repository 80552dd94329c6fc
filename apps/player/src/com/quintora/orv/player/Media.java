// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import java.io.IOException;

/** Opens media to look into, not to play. */
final class Media {
    private Media() {}

    /** Gives a prepared player, which the caller closes. Blocks until the media is open, and before
     * that until a pipe has been read to its end. */
    static OrvMediaPlayer open(String source) throws Failure {
        OrvMediaPlayer player = NativeHalf.newPlayer();
        try {
            if (StandardInput.isPipe(source)) {
                player.setDataSource(StandardInput.kept(source));
            } else {
                player.setDataSource(StandardInput.path(source));
            }
            player.prepareAndWait();
            return player;
        } catch (IOException | SecurityException e) {
            player.close();
            throw new Failure(e.getMessage(), e);
        }
    }
}
