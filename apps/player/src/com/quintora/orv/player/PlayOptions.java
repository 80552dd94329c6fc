// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.orv.player.desktop.MediaControls;
import com.quintora.orv.player.memory.Memory;
import com.quintora.orv.player.playlist.Entry;
import com.quintora.orv.player.playlist.EntryFinder;
import com.quintora.orv.player.playlist.Playlist;
import com.quintora.orv.player.playlist.Repeat;
import java.nio.file.Path;
import java.util.List;
import java.util.Optional;
import java.util.OptionalDouble;
import java.util.OptionalInt;
import java.util.stream.Stream;
import picocli.CommandLine;

/** What and how to play. Track numbers count from 0, times are kept in milliseconds. */
public final class PlayOptions implements Cloneable {
    /** The slowest speed, forward and backward. */
    static final double MIN_SPEED = 0.25;

    List<String> sources = List.of();
    String source; // Of one playback.
    String subtitle;
    Integer audioTrack;
    Integer subtitleTrack;
    double speed;
    int start;
    boolean loop;
    boolean shuffle;
    Section section;
    boolean stream;
    PcmMediaInfo pcm;
    Integer volume;
    boolean noWindow;
    boolean noMemory;
    Path memoryFile;
    boolean noGpu;
    boolean gpu;
    Double scale;
    boolean stats;
    Path screenshotFolder;

    /** Those that these arguments of play give, which are not checked further. */
    public static PlayOptions of(String... words) {
        var options = new PlayOptions();
        var arguments = Arguments.of(options);
        options.addTo(arguments);
        new CommandLine(arguments.command()).parseArgs(words);
        return options;
    }

    /**
     * Those of one of the media. Where to begin, the section and the subtitle file are of the first
     * alone.
     *
     * @param loops whether it begins again at its end
     * @param volume 0 to 100
     */
    public PlayOptions forEntry(Entry entry, boolean isFirst, boolean loops, int volume) {
        PlayOptions copy = copy();
        copy.source = entry.source();
        copy.loop = loops;
        copy.volume = volume;
        if (!isFirst) {
            copy.start = 0;
            copy.section = null;
            copy.subtitle = null;
        }
        return copy;
    }

    private PlayOptions copy() {
        try {
            return (PlayOptions) clone();
        } catch (CloneNotSupportedException e) {
            throw new AssertionError(e);
        }
    }

    /** Describes the arguments whose values go here. */
    void addTo(Arguments arguments) {
        arguments.add(
                Arguments.parameter(0, String[].class, this::addSources)
                        .index("0..*")
                        .arity("0..*")
                        .required(false)
                        .paramLabel("FILE|FOLDER|URL")
                        .description(
                                "What to play: media, folders of them, playlists (M3U, PLS); - for"
                                        + " standard input; without it, a sample that is made on"
                                        + " the spot.")
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
        addMemory(arguments);
        arguments.addFlag(
                "--no-gpu",
                value -> noGpu = value,
                "Draw the window's pictures by software, not by the graphics processor.");
        arguments.addFlag(
                "--gpu", value -> gpu = value, "Draw by OpenGL also where that is only software.");
        arguments.add(
                Arguments.option("--scale", Double.class, value -> scale = value)
                        .paramLabel("FACTOR")
                        .description(
                                "How many times as large as usual the window's controls and letters"
                                        + " are, 1 to 4; without it, as the desktop wishes.")
                        .build());
        arguments.addFlag(
                "--stats",
                value -> stats = value,
                "Print afterwards how quickly and how smoothly it played.");
        arguments.add(
                Arguments.option(
                                "--screenshot-folder", Path.class,
                                value -> screenshotFolder = value)
                        .paramLabel("DIR")
                        .description(
                                "Where the window's screenshots go; without it, the user's folder"
                                        + " for pictures.")
                        .build());
    }

    private void addMemory(Arguments arguments) {
        arguments.addFlag(
                "--no-memory",
                value -> noMemory = value,
                "Remember nothing: no volume, no place, no recent files.");
        arguments.add(
                Arguments.option("--memory", Path.class, value -> memoryFile = value)
                        .paramLabel("FILE")
                        .description(
                                "Where the window remembers it, instead of orv/player.conf in the"
                                        + " user's configuration folder.")
                        .build());
    }

    // Those before an option come apart from those behind it.
    private void addSources(String... words) {
        sources = Stream.concat(sources.stream(), Stream.of(words)).toList();
        source = sources.isEmpty() ? null : sources.get(0);
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
                Arguments.option("--volume", Integer.class, value -> volume = value)
                        .paramLabel("PERCENT")
                        .description("0 to 100; 100 unless the window remembers another.")
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
        arguments.addFlag(
                "--loop", value -> loop = value, "Begin again at the end, of the last of several.");
        arguments.addFlag(
                "--shuffle", value -> shuffle = value, "Play several in an order of chance.");
        arguments.add(
                Arguments.option("--ab", Section.class, value -> section = value)
                        .paramLabel("A:B")
                        .converters(Section::parse)
                        .description("Repeat a section: 10:20 in seconds, or 0:10-0:20.")
                        .build());
    }

    /** What is kept from one start of the window to the next. */
    public Memory memory() {
        if (noMemory) {
            return Memory.none();
        }
        return memoryFile == null ? Memory.ofUser() : Memory.in(memoryFile.toAbsolutePath());
    }

    /** The address of the desktop's message bus, if there is one. */
    public Optional<String> bus() {
        String named = System.getProperty("orv.bus");
        return named == null ? MediaControls.busOfUser() : Optional.of(named);
    }

    /** Whether they say where to begin. */
    public boolean nameAPlace() {
        return start > 0 || section != null || speed < 0;
    }

    /** What was named to be played. */
    public List<String> sources() {
        return sources;
    }

    /**
     * The media that they name. Blocks while folders and playlists are read.
     *
     * @throws Failure for those without media
     */
    public Playlist playlist() throws Failure {
        Playlist list = new Playlist();
        list.setRepeat(loop ? Repeat.ALL : Repeat.OFF);
        list.setShuffled(shuffle);
        list.set(EntryFinder.find(sources));
        return list;
    }

    /** 0 to 100, if it was asked for. */
    public OptionalInt volume() {
        return volume == null ? OptionalInt.empty() : OptionalInt.of(volume);
    }

    /** How many times as large as usual the window's controls are, if it was asked for: 1 to 4. */
    public OptionalDouble scale() {
        return scale == null ? OptionalDouble.empty() : OptionalDouble.of(scale);
    }

    /** When the graphics processor draws the pictures; the last word is --no-gpu's. */
    public GpuUse gpuUse() {
        if (noGpu) {
            return GpuUse.NEVER;
        }
        return gpu ? GpuUse.ALWAYS : GpuUse.USUAL;
    }

    /** Where the pictures of this media go that the user keeps. */
    public Screenshots screenshots() {
        return new Screenshots(screenshotFolder, source);
    }

    public boolean reportsStats() {
        return stats;
    }
}
