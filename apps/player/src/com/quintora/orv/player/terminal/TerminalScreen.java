// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.terminal;

import com.quintora.orv.player.Snapshot;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.TimeUnit;
import java.util.function.Supplier;

/** Shows how a playback goes, as a bar on a terminal and as a line now and then elsewhere. */
public final class TerminalScreen {
    private static final int DRAW_MS = 100;
    private static final int LOG_MS = 5_000;

    private final Terminal terminal;

    public TerminalScreen(Terminal terminal) {
        this.terminal = terminal;
    }

    /** Returns when the playback has ended. */
    public void follow(Supplier<Snapshot> playback, CountDownLatch ended)
            throws InterruptedException {
        do {
            show(playback.get());
        } while (!ended.await(
                terminal.isInteractive() ? DRAW_MS : LOG_MS, TimeUnit.MILLISECONDS));
        show(playback.get());
        terminal.restore();
    }

    private void show(Snapshot now) {
        if (terminal.isInteractive()) {
            terminal.draw(ProgressLine.bar(now, terminal.columns()));
        } else {
            terminal.line(ProgressLine.plain(now));
        }
    }
}
