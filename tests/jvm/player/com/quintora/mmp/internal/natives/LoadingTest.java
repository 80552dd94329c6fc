// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.io.BufferedReader;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;
import java.util.concurrent.TimeUnit;
import java.util.stream.Stream;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Whole processes that load the native half, or find that they cannot. */
class LoadingTest {
    private static final Machine HERE = Machine.ofThisVm();

    @TempDir Path folder;
    private final List<Process> processes = new ArrayList<>();

    /** The libraries that the other tests run with. */
    private static Map<String, byte[]> builtLibraries() throws IOException {
        Map<String, byte[]> files = new LinkedHashMap<>();
        for (String name : List.of("orv_platform", "orvtarn", NativeLibrary.PLAYER)) {
            String fileName = System.mapLibraryName(name);
            String path = System.getProperty("java.library.path");
            files.put(fileName, Files.readAllBytes(Path.of(LibraryPath.find(path, fileName))));
        }
        return files;
    }

    private Path cache() {
        return folder.resolve("cache");
    }

    /** Starts it with that JAR at the end of the class path, unless it is null; it then waits. */
    private BufferedReader start(Path jar, Path libraryPath, String... arguments) throws Exception {
        List<String> command =
                new ArrayList<>(List.of(System.getProperty("orv.test.java").split("\\|")));
        command.addAll(List.of("-XX:+UseSerialGC", "-XX:TieredStopAtLevel=1"));
        command.add("--enable-native-access=ALL-UNNAMED");
        command.add("-Djava.library.path=" + libraryPath);
        command.add("-Dcom.quintora.mmp.cache=" + cache());
        command.add("-cp");
        command.add(System.getProperty("java.class.path") + (jar == null ? "" : ":" + jar));
        command.add(LoadingProgram.class.getName());
        command.addAll(List.of(arguments));
        Process process = new ProcessBuilder(command).redirectErrorStream(true).start();
        processes.add(process);
        BufferedReader out = process.inputReader();
        assertEquals("ready", out.readLine());
        return out;
    }

    /** Lets all that were started go on. */
    private void release() throws IOException {
        for (Process process : processes) {
            process.getOutputStream().close();
        }
    }

    /** Its next line, which is its last. */
    private static String result(BufferedReader out) throws IOException {
        String line = out.readLine();
        assertNotNull(line);
        return line;
    }

    @AfterEach
    void end() throws Exception {
        release();
        for (Process process : processes) {
            if (!process.waitFor(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS)) {
                process.destroyForcibly().waitFor();
            }
        }
    }

    /** Loads in a new process, out of a native JAR; gives the file that was loaded. */
    private String loadFromJar(String what) throws Exception {
        Path jar = Bundles.jar(
                folder.resolve("native.jar"), HERE, JavaVersion.read(), builtLibraries());
        BufferedReader out = start(jar, folder, what);
        release();
        return result(out);
    }

    /** The place in the cache of that library out of the JAR. */
    private String unpacked(String name) throws IOException {
        NativeBundle bundle = Bundles.bundle(JavaVersion.read(), builtLibraries());
        return "loaded [" + cache().resolve(bundle.identity()).resolve(name) + "]";
    }

    @Test
    void thePlayerComesOutOfTheNativeJar() throws Exception {
        assertEquals(unpacked("libmediaplayer_orv.so"), loadFromJar("load"));
        try (Stream<Path> unpacked = Files.walk(cache())) {
            assertEquals(3, unpacked.filter(Files::isRegularFile).count());
        }
    }

    @Test
    void theDesktopsClassesComeOutOfTheNativeJarThoughUsedFirst() throws Exception {
        assertEquals(unpacked("liborv_platform.so"), loadFromJar("surface"));
    }

    @Test
    void aLibraryOnTheLibraryPathWinsOverTheJar() throws Exception {
        Path jar =
                Bundles.jar(folder.resolve("native.jar"), HERE, "0.0.1", Bundles.twoFiles());
        Path libraries = Path.of(System.getProperty("java.library.path"));
        BufferedReader out = start(jar, libraries, "load");
        release();
        assertEquals("loaded [" + libraries.resolve("libmediaplayer_orv.so") + "]", result(out));
        assertTrue(Files.notExists(cache()));
    }

    @Test
    void withoutALibraryTheErrorSaysWhatToDo() throws Exception {
        BufferedReader out = start(null, folder, "load");
        release();
        String refusal = result(out);
        assertTrue(refusal.startsWith("There is no native library of the player for "
                + HERE.name() + ". No folder of java.library.path has libmediaplayer_orv.so ("
                + folder + "), and no JAR "), refusal);
    }

    @Test
    void aLibraryThatIsNoneIsRefusedInASentence() throws Exception {
        Path file = Files.writeString(folder.resolve("libmediaplayer_orv.so"), "not a library");
        BufferedReader out = start(null, folder, "load");
        release();
        assertEquals("The native library cannot be used: " + file
                + " is not an ELF file, so not a native library", result(out));
    }

    @Test
    void processesAtOnceAllSucceed() throws Exception {
        Map<String, byte[]> files = Bundles.twoFiles();
        files.put("liblarge.so", new byte[5_000_000]);
        Path jar =
                Bundles.jar(folder.resolve("native.jar"), HERE, JavaVersion.read(), files);
        List<BufferedReader> outs = new ArrayList<>();
        for (int i = 0; i < 4; i++) {
            outs.add(start(jar, folder, "unpack", "liblarge.so"));
        }
        release();
        for (BufferedReader out : outs) {
            assertEquals(Digests.crc32(files.get("liblarge.so")), result(out));
        }
        try (Stream<Path> left = Files.walk(cache())) {
            assertEquals(3, left.filter(Files::isRegularFile).count());
        }
    }
}
