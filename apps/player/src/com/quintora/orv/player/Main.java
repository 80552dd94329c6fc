// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.PrintWriter;
import picocli.CommandLine;
import picocli.CommandLine.Command;
import picocli.CommandLine.ParameterException;
import picocli.CommandLine.TypeConversionException;
import picocli.CommandLine.UnmatchedArgumentException;

/**
 * The desktop player's commands. Exit status: 0 for success, 1 for a failure explained in one
 * sentence, 2 for wrong arguments, 130 after Ctrl-C.
 */
@Command(
        name = "orv",
        subcommands = {
            PlayCommand.class,
            InfoCommand.class,
            ThumbnailCommand.class,
            CoverCommand.class
        })
public final class Main {
    private Main() {}

    public static void main(String[] arguments) {
        CommandLine commands = commandLine();
        int status = commands.execute(arguments);
        commands.getOut().flush();
        System.exit(status == 0 && outputIsLost() ? CommandLine.ExitCode.SOFTWARE : status);
    }

    // Streams of characters swallow what goes wrong, such as a full disk.
    private static boolean outputIsLost() {
        if (!System.out.checkError()) {
            return false;
        }
        System.err.println("orv: cannot write to standard output");
        return true;
    }

    static CommandLine commandLine() {
        return new CommandLine(new Main())
                // In one piece, for readers that close a pipe after the first lines.
                .setOut(new PrintWriter(System.out))
                .setUsageHelpWidth(100)
                .registerConverter(int.class, Main::wholeNumber)
                .registerConverter(Integer.class, Main::wholeNumber)
                .registerConverter(double.class, Main::number)
                .setParameterExceptionHandler(Main::tellUsage)
                .setExecutionExceptionHandler(Main::tellFailure);
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

    private static int tellUsage(ParameterException problem, String[] arguments) {
        CommandLine command = problem.getCommandLine();
        say(command, sentence(problem));
        say(command, "see ./orv " + command.getCommandName() + " --help");
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
