// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.google.gson.GsonBuilder;
import com.quintora.mmp.OrvMediaPlayer;
import java.io.PrintWriter;
import java.util.concurrent.Callable;
import picocli.CommandLine.Command;
import picocli.CommandLine.Mixin;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.Option;
import picocli.CommandLine.Parameters;
import picocli.CommandLine.Spec;

/** Prints what media hold. */
@Command(
        name = "info",
        description = "Prints the container, duration, tracks, chapters and metadata of media.")
final class InfoCommand implements Callable<Integer> {
    @Parameters(paramLabel = "FILE|URL", description = "A media file or URL; - for standard input.")
    private String source;

    @Option(names = "--json", description = "For programs: one JSON object.")
    private boolean json;

    @Mixin private CommonOptions common;
    @Spec private CommandSpec spec;

    @Override
    public Integer call() throws Failure {
        PrintWriter out = spec.commandLine().getOut();
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
