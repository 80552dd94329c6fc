// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.image.BufferedImage;
import java.nio.file.Path;
import java.util.concurrent.Callable;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.ParameterException;

/** Writes one picture of a video, or a sheet of pictures from all over it. */
final class ThumbnailCommand implements Callable<Integer> {
    private static final int USUAL_HEIGHT = 180;

    private final CommandSpec command;
    private String source;
    private Path out;
    private Integer at;
    private WantedSize size;
    private SheetGrid sheet;

    ThumbnailCommand() {
        var arguments =
                Arguments.ofCommand(
                        this,
                        "thumbnail",
                        "Writes one picture of a video, or a sheet of pictures from all over it, as"
                                + " a PNG file.");
        arguments.addSource("FILE", value -> source = value);
        arguments.addPicture("OUT.png", value -> out = value);
        arguments.add(
                Arguments.option("--at", Integer.class, value -> at = value)
                        .paramLabel("TIME")
                        .converters(Times::parseMillis)
                        .description("Of which moment: seconds, or h:mm:ss; the start without it.")
                        .build());
        arguments.add(
                Arguments.option("--sheet", SheetGrid.class, value -> sheet = value)
                        .paramLabel("COLUMNSxROWS")
                        .converters(SheetGrid::parse)
                        .description(
                                "A sheet of that many pictures, each with its time; at most 20x20.")
                        .build());
        arguments.add(
                Arguments.option("--size", WantedSize.class, value -> size = value)
                        .paramLabel("WxH")
                        .converters(WantedSize::parse)
                        .description(
                                "How large a picture is: at most 255 rows, or else as large as the"
                                        + " video; full for the video's own size; without it, 180"
                                        + " rows in the video's shape.")
                        .build());
        command = arguments.command();
    }

    CommandSpec command() {
        return command;
    }

    @Override
    public Integer call() throws Failure {
        check();
        try (Stills stills = Stills.open(source)) {
            OutputFile.write(out, PngFile.encode(draw(stills)));
        }
        return 0;
    }

    private void check() {
        require(
                OutputFile.isStandardOutput(out) || PngFile.isNamedSo(out),
                "a thumbnail is a PNG file; '" + out + "' is not named so");
        require(
                sheet == null || at == null,
                "a sheet has pictures from all over the video; leave --at out");
    }

    private void require(boolean met, String sentence) {
        if (!met) {
            throw new ParameterException(command.commandLine(), sentence);
        }
    }

    private BufferedImage draw(Stills stills) throws Failure {
        Size wanted =
                size == null ? stills.size().withHeight(USUAL_HEIGHT) : size.of(stills.size());
        if (sheet != null) {
            return new ContactSheet(source, stills, sheet, wanted).draw();
        }
        return stills.at(at == null ? 0 : at, wanted).image();
    }
}
