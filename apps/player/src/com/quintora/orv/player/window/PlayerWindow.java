// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Failure;
import com.quintora.orv.player.Interruption;
import com.quintora.orv.player.PlayOptions;
import com.quintora.orv.player.Session;
import java.awt.EventQueue;
import java.util.concurrent.CountDownLatch;

/** Plays in a window until it is closed. */
public final class PlayerWindow {
    private PlayerWindow() {}

    /** Returns the exit status: 0, or 1 when the media could not be played. */
    public static int play(PlayOptions options) throws InterruptedException {
        CountDownLatch closed = new CountDownLatch(1);
        Stage stage = new Stage(options.title());
        try (Session session = new Session(options, stage::draw);
                Interruption interruption = new Interruption(session, () -> {})) {
            Conductor conductor = new Conductor(session, stage, options);
            EventQueue.invokeLater(() -> stage.open(conductor, closed::countDown));
            conductor.begin();
            closed.await();
            conductor.end();
            if (options.reportsStats()) {
                System.out.println(session.report());
            }
            Failure failure = conductor.failure();
            return failure == null || interruption.happened() ? 0 : 1;
        }
    }
}
