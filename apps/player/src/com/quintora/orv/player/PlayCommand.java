// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.TrickPlay;
import com.quintora.orv.player.playlist.Entry;
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
        if (options.sources.isEmpty()) {
            options.sources = List.of(Sample.path());
        }
        return options.noWindow || !hasDisplay()
                ? new TerminalPlayer(options).play()
                : PlayerWindow.play(options);
    }

    private void check() {
        int volume = options.volume().orElse(100);
        require(volume >= 0 && volume <= 100, "--volume is 0 to 100");
        double scale = options.scale().orElse(1);
        require(scale >= 1 && scale <= 4, "--scale is 1 to 4");
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
                options.pcm == null || !options.sources.isEmpty(),
                "--pcm describes a file of raw PCM; name the file");
        require(
                !options.stream || options.sources.stream().noneMatch(Entry::isUrl),
                "--stream reads a file, not a URL");
    }

    private void require(boolean met, String sentence) {
        if (!met) {
            throw new ParameterException(command.commandLine(), sentence);
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
