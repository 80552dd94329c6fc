// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.google.gson.GsonBuilder;
import com.quintora.mmp.OrvMediaPlayer;
import java.io.PrintWriter;
import java.util.concurrent.Callable;
import picocli.CommandLine.Model.CommandSpec;

/** Prints what media hold. */
final class InfoCommand implements Callable<Integer> {
    private final CommandSpec command;
    private String source;
    private boolean json;

    InfoCommand() {
        var arguments =
                Arguments.ofCommand(
                        this,
                        "info",
                        "Prints the container, duration, tracks, chapters and metadata of media.");
        arguments.addSource("FILE|URL", value -> source = value);
        arguments.addFlag("--json", value -> json = value, "For programs: one JSON object.");
        command = arguments.command();
    }

    CommandSpec command() {
        return command;
    }

    @Override
    public Integer call() throws Failure {
        PrintWriter out = command.commandLine().getOut();
        try (OrvMediaPlayer player = Media.open(source)) {
            MediaInfo info = MediaInfo.of(source, player);
            if (json) {
                out.println(
                        new GsonBuilder()
                                .setPrettyPrinting()
                                .disableHtmlEscaping()
                                .create()
                                .toJson(info));
            } else {
                InfoTable.of(info).forEach(out::println);
            }
        }
        out.flush();
        return 0;
    }
}
