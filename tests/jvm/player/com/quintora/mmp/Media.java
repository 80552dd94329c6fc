// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;

/** The media of the tests, made when first asked for. */
public final class Media {
    private static final Path FOLDER = Path.of(System.getProperty("orv.test.media"));
    private static final String MAKER = System.getProperty("orv.test.make-media");

    private Media() {}

    public static String path(String name) throws Exception {
        Path file = FOLDER.resolve(name);
        if (Files.notExists(file)) {
            run(MAKER, FOLDER.toString(), name);
        }
        return file.toString();
    }

    /** What a program writes to its standard output; the test fails when the program does. */
    public static byte[] run(String... command) throws IOException, InterruptedException {
        Process process = new ProcessBuilder(command)
                .redirectError(ProcessBuilder.Redirect.INHERIT)
                .start();
        byte[] output = process.getInputStream().readAllBytes();
        assertEquals(0, process.waitFor(), () -> List.of(command).toString());
        return output;
    }
}
