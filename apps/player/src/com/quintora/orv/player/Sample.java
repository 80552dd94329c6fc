// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;

/** The media that is played when none is named: made once, then kept. */
final class Sample {
    private Sample() {}

    /** Gives the sample's path, making it first if need be, which takes seconds. */
    static String path() throws Failure {
        String path = System.getProperty("orv.sample");
        String maker = System.getProperty("orv.make-sample");
        if (path == null || maker == null) {
            throw new Failure("name a file or URL to play");
        }
        if (!Files.exists(Path.of(path))) {
            System.err.println("orv: making a sample, as no file was named");
            make(maker, path);
        }
        return path;
    }

    private static void make(String maker, String path) throws Failure {
        try {
            Process process = new ProcessBuilder(maker, path).inheritIO().start();
            if (process.waitFor() != 0) {
                throw new Failure("the sample could not be made; ffmpeg's words are above");
            }
        } catch (IOException e) {
            throw new Failure("the sample could not be made: " + e.getMessage());
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
            throw new Failure("making the sample was interrupted");
        }
    }
}
