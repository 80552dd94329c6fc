// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.io.IOException;
import java.io.UncheckedIOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.concurrent.TimeUnit;

/** The player as a program of its own, ended at the latest by {@link #close()}. */
public final class PlayerProcess implements AutoCloseable {
    private final Path out;
    private final Path err;
    private final Process process;

    /**
     * Starts it on those displays and on no other; it writes into files of that folder. The log is
     * a value of ORV_LOG, or null for none.
     */
    public PlayerProcess(Path folder, String log, Map<String, String> displays, String... arguments)
            throws IOException {
        this(folder, log, displays, List.of(), arguments);
    }

    /** Starts it through another program, which is given its command line as arguments. */
    public PlayerProcess(
            Path folder,
            String log,
            Map<String, String> displays,
            List<String> starter,
            String... arguments)
            throws IOException {
        out = folder.resolve("out");
        err = folder.resolve("err");
        List<String> command = new ArrayList<>(starter);
        command.addAll(List.of(System.getProperty("orv.test.java").split("\\|")));
        command.add("--enable-native-access=ALL-UNNAMED");
        command.add("-Djava.library.path=" + System.getProperty("java.library.path"));
        command.add("-Dorv.columns=80");
        command.add("-Dorv.sound=" + displays.getOrDefault("ORV_TEST_SOUND", ""));
        command.addAll(
                Arrays.asList("-cp", System.getProperty("java.class.path"), Main.class.getName()));
        command.addAll(Arrays.asList(arguments));
        ProcessBuilder builder = new ProcessBuilder(command);
        builder.environment().keySet().removeAll(List.of("DISPLAY", "WAYLAND_DISPLAY"));
        builder.environment().putAll(displays);
        if (log == null) {
            builder.environment().remove("ORV_LOG");
        } else {
            builder.environment().put("ORV_LOG", log);
        }
        process = builder.redirectOutput(out.toFile()).redirectError(err.toFile()).start();
    }

    /** Sends what Ctrl-C sends, and waits for the end. */
    public void interrupt() throws Exception {
        Media.run("kill", "-INT", String.valueOf(process.pid()));
        awaitEnd();
    }

    /** Waits for the end; gives the exit status. */
    public int awaitEnd() throws InterruptedException {
        assertTrue(process.waitFor(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS), this::all);
        return process.exitValue();
    }

    public String out() {
        return read(out);
    }

    public String err() {
        return read(err);
    }

    /** All that it wrote, for a failure's message. */
    public String all() {
        return out() + err();
    }

    private static String read(Path file) {
        try {
            return Files.readString(file);
        } catch (IOException e) {
            throw new UncheckedIOException(e);
        }
    }

    @Override
    public void close() {
        process.destroyForcibly();
    }
}
