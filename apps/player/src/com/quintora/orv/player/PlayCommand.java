// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.orv.player.terminal.Terminal;
import com.quintora.orv.player.terminal.TerminalScreen;
import com.quintora.orv.player.window.PlayerWindow;
import java.util.concurrent.Callable;
import picocli.CommandLine.Command;
import picocli.CommandLine.Mixin;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.ParameterException;
import picocli.CommandLine.Spec;

/** Plays in a window, or in the terminal where there is no display. */
@Command(
        name = "play",
        description = "Plays a file or URL: in a window, or in the terminal where there is no"
                + " display.")
final class PlayCommand implements Callable<Integer> {
    @Mixin private CommonOptions common;
    @Mixin private PlayOptions options;
    @Spec private CommandSpec spec;

    @Override
    public Integer call() throws Failure, InterruptedException {
        check();
        if (options.source == null) {
            options.source = Sample.path();
        }
        return options.noWindow || !hasDisplay() ? playInTerminal() : PlayerWindow.play(options);
    }

    private void check() {
        if (options.volume < 0 || options.volume > 100) {
            throw new ParameterException(spec.commandLine(), "--volume is 0 to 100");
        }
        if (options.stream && options.source != null && options.source.contains("://")) {
            throw new ParameterException(
                    spec.commandLine(), "--stream reads a file, not a URL");
        }
    }

    private int playInTerminal() throws Failure, InterruptedException {
        Terminal terminal = Terminal.standard();
        try (Session session = new Session(options, image -> {});
                Interruption interruption = new Interruption(session, terminal::close)) {
            try {
                playInTerminal(session, terminal);
                return 0;
            } catch (Failure | IllegalStateException e) {
                if (interruption.happened()) {
                    return Interruption.EXIT_STATUS;
                }
                throw e;
            }
        } finally {
            terminal.restore();
        }
    }

    private void playInTerminal(Session session, Terminal terminal)
            throws Failure, InterruptedException {
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

    // Without asking AWT, which takes longer to load than the rest of the program.
    private static boolean hasDisplay() {
        return !Boolean.getBoolean("java.awt.headless")
                && (isSet("DISPLAY") || isSet("WAYLAND_DISPLAY"));
    }

    private static boolean isSet(String variable) {
        String value = System.getenv(variable);
        return value != null && !value.isEmpty();
    }
}
