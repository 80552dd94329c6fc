// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import java.nio.file.Path;
import java.util.concurrent.Callable;
import picocli.CommandLine.Command;
import picocli.CommandLine.Mixin;
import picocli.CommandLine.Parameters;

/** Writes the picture inside a media file. */
@Command(
        name = "cover",
        description = "Writes the picture inside a file, such as an album's cover, byte for byte.")
final class CoverCommand implements Callable<Integer> {
    @Parameters(paramLabel = "FILE", description = "A media file or URL; - for standard input.")
    private String source;

    @Parameters(paramLabel = "OUT", description = "Where to write the picture; - for standard output.")
    private Path out;

    @Mixin private CommonOptions common;

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
