// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.io.IOException;
import java.net.ServerSocket;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.function.Predicate;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Playing in a process of its own: Ctrl-C, and what the native libraries log. */
class PlayProcessTest {
    private static final String SHOW_CURSOR = "\033[?25h";

    @TempDir Path folder;

    private PlayerProcess process;

    @AfterEach
    void endProcess() {
        process.close();
    }

    @Test
    void aPlaybackIsEndedAndTheTerminalRestored() throws Exception {
        play("silent", Media.path("long.mkv"));
        Wait.until("it plays", () -> process.out().contains("shown"));
        process.interrupt();
        assertEquals(Interruption.EXIT_STATUS, process.awaitEnd(), process::all);
        assertTrue(process.out().endsWith(SHOW_CURSOR + "\n"), process::all);
        assertEquals("", process.err());
    }

    @Test
    void thePlayerIsReleasedBeforeTheEnd() throws Exception {
        play("info", Media.path("long.mkv"));
        Wait.until("it plays", () -> process.out().contains("shown"));
        process.interrupt();
        assertTrue(process.err().contains("OrvMediaClient_release(): Leave"), process::all);
    }

    @Test
    void withoutALogPriorityOnlyWhatWentWrongIsLogged() throws Exception {
        play(null, folder.resolve("none.mkv").toString());
        assertEquals(1, process.awaitEnd(), process::all);
        // Versions of the log library write a line's parts in different orders.
        Predicate<String> isError = line -> line.contains(" E ") && line.contains("TarnPlayer");
        assertTrue(process.err().lines().anyMatch(isError), process::all);
        assertTrue(process.err().lines().noneMatch(line -> line.contains(" I ")), process::all);
    }

    @Test
    void aMachineWithoutSoundIsMentionedOnce() throws Exception {
        Map<String, String> mute = Map.of("ORV_TEST_SOUND", "none");
        process = new PlayerProcess(folder, "silent", mute, "play", Media.path("short.mp4"));
        assertEquals(0, process.awaitEnd(), process::all);
        assertEquals(
                "orv: there is no sound card and no sound server: this plays without sound\n",
                process.err());
        process = new PlayerProcess(folder, "silent", mute, "play", Media.path("silent.mkv"));
        assertEquals(0, process.awaitEnd(), process::all);
        assertEquals("", process.err(), "there is no sound to miss");
    }

    @Test
    void aStreamIsReadThroughJava() throws Exception {
        play("info", Media.path("silent.mkv"), "--stream");
        assertEquals(0, process.awaitEnd(), process::all);
        assertTrue(
                process.err().contains("JavaInputStream::JavaInputStream(): Enter"), process::all);
    }

    @Test
    void anOpeningThatTakesForEverIsEndedToo() throws Exception {
        try (ServerSocket silent = new ServerSocket(0)) {
            play("silent", "http://127.0.0.1:" + silent.getLocalPort() + "/film.mkv");
            silent.accept();
            process.interrupt();
        }
        assertEquals(Interruption.EXIT_STATUS, process.awaitEnd(), process::all);
        assertEquals("", process.err());
    }

    @Test
    void waylandAloneIsNoDisplay() throws Exception {
        Map<String, String> wayland = Map.of("WAYLAND_DISPLAY", "wayland-0");
        process = new PlayerProcess(folder, "silent", wayland, "play", Media.path("short.mp4"));
        assertEquals(0, process.awaitEnd(), process::all);
        assertTrue(process.out().contains("shown"), process::all);
    }

    private void play(String log, String... arguments) throws IOException {
        List<String> command = new ArrayList<>(List.of("play", "--no-window"));
        command.addAll(Arrays.asList(arguments));
        process = new PlayerProcess(folder, log, Map.of(), command.toArray(String[]::new));
    }
}
