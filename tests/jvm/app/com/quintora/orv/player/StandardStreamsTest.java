// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.google.gson.JsonObject;
import com.google.gson.JsonParser;
import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.attribute.PosixFilePermissions;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Media from standard input, pictures to standard output, and outputs that cannot be written. */
class StandardStreamsTest {
    // "$@" is the player; STREAMS says what it is connected to.
    private static final String CONNECTED = "eval \"exec \\\"\\$@\\\" $STREAMS\"";

    @TempDir Path folder;

    @Test
    void pipedMediaAreDescribedAsTheFileIs() throws Exception {
        String file = Media.path("tracks.mp4");
        JsonObject expected = describe("", file);
        for (String name : List.of("-", "/dev/stdin")) {
            JsonObject piped = describe("< <(cat '" + file + "')", name);
            assertEquals(name, piped.get("source").getAsString());
            piped.add("source", expected.get("source"));
            assertEquals(expected, piped);
        }
    }

    @Test
    void redirectedMediaAreDescribedAsTheFileIs() throws Exception {
        String file = Media.path("tracks.mkv");
        JsonObject expected = describe("", file);
        for (String name : List.of("-", "/dev/stdin", "/proc/self/fd/0")) {
            JsonObject redirected = describe("<'" + file + "'", name);
            redirected.add("source", expected.get("source"));
            assertEquals(expected, redirected);
        }
    }

    @Test
    void pipedMediaArePlayed() throws Exception {
        String pipe = "< <(cat '" + Media.path("short.ts") + "')";
        for (String name : List.of("-", "/dev/stdin")) {
            assertPlayed(pipe, name);
        }
        assertPlayed(pipe, "--stream", "-");
    }

    @Test
    void aPipeThatGivesNothingIsLeftAtOnce() throws Exception {
        Media.run("mkfifo", folder.resolve("silent").toString());
        String pipe = "<>'" + folder.resolve("silent") + "'";
        try (PlayerProcess play = start("", pipe, "play", "--no-window", "-")) {
            Wait.until("it opens", () -> play.err().contains("OrvMediaClient_prepare(): Enter"));
            play.interrupt();
            assertEquals(Interruption.EXIT_STATUS, play.awaitEnd(), play::all);
        }
    }

    @Test
    void aCoverIsWrittenToStandardOutput() throws Exception {
        Path out = folder.resolve("cover");
        assertEnds(0, ">'" + out + "'", "cover", Media.path("covered.mp3"), "-");
        assertArrayEquals(
                Files.readAllBytes(Path.of(Media.path("front.jpg"))), Files.readAllBytes(out));
    }

    @Test
    void aThumbnailIsWrittenToStandardOutput() throws Exception {
        Path piped = folder.resolve("piped");
        Path file = folder.resolve("file.png");
        String media = Media.path("video.mp4");
        assertEnds(0, "<'" + media + "' >'" + piped + "'", "thumbnail", "-", "--at", "4", "-");
        assertEnds(0, "", "thumbnail", media, "--at", "4", file.toString());
        assertArrayEquals(Files.readAllBytes(file), Files.readAllBytes(piped));
    }

    @Test
    void aFullOutputIsAFailure() throws Exception {
        String cover = Media.path("covered.mp3");
        assertEnds(1, ">/dev/full", "info", cover);
        assertEnds(1, ">/dev/full", "info", "--json", cover);
        assertEnds(1, ">/dev/full", "cover", cover, "-");
        assertEnds(1, ">/dev/full", "thumbnail", Media.path("still.png"), "-");
        assertEnds(1, "", "cover", cover, "/dev/full");
    }

    @Test
    void aReaderMayLeaveAfterTheFirstLine() throws Exception {
        String line = folder.resolve("line").toString();
        PlayerProcess info =
                assertEnds(0, "> >(head -n 1 >'" + line + "')", "info", Media.path("tracks.mkv"));
        assertEquals("", info.err());
    }

