// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.util.PcmMediaInfo;
import java.nio.file.Path;
import picocli.CommandLine.Option;
import picocli.CommandLine.Parameters;

/** What and how to play. Track numbers count from 0, times are kept in milliseconds. */
public final class PlayOptions {
    /** The slowest speed, forward and backward. */
    static final double MIN_SPEED = 0.25;

    @Parameters(
            arity = "0..1",
            paramLabel = "FILE|URL",
            description =
                    "What to play, - for standard input; without it, a sample that is made on the"
                            + " spot.")
    String source;

    @Option(
            names = "--subtitle",
            paramLabel = "FILE",
            description = "Show this subtitle file too (SRT, ASS, or the .idx of a VobSub pair).")
    String subtitle;

    @Option(
            names = "--audio-track",
            paramLabel = "N",
            description = "Play sound track N, counted from 0.")
    Integer audioTrack;

    @Option(
            names = "--subtitle-track",
            paramLabel = "N",
            description = "Show subtitle track N, counted from 0; -1 for none.")
    Integer subtitleTrack;

    @Option(
            names = "--speed",
            paramLabel = "X",
            defaultValue = "1",
            description =
                    "Times the normal speed: 0.25 to 32, or -32 to -0.25 for backward, which begins"
                            + " at the end unless --start says where.")
    double speed;

    @Option(
            names = "--start",
            paramLabel = "TIME",
            defaultValue = "0",
            converter = Times.Converter.class,
            description = "Begin there: seconds, or h:mm:ss.")
    int start;

    @Option(names = "--loop", description = "Begin again at the end.")
    boolean loop;

    @Option(
            names = "--ab",
            paramLabel = "A:B",
            converter = Section.Converter.class,
            description = "Repeat a section: 10:20 in seconds, or 0:10-0:20.")
    Section section;

    @Option(names = "--stream", description = "Feed the file to the player through Java.")
    boolean stream;

    @Option(
            names = "--pcm",
            paramLabel = "RATE:CHANNELS:FORMAT",
            converter = PcmFormat.Converter.class,
            description = "The file is raw PCM, as in 44100:2:s16le.")
    PcmMediaInfo pcm;

    @Option(
            names = "--volume",
            paramLabel = "PERCENT",
            defaultValue = "100",
            description = "0 to 100.")
    int volume;

    @Option(names = "--no-window", description = "Play in the terminal.")
    boolean noWindow;

    @Option(
            names = "--stats",
            description = "Print afterwards how quickly and how smoothly it played.")
    boolean stats;

    /** What stands in a window's title bar: the file's name, or the whole URL. */
    public String title() {
        if (StandardInput.isNamed(source)) {
            return "standard input";
        }
        return source.contains("://") ? source : String.valueOf(Path.of(source).getFileName());
    }

    /** 0 to 100. */
    public int volume() {
        return volume;
    }

    public boolean reportsStats() {
        return stats;
    }
}
