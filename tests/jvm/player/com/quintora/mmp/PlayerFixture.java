// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;

/** A player for each test, released afterwards whatever happens. */
abstract class PlayerFixture {
    final Recorder recorder = new Recorder();
    OrvMediaPlayer player;

    @BeforeEach
    void makePlayer() {
        player = new OrvMediaPlayer();
        player.addListener(recorder);
    }

    @AfterEach
    void releasePlayer() {
        player.close();
    }

    void prepare(String media) throws Exception {
        open(Media.path(media));
    }

    void open(String pathOrUrl) throws IOException {
        player.setDataSource(pathOrUrl);
        player.prepareAndWait();
    }

    void showSubtitle(int index) {
        player.tracks().selectAndWait(player.tracks().subtitles().get(index));
    }

    void awaitState(PlayerState state) throws Exception {
        Wait.until("the state was " + state + "; it was " + player.getState(),
                () -> player.getState() == state);
    }

    /** Waits until playing has moved on from where it stands. */
    void awaitMoving() throws Exception {
        int from = player.getCurrentPosition();
        Wait.until("the position moved on from " + from, () -> player.getCurrentPosition() > from);
    }
}
