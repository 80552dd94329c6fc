// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** Playing in the terminal, with its options, to the end of the media. */
class PlayCommandTest {
    private static final Pattern REPORT =
            Pattern.compile("([0-9.]+) s of media took ([0-9.]+) s; (\\d+) frames shown");

    /** How a playback went, as it tells itself. */
    private record Report(double media, double time, int frames) {}

    @Test
    void mediaPlaysToItsEnd() throws Exception {
        Report report = play("short.mp4");
        assertEquals(3, report.media, 0.2);
        assertTrue(report.frames > 0, report.toString());
    }

    @Test
    void soundAloneHasNoFrames() throws Exception {
        assertEquals(0, play("tone.mp3").frames);
    }

    @Test
    void aStartBeginsLater() throws Exception {
        assertEquals(1, play("short.mp4", "--start", "2").media, 0.2);
    }

    /** The key frame before is 13 seconds away. */
    @Test
    void aStartBetweenKeyFramesIsExact() throws Exception {
        Report report = play("distant.mkv", "--start", "28");
        assertEquals(2, report.media, 0.2);
        assertTrue(report.frames < 100, "the way is not shown: " + report);
    }

    @Test
    void aStartAmongFewFramesIsExact() throws Exception {
        assertEquals(1, play("sparse.mkv", "--start", "4.5").media, 0.2);
    }

    @Test
    void aSpeedTakesLessTime() throws Exception {
        Report report = play("long.mkv", "--start", "40", "--speed", "8");
        assertEquals(20, report.media, 1.1);
        assertTrue(report.time < report.media / 2, report.toString());
    }

    @Test
    void backwardBeginsAtTheEnd() throws Exception {
        PlayOptions options = PlayOptions.of("--speed", "-1", Media.path("short.mp4"));
        try (Session session = new Session(options, image -> {})) {
            session.open();
            assertTrue(session.player().getCurrentPosition() >= 1_900);
        }
    }

    @Test
    void aStreamPlaysAsTheFileDoes() throws Exception {
        assertEquals(3, play("short.mp4", "--stream").media, 0.2);
    }

    @Test
    void rawPcmPlaysAsDescribed() throws Exception {
        assertEquals(2, play("tone-s16be.pcm", "--pcm", "44100:2:s16be").media, 0.2);
        assertEquals(1, play("tone-s16le.pcm", "--pcm", "44100:4:s16le").media, 0.2);
    }

    @Test
    void tracksAndSubtitlesAreTaken() throws Exception {
        play("tracks.mkv", "--audio-track", "1", "--subtitle-track", "1", "--start", "8");
        play("tracks.mkv", "--subtitle", Media.path("lines.srt"), "--start", "8");
        play("tracks.mkv", "--subtitle-track", "-1", "--start", "8", "--volume", "10");
    }

    @ParameterizedTest
    @CsvSource({
        "--audio-track, 2, 'there is no sound track 2; they are 0 to 1'",
        "--audio-track, -1, 'there is no sound track -1; they are 0 to 1'",
        "--subtitle-track, 7, 'there is no subtitle track 7; they are 0 to 1'",
        "--subtitle, /none.srt, '/none.srt: no such file'"
    })
    void whatTheMediaCannotDoIsOneSentence(String option, String value, String sentence)
            throws Exception {
        Cli run = Cli.run("play", "--no-window", Media.path("tracks.mkv"), option, value);
        assertEquals(1, run.status());
        assertEquals("orv: " + sentence + "\n", run.err());
    }

    @ParameterizedTest
    @CsvSource({
        "--start, soon", "--volume, 101", "--ab, 5", "--pcm, x", "--speed, fast", "--speed, 99",
        "--speed, 0.1", "--speed, -33", "--speed, NaN"
    })
    void whatIsNoArgumentIsAQuestionOfUsage(String option, String value) {
        Cli run = Cli.run("play", "--no-window", "some.mkv", option, value);
        assertEquals(2, run.status());
        assertEquals("orv: see ./orv play --help", run.errLines().get(1));
    }

