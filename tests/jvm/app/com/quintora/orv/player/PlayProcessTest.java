// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.io.IOException;
import java.net.ServerSocket;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Playing in a process of its own: Ctrl-C, and what the native libraries log. */
class PlayProcessTest {
    private static final String SHOW_CURSOR = "\033[?25h";

    @TempDir Path folder;

    private Process process;

    @AfterEach
    void endProcess() {
        process.destroyForcibly();
    }

    @Test
    void aPlaybackIsEndedAndTheTerminalRestored() throws Exception {
        play("silent", Media.path("long.mkv"));
        Wait.until("it plays", () -> out().contains("shown"));
        interrupt();
        assertEquals(Interruption.EXIT_STATUS, process.exitValue(), this::all);
        assertTrue(out().endsWith(SHOW_CURSOR + "\n"), this::all);
        assertEquals("", err());
    }

    @Test
    void thePlayerIsReleasedBeforeTheEnd() throws Exception {
        play("info", Media.path("long.mkv"));
        Wait.until("it plays", () -> out().contains("shown"));
        interrupt();
        assertTrue(err().contains("OrvMediaClient_release(): Leave"), this::all);
    }

    @Test
    void aStreamIsReadThroughJava() throws Exception {
        play("info", Media.path("silent.mkv"), "--stream");
        Wait.until("it ends", () -> !process.isAlive());
        assertEquals(0, process.exitValue(), this::all);
        assertTrue(err().contains("JavaInputStream::JavaInputStream(): Enter"), this::all);
    }

    @Test
    void anOpeningThatTakesForEverIsEndedToo() throws Exception {
        try (ServerSocket silent = new ServerSocket(0)) {
            play("silent", "http://127.0.0.1:" + silent.getLocalPort() + "/film.mkv");
            silent.accept();
            interrupt();
        }
        assertEquals(Interruption.EXIT_STATUS, process.exitValue(), this::all);
        assertEquals("", err());
    }

    @Test
    void waylandAloneIsNoDisplay() throws Exception {
        begin("silent", Map.of("WAYLAND_DISPLAY", "wayland-0"), "play", Media.path("short.mp4"));
        Wait.until("it ends", () -> !process.isAlive());
        assertEquals(0, process.exitValue(), this::all);
        assertTrue(out().contains("shown"), this::all);
    }

    @Test
    void aDisplayThatIsGoneIsOneSentence() throws Exception {
        Map<String, String> stale = Map.of("DISPLAY", "unix:/none");
        begin("silent", stale, "play", Media.path("short.mp4"));
        Wait.until("it ends", () -> !process.isAlive());
        assertEquals(1, process.exitValue(), this::all);
        assertEquals(
                "orv: cannot open a window on display unix:/none;"
                        + " --no-window plays in the terminal\n",
                err());
    }

    private void play(String log, String... arguments) throws IOException {
        List<String> command = new ArrayList<>(List.of("play", "--no-window"));
        command.addAll(Arrays.asList(arguments));
        begin(log, Map.of(), command.toArray(String[]::new));
    }

    /** Starts it on those displays, and on no other. */
    private void begin(String log, Map<String, String> displays, String... arguments)
            throws IOException {
        List<String> command = new ArrayList<>();
        command.add(Path.of(System.getProperty("java.home"), "bin", "java").toString());
        command.add("-Djava.library.path=" + System.getProperty("java.library.path"));
        command.add("-Dorv.columns=80");
        command.addAll(
                Arrays.asList("-cp", System.getProperty("java.class.path"), Main.class.getName()));
        command.addAll(Arrays.asList(arguments));
        ProcessBuilder builder = new ProcessBuilder(command);
        builder.environment().keySet().removeAll(List.of("DISPLAY", "WAYLAND_DISPLAY"));
        builder.environment().putAll(displays);
        builder.environment().put("ORV_LOG", log);
        process =
                builder.redirectOutput(folder.resolve("out").toFile())
                        .redirectError(folder.resolve("err").toFile())
                        .start();
    }

    private void interrupt() throws Exception {
        Media.run("kill", "-INT", String.valueOf(process.pid()));
        assertTrue(process.waitFor(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS), this::all);
    }

    private String out() throws IOException {
        return Files.readString(folder.resolve("out"));
    }

    private String err() throws IOException {
        return Files.readString(folder.resolve("err"));
    }

    private String all() {
        try {
            return out() + err();
        } catch (IOException e) {
            return e.toString();
        }
    }
}
