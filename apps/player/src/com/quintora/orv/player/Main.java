// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.orv.player.window.PlayerWindow;
import java.io.PrintWriter;
import java.util.List;
import picocli.CommandLine;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.ParameterException;
import picocli.CommandLine.TypeConversionException;
import picocli.CommandLine.UnmatchedArgumentException;

/**
 * The desktop player's commands. Exit status: 0 for success, 1 for a failure explained in one
 * sentence, 2 for wrong arguments, 130 after Ctrl-C.
 */
public final class Main {
    private static final List<String> COMMANDS = List.of("play", "info", "thumbnail", "cover");

    private Main() {}

    public static void main(String[] arguments) {
        if (needsPlayer(arguments)) {
            if (PlayCommand.needsWindow(arguments)) {
                PlayerWindow.begin();
            }
            NativeHalf.beginLoading();
        }
        CommandLine commands = commandLine(arguments);
        int status = commands.execute(arguments);
        commands.getOut().flush();
        NativeHalf.endLoading();
        System.exit(status == 0 && outputIsLost() ? CommandLine.ExitCode.SOFTWARE : status);
    }

    // Before they are read: a wrong guess costs time, no more.
    private static boolean needsPlayer(String... arguments) {
        List<String> words = List.of(arguments);
        return words.size() > 1 && !words.contains("--help") && !words.contains("-h");
    }

    // Streams of characters swallow what goes wrong, such as a full disk.
    private static boolean outputIsLost() {
        if (!System.out.checkError()) {
            return false;
        }
        System.err.println("orv: cannot write to standard output");
        return true;
    }

    /** What runs these arguments. Only their own command is described: all four take their time. */
    static CommandLine commandLine(String... arguments) {
        CommandLine line = new CommandLine(CommandSpec.create().name("orv"));
        boolean isNamed = arguments.length > 0 && COMMANDS.contains(arguments[0]);
        for (String name : isNamed ? List.of(arguments[0]) : COMMANDS) {
            line.addSubcommand(name, new CommandLine(command(name)));
        }
        return line
                // In one piece, for readers that close a pipe after the first lines.
                .setOut(new PrintWriter(System.out))
                .setUsageHelpWidth(100)
                .registerConverter(int.class, Main::wholeNumber)
                .registerConverter(Integer.class, Main::wholeNumber)
                .registerConverter(double.class, Main::number)
                .registerConverter(Double.class, Main::number)
                .setParameterExceptionHandler(Main::sayUsage)
                .setExecutionExceptionHandler(Main::tellFailure);
    }

    private static CommandSpec command(String name) {
        return switch (name) {
            case "play" -> new PlayCommand().command();
            case "info" -> new InfoCommand().command();
            case "thumbnail" -> new ThumbnailCommand().command();
            case "cover" -> new CoverCommand().command();
            default -> throw new IllegalArgumentException(name);
        };
    }

    private static int wholeNumber(String text) {
        try {
            return Integer.parseInt(text);
        } catch (NumberFormatException e) {
            throw new TypeConversionException("'" + text + "' is not a whole number");
        }
    }

    private static double number(String text) {
        try {
            return Double.parseDouble(text);
        } catch (NumberFormatException e) {
            throw new TypeConversionException("'" + text + "' is not a number");
        }
    }

    private static int sayUsage(ParameterException problem, String[] arguments) {
        CommandLine command = problem.getCommandLine();
        say(command, sentence(problem));
        // The installed player is called otherwise than that of a checkout.
        String orv = System.getProperty("orv.command", "./orv");
        say(command, "see " + orv + " " + command.getCommandName() + " --help");
        return CommandLine.ExitCode.USAGE;
    }

    private static String sentence(ParameterException problem) {
        return problem instanceof UnmatchedArgumentException unmatched
                        && !unmatched.isUnknownOption()
                ? "too many arguments: " + String.join(" ", unmatched.getUnmatched())
                : problem.getMessage();
    }

    private static int tellFailure(
            Exception problem, CommandLine command, CommandLine.ParseResult arguments)
            throws Exception {
        // A player says in a sentence what it cannot do in its present state.
        if (!(problem instanceof Failure) && !(problem instanceof IllegalStateException)) {
            throw problem;
        }
        say(command, problem.getMessage());
        return CommandLine.ExitCode.SOFTWARE;
    }

    private static void say(CommandLine command, String sentence) {
        command.getErr().println("orv: " + Printable.of(sentence));
    }
}
