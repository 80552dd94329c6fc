// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import picocli.CommandLine;
import picocli.CommandLine.Command;
import picocli.CommandLine.ParameterException;

/**
 * The desktop player's commands. Exit status: 0 for success, 1 for a failure told in one
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
        System.exit(commandLine().execute(arguments));
    }

    static CommandLine commandLine() {
        return new CommandLine(new Main())
                .setUsageHelpWidth(100)
                .setCaseInsensitiveEnumValuesAllowed(true)
                .setParameterExceptionHandler(Main::tellUsage)
                .setExecutionExceptionHandler(Main::tellFailure);
    }

    private static int tellUsage(ParameterException problem, String[] arguments) {
        CommandLine command = problem.getCommandLine();
        say(command, problem.getMessage());
        say(command, "see ./orv " + command.getCommandName() + " --help");
        return CommandLine.ExitCode.USAGE;
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
        command.getErr().println("orv: " + sentence);
    }
}
