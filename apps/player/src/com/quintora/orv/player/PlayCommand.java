// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.TrickPlay;
import com.quintora.orv.player.terminal.Terminal;
import com.quintora.orv.player.terminal.TerminalScreen;
import com.quintora.orv.player.window.PlayerWindow;
import java.util.List;
import java.util.concurrent.Callable;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.ParameterException;

/** Plays in a window, or in the terminal where there is no display. */
final class PlayCommand implements Callable<Integer> {
    private final PlayOptions options = new PlayOptions();
    private final CommandSpec command;

    PlayCommand() {
        var arguments =
                Arguments.ofCommand(
                        this,
                        "play",
                        "Plays a file or URL: in a window, or in the terminal where there is no"
                                + " display.");
        options.addTo(arguments);
        command = arguments.command();
        command.usageMessage().footer("In the window, H lists the keyboard shortcuts.");
    }

    CommandSpec command() {
        return command;
    }

    @Override
    public Integer call() throws Failure, InterruptedException {
        check();
        if (options.source == null) {
            options.source = Sample.path();
        }
        return options.noWindow || !hasDisplay() ? playInTerminal() : PlayerWindow.play(options);
    }

    private void check() {
        require(options.volume >= 0 && options.volume <= 100, "--volume is 0 to 100");
        double speed = Math.abs(options.speed);
        require(
                speed >= PlayOptions.MIN_SPEED && speed <= TrickPlay.MAX_SPEED,
                "--speed is 0.25 to 32, or -32 to -0.25 for backward");
        require(
                options.section == null || options.speed > 0,
                "--ab repeats a section forward; --speed is negative");
        require(
                options.section == null || options.start == 0,
                "--ab begins at the section's start; leave --start out");
        require(
                options.pcm == null || options.source != null,
                "--pcm describes a file of raw PCM; name the file");
        require(!options.stream || !isUrl(options.source), "--stream reads a file, not a URL");
    }

    private void require(boolean met, String sentence) {
        if (!met) {
            throw new ParameterException(command.commandLine(), sentence);
        }
    }

    private static boolean isUrl(String source) {
        return source != null && source.contains("://");
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

    /** Whether these arguments, which nobody has read yet, look as if there will be a window. */
    static boolean needsWindow(String... arguments) {
        List<String> words = List.of(arguments);
        return words.get(0).equals("play") && !words.contains("--no-window") && hasDisplay();
    }

    // Without asking AWT, which takes longer to load than the rest of the program. It draws on
    // X displays alone: Wayland's desktops offer one as well, and name it in DISPLAY.
    static boolean hasDisplay() {
        String display = System.getenv("DISPLAY");
        return !Boolean.getBoolean("java.awt.headless") && display != null && !display.isEmpty();
    }
}
