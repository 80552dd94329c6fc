// SPDX-License-Identifier: Apache-2.0
package com.quintora.samples;

import com.quintora.mmp.Wait;
import java.io.IOException;
import java.io.OutputStream;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.concurrent.TimeUnit;
import java.util.stream.Stream;

/** A sample, run as a program of its own. */
public final class Sample implements AutoCloseable {
    private static final Path FOLDER = Path.of(System.getProperty("orv.test.samples"));
    private static final String JAVAFX = System.getProperty("orv.test.javafx", "");
    private static final String LIBRARIES = System.getProperty("java.library.path");

    /**
     * How it ended.
     *
     * @param status 0 for well, 1 for a failure, 2 for wrong arguments
     */
    public record Result(int status, List<String> output, List<String> errors) {}

    private final Process process;
    private final Path output = Files.createTempFile("sample", ".out");
    private final Path errors = Files.createTempFile("sample", ".err");

    private Sample(List<String> command) throws IOException {
        ProcessBuilder builder = new ProcessBuilder(command)
                .redirectOutput(output.toFile())
                .redirectError(errors.toFile());
        // For JavaFX, whose own libraries java.library.path would hide.
        builder.environment().put("LD_LIBRARY_PATH", LIBRARIES);
        process = builder.start();
    }

    public static List<Path> sources() throws IOException {
        try (Stream<Path> files = Files.list(FOLDER)) {
            return files.filter(file -> file.toString().endsWith(".java")).sorted().toList();
        }
    }

    /** Whether it can run here: JavaFX may be missing. */
    public static boolean canRun(String name) {
        return !name.equals("PlayInJavaFx") || !JAVAFX.isEmpty();
    }

    public static Sample start(String name, String... args) throws IOException {
        return startClass(name, name, args);
    }

    /** As its file is run without being compiled first. */
    public static Sample startSource(String name, String... args) throws IOException {
        return startClass(name, FOLDER.resolve(name + ".java").toString(), args);
    }

    private static Sample startClass(String name, String main, String... args)
            throws IOException {
        boolean compiled = main.equals(name);
        String jars = Arrays.stream(System.getProperty("java.class.path").split(":"))
                .filter(jar -> compiled || !jar.endsWith("orv_samples.jar"))
                .reduce((left, right) -> left + ":" + right)
                .orElseThrow();
        List<String> command =
                new ArrayList<>(List.of(System.getProperty("orv.test.java").split("\\|")));
        command.addAll(List.of("--enable-native-access=ALL-UNNAMED", "-XX:+UseSerialGC",
                "-XX:TieredStopAtLevel=1", "-cp", jars));
        command.addAll(name.equals("PlayInJavaFx")
                ? List.of("--module-path", JAVAFX, "--add-modules", "javafx.graphics")
                : List.of("-Djava.library.path=" + LIBRARIES));
        command.add(main);
        command.addAll(List.of(args));
        return new Sample(command);
    }

    public Sample type(String text) throws IOException {
        try (OutputStream input = process.getOutputStream()) {
            input.write(text.getBytes());
        }
        return this;
    }

    public boolean isRunning() {
        return process.isAlive();
    }

    public Result await() throws Exception {
        if (!process.waitFor(Wait.LIMIT.toSeconds() * 2, TimeUnit.SECONDS)) {
            throw new AssertionError("it still runs; it wrote " + Files.readAllLines(output)
                    + Files.readAllLines(errors));
        }
        return new Result(
                process.exitValue(), Files.readAllLines(output), Files.readAllLines(errors));
    }

    @Override
    public void close() throws IOException {
        process.destroyForcibly();
        Files.deleteIfExists(output);
        Files.deleteIfExists(errors);
    }
}