    @Test
    void whatCannotBeWrittenWholeIsNotWritten() throws Exception {
        String media = Media.path("video.mp4");
        Path thumbnail = folder.resolve("out.png");
        PlayerProcess run =
                start("ulimit -f 4; ", "", "thumbnail", media, "--size", "400x250",
                        thumbnail.toString());
        assertEquals(1, run.awaitEnd(), run::all);
        assertTrue(run.err().contains("orv: cannot write '" + thumbnail + "'"), run::all);
        assertEquals(List.of(), filesBesideTheStreams());
    }

    @Test
    void whatWasThereStaysWhenItCannotBeReplaced() throws Exception {
        Path thumbnail = Files.writeString(folder.resolve("out.png"), "before");
        PlayerProcess run =
                start("ulimit -f 4; ", "", "thumbnail", Media.path("video.mp4"), "--size",
                        "400x250", thumbnail.toString());
        assertEquals(1, run.awaitEnd(), run::all);
        assertEquals(List.of(thumbnail), filesBesideTheStreams());
        assertEquals("before", Files.readString(thumbnail));
    }

    @Test
    void aLinkStaysOne() throws Exception {
        Path target = Files.writeString(folder.resolve("target.png"), "before");
        Files.setPosixFilePermissions(target, PosixFilePermissions.fromString("rw-r-----"));
        Path link = Files.createSymbolicLink(folder.resolve("link.png"), Path.of("target.png"));
        assertEnds(0, "", "thumbnail", Media.path("video.mp4"), link.toString());
        assertTrue(Files.isSymbolicLink(link));
        assertEquals("PNG", Files.readString(target, StandardCharsets.ISO_8859_1).substring(1, 4));
        assertEquals("rw-r-----",
                PosixFilePermissions.toString(Files.getPosixFilePermissions(target)));
    }

    private JsonObject describe(String streams, String source) throws Exception {
        PlayerProcess info = assertEnds(0, streams, "info", "--json", source);
        return JsonParser.parseString(info.out()).getAsJsonObject();
    }

    private void assertPlayed(String streams, String... source) throws Exception {
        List<String> arguments = new ArrayList<>(List.of("play", "--no-window", "--stats"));
        arguments.addAll(Arrays.asList(source));
        PlayerProcess play = assertEnds(0, streams, arguments.toArray(String[]::new));
        // All three seconds. Of the 90 frames a busy machine leaves some out, not all of which
        // mpv counts.
        String end = "(?s).*; 3\\.0\\d s of media took .*; \\d+ frames shown, \\d+ dropped\n";
        assertTrue(play.out().matches(end), play::all);
        String[] counts = play.out().replaceAll("(?s).*; ", "").split("\\D+");
        int shown = Integer.parseInt(counts[0]);
        int dropped = Integer.parseInt(counts[1]);
        assertTrue(shown > 1 && shown + dropped <= 92, play::all);
    }

    private PlayerProcess assertEnds(int status, String streams, String... arguments)
            throws Exception {
        try (PlayerProcess process = start("", streams, arguments)) {
            assertEquals(status, process.awaitEnd(), process::all);
            if (status != 0) {
                assertTrue(process.err().startsWith("orv: cannot write"), process::all);
                assertEquals(1, process.err().lines().count(), process::all);
            }
            return process;
        }
    }

    private PlayerProcess start(String before, String streams, String... arguments)
            throws Exception {
        return new PlayerProcess(
                folder,
                arguments[0].equals("play") ? "info" : "silent",
                Map.of("STREAMS", streams),
                List.of("bash", "-c", before + CONNECTED, "orv"),
                arguments);
    }

    private List<Path> filesBesideTheStreams() throws Exception {
        try (var files = Files.list(folder)) {
            return files.filter(file -> !file.endsWith("out") && !file.endsWith("err")).toList();
        }
    }
}
