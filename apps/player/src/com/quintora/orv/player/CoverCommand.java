// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import java.nio.file.Path;
import java.util.concurrent.Callable;
import picocli.CommandLine.Model.CommandSpec;

/** Writes the picture inside a media file. */
final class CoverCommand implements Callable<Integer> {
    private final CommandSpec command;
    private String source;
    private Path out;

    CoverCommand() {
        var arguments =
                Arguments.ofCommand(
                        this,
                        "cover",
                        "Writes the picture inside a file, such as an album's cover, byte for"
                                + " byte.");
        arguments.addSource("FILE", value -> source = value);
        arguments.addPicture("OUT", value -> out = value);
        command = arguments.command();
    }

    CommandSpec command() {
        return command;
    }

    @Override
    public Integer call() throws Failure {
        try (OrvMediaPlayer player = Media.open(source)) {
            byte[] picture =
                    player.pictures()
                            .embedded()
                            .orElseThrow(() -> noPicture(source));
            OutputFile.write(out, picture);
        }
        return 0;
    }

    private static Failure noPicture(String source) {
        return new Failure("there is no picture inside '" + source + "'");
    }
}
