// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.util.PcmMediaInfo;
import java.nio.file.Path;
import picocli.CommandLine;

/** What and how to play. Track numbers count from 0, times are kept in milliseconds. */
public final class PlayOptions {
    /** The slowest speed, forward and backward. */
    static final double MIN_SPEED = 0.25;

    String source;
    String subtitle;
    Integer audioTrack;
    Integer subtitleTrack;
    double speed;
    int start;
    boolean loop;
    Section section;
    boolean stream;
    PcmMediaInfo pcm;
    int volume;
    boolean noWindow;
    boolean noGpu;
    boolean gpu;
    boolean stats;

    /** Those that these arguments of play give, which are not checked further. */
    public static PlayOptions of(String... words) {
        var options = new PlayOptions();
        var arguments = Arguments.of(options);
        options.addTo(arguments);
        new CommandLine(arguments.command()).parseArgs(words);
        return options;
    }

    /** Describes the arguments whose values go here. */
    void addTo(Arguments arguments) {
        arguments.add(
                Arguments.parameter(0, String.class, value -> source = value)
                        .arity("0..1")
                        .required(false)
                        .paramLabel("FILE|URL")
                        .description(
                                "What to play, - for standard input; without it, a sample that is"
                                        + " made on the spot.")
                        .build());
        addChoices(arguments);
        addPace(arguments);
        arguments.addFlag(
                "--stream", value -> stream = value, "Feed the file to the player through Java.");
        arguments.add(
                Arguments.option("--pcm", PcmMediaInfo.class, value -> pcm = value)
                        .paramLabel("RATE:CHANNELS:FORMAT")
                        .converters(PcmFormat::parse)
                        .description("The file is raw PCM, as in 44100:2:s16le.")
                        .build());
        arguments.addFlag("--no-window", value -> noWindow = value, "Play in the terminal.");
        arguments.addFlag(
                "--no-gpu",
                value -> noGpu = value,
                "Draw the window's pictures by software, not by the graphics processor.");
        arguments.addFlag(
                "--gpu", value -> gpu = value, "Draw by OpenGL also where that is only software.");
        arguments.addFlag(
                "--stats",
                value -> stats = value,
                "Print afterwards how quickly and how smoothly it played.");
    }

    private void addChoices(Arguments arguments) {
        arguments.add(
                Arguments.option("--subtitle", String.class, value -> subtitle = value)
                        .paramLabel("FILE")
                        .description(
                                "Show this subtitle file too (SRT, ASS, or the .idx of a VobSub"
                                        + " pair).")
                        .build());
        arguments.add(
                Arguments.option("--audio-track", Integer.class, value -> audioTrack = value)
                        .paramLabel("N")
                        .description("Play sound track N, counted from 0.")
                        .build());
        arguments.add(
                Arguments.option("--subtitle-track", Integer.class, value -> subtitleTrack = value)
                        .paramLabel("N")
                        .description("Show subtitle track N, counted from 0; -1 for none.")
                        .build());
        arguments.add(
                Arguments.option("--volume", int.class, value -> volume = value)
                        .paramLabel("PERCENT")
                        .defaultValue("100")
                        .description("0 to 100.")
                        .build());
    }

    private void addPace(Arguments arguments) {
        arguments.add(
                Arguments.option("--speed", double.class, value -> speed = value)
                        .paramLabel("X")
                        .defaultValue("1")
                        .description(
                                "Times the normal speed: 0.25 to 32, or -32 to -0.25 for backward,"
                                        + " which begins at the end unless --start says where.")
                        .build());
        arguments.add(
                Arguments.option("--start", int.class, value -> start = value)
                        .paramLabel("TIME")
                        .defaultValue("0")
                        .converters(Times::parseMillis)
                        .description("Begin there: seconds, or h:mm:ss.")
                        .build());
        arguments.addFlag("--loop", value -> loop = value, "Begin again at the end.");
        arguments.add(
                Arguments.option("--ab", Section.class, value -> section = value)
                        .paramLabel("A:B")
                        .converters(Section::parse)
                        .description("Repeat a section: 10:20 in seconds, or 0:10-0:20.")
                        .build());
    }

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

    /** When the graphics processor draws the pictures; the last word is --no-gpu's. */
    public GpuUse gpuUse() {
        if (noGpu) {
            return GpuUse.NEVER;
        }
        return gpu ? GpuUse.ALWAYS : GpuUse.USUAL;
    }

    public boolean reportsStats() {
        return stats;
    }
}
