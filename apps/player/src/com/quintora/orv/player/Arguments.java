// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.nio.file.Path;
import java.util.function.Consumer;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.Model.ISetter;
import picocli.CommandLine.Model.OptionSpec;
import picocli.CommandLine.Model.PositionalParamSpec;

/**
 * Describes a command's arguments in code: reading them from annotations takes longer than all else
 * that a short command does in Java. A value goes where it belongs when it has been read.
 */
final class Arguments {
    private final CommandSpec command;

    private Arguments(CommandSpec command) {
        this.command = command;
    }

    /** Of what runs a command, a Runnable or Callable, or of what only holds the values. */
    static Arguments of(Object holder) {
        return new Arguments(CommandSpec.wrapWithoutInspection(holder));
    }

    /** Those of the command called so, with what every command takes. */
    static Arguments ofCommand(Object command, String name, String description) {
        Arguments arguments = of(command);
        arguments.command.name(name).usageMessage().description(description);
        arguments.addCommon();
        return arguments;
    }

    private void addCommon() {
        add(
                OptionSpec.builder("-h", "--help")
                        .type(boolean.class)
                        .usageHelp(true)
                        .description("Show this help.")
                        .build());
        // The next two are read by the starting script: the native libraries look at the
        // environment when they are loaded.
        addFlag("--log", value -> {}, "Show the native libraries' log.");
        addFlag(
                "--insecure",
                value -> {},
                "Accept servers whose certificate is not trusted.");
    }

    CommandSpec command() {
        return command;
    }

    /** What the command reads, as the first argument. */
    void addSource(String label, Consumer<String> target) {
        add(
                parameter(0, String.class, target)
                        .paramLabel(label)
                        .description("A media file or URL; - for standard input.")
                        .build());
    }

    /** Where the command writes its picture, as the second argument. */
    void addPicture(String label, Consumer<Path> target) {
        add(
                parameter(1, Path.class, target)
                        .paramLabel(label)
                        .description("Where to write the picture; - for standard output.")
                        .build());
    }

    void add(OptionSpec option) {
        command.addOption(option);
    }

    void addFlag(String name, Consumer<Boolean> target, String description) {
        add(option(name, boolean.class, target).description(description).build());
    }

    void add(PositionalParamSpec parameter) {
        command.addPositional(parameter);
    }

    /** An option whose values go to the target, the default one, too. */
    static <T> OptionSpec.Builder option(String name, Class<T> type, Consumer<T> target) {
        return OptionSpec.builder(name)
                .type(type)
                .hasInitialValue(false)
                .setter(new Target<>(target));
    }

    /** The argument of that place, counted from 0, which must be there. */
    static <T> PositionalParamSpec.Builder parameter(
            int place, Class<T> type, Consumer<T> target) {
        return PositionalParamSpec.builder()
                .index(String.valueOf(place))
                .arity("1")
                .required(true)
                .type(type)
                .hasInitialValue(false)
                .setter(new Target<>(target));
    }

    private record Target<T>(Consumer<T> target) implements ISetter {
        @Override
        @SuppressWarnings("unchecked") // picocli gives values of the type that was asked for.
        public <V> V set(V value) {
            target.accept((T) value);
            return null; // Nobody asks for the former value.
        }
    }
}
