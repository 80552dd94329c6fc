// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.orv.player.playlist.Entry;
import com.quintora.orv.player.playlist.Playlist;
import com.quintora.orv.player.terminal.Terminal;
import com.quintora.orv.player.terminal.TerminalScreen;
import java.util.OptionalInt;

/** Plays one media after the other, with a line in the terminal that shows how it goes. */
final class TerminalPlayer {
    private final PlayOptions options;
    private final Playlist list;
    private final Terminal terminal = Terminal.standard();
    private boolean isFirst = true;
    private boolean isInterrupted;
    private int failuresInARow;
    private int status;

    TerminalPlayer(PlayOptions options) throws Failure {
        this.options = options;
        list = options.playlist();
    }

    /** Gives the exit status; 1 when one of several could not be played. */
    int play() throws Failure, InterruptedException {
        try {
            playAll();
        } finally {
            terminal.restore();
        }
        return isInterrupted ? Interruption.EXIT_STATUS : status;
    }

    private void playAll() throws Failure, InterruptedException {
        while (true) {
            playCurrent();
            OptionalInt next = list.next();
            boolean isHopeless = failuresInARow == list.entries().size();
            if (isInterrupted || isHopeless || next.isEmpty()) {
                return;
            }
            list.goTo(next.getAsInt());
            isFirst = false;
        }
    }

    private void playCurrent() throws Failure, InterruptedException {
        try {
            playOne();
            failuresInARow = 0;
        } catch (Failure | IllegalStateException e) {
            if (isInterrupted) {
                return;
            }
            if (list.entries().size() == 1) {
                throw e;
            }
            terminal.restore();
            System.err.println("orv: " + Printable.of(e.getMessage()));
            failuresInARow++;
            status = 1;
        }
    }

    private void playOne() throws Failure, InterruptedException {
        Entry entry = list.currentEntry();
        if (list.entries().size() > 1) {
            terminal.line(Printable.of(entry.name()));
        }
        PlayOptions its = options.forEntry(
                entry, isFirst, list.repeatsCurrent(), options.volume().orElse(100));
        try (Session session = new Session(its, image -> {});
                Interruption interruption = new Interruption(session::close, terminal::close)) {
            try {
                play(session);
            } finally {
                isInterrupted = interruption.happened();
            }
        }
    }

    private void play(Session session) throws Failure, InterruptedException {
        session.open();
        session.start();
        new TerminalScreen(terminal).follow(session::snapshot, session.ended());
        if (session.failure() != null) {
            throw session.failure();
        }
        if (options.stats) {
            terminal.line(session.report());
        }
    }
}