    @ParameterizedTest
    @CsvSource({
        "--ab 1:2 --speed -1 some.mkv, --ab repeats a section forward; --speed is negative",
        "--ab 1:2 --start 1 some.mkv, --ab begins at the section's start; leave --start out",
        "--scale 0.9 some.mkv, --scale is 1 to 4",
        "--scale 4.1 some.mkv, --scale is 1 to 4",
        "--scale NaN some.mkv, --scale is 1 to 4",
        "--pcm 44100:2:s16le, --pcm describes a file of raw PCM; name the file"
    })
    void whatDoesNotGoTogetherIsAQuestionOfUsage(String arguments, String sentence) {
        Cli run = Cli.run(("play --no-window " + arguments).split(" "));
        assertEquals(2, run.status());
        assertEquals("orv: " + sentence, run.errLines().get(0));
    }

    @ParameterizedTest
    @CsvSource({"--start, 4, that moment", "--ab, 2:4, the section does"})
    void whatLiesBeyondTheMediaIsOneSentence(String option, String value, String what)
            throws Exception {
        String media = Media.path("short.mp4");
        Cli run = Cli.run("play", "--no-window", media, option, value);
        assertEquals(1, run.status());
        assertEquals("orv: '" + media + "' ends at 0:03, before " + what + "\n", run.err());
    }

    @Test
    void whatIsWrongWithArgumentsIsSaidInPlainWords() {
        assertUsage("'x' is not a whole number", "--audio-track", "x", "some.mkv");
        assertUsage("'x' is not a number", "--speed", "x", "some.mkv");
        assertUsage("'x' is not a number", "--scale", "x", "some.mkv");
        assertUsage("orv: Unknown option: '--sped'", "--sped");
    }

    private static void assertUsage(String words, String... arguments) {
        String[] all = Stream.concat(Stream.of("play", "--no-window"), Stream.of(arguments))
                .toArray(String[]::new);
        Cli run = Cli.run(all);
        assertEquals(2, run.status());
        assertTrue(run.errLines().get(0).endsWith(words), run.err());
    }

    @Test
    void aPairOfSubtitleFilesMayHaveCapitalNames(@TempDir Path folder) throws Exception {
        Files.copy(Path.of(Media.path("words.idx")), folder.resolve("WORDS.IDX"));
        Files.copy(Path.of(Media.path("words.sub")), folder.resolve("WORDS.SUB"));
        play("short.mp4", "--subtitle", folder.resolve("WORDS.IDX").toString(), "--start", "2");
    }

    @Test
    void anEmptyNameIsOneSentence() {
        Cli run = Cli.run("play", "--no-window", "");
        assertEquals(1, run.status());
        assertEquals("orv: the path is empty\n", run.err());
    }

    @ParameterizedTest
    @CsvSource({"/none.mkv, /none.mkv: no such file", "'', the path is empty"})
    void whatIsNoStreamIsOneSentence(String source, String sentence) {
        Cli run = Cli.run("play", "--no-window", "--stream", source);
        assertEquals(1, run.status());
        assertEquals("orv: " + sentence + "\n", run.err());
    }

    @Test
    void mediaThatIsDamagedOrMissingIsOneSentence() throws Exception {
        for (String source : new String[] {"/none.mkv", Media.path("noise.bin")}) {
            Cli run = Cli.run("play", "--no-window", source);
            assertEquals(1, run.status());
            assertEquals(1, run.errLines().size(), run.err());
            assertTrue(run.err().startsWith("orv: " + source + ":"), run.err());
        }
    }

    private static Report play(String media, String... options) throws Exception {
        String[] arguments = new String[options.length + 4];
        arguments[0] = "play";
        arguments[1] = "--no-window";
        arguments[2] = "--stats";
        arguments[3] = Media.path(media);
        System.arraycopy(options, 0, arguments, 4, options.length);
        Cli run = Cli.run(arguments);
        assertEquals(0, run.status(), run.err());
        Matcher report = REPORT.matcher(run.out());
        assertTrue(report.find(), run.out());
        return new Report(
                Double.parseDouble(report.group(1)),
                Double.parseDouble(report.group(2)),
                Integer.parseInt(report.group(3)));
    }
}
