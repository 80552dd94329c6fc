// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.desktop.FrameReader;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;

/** Loads or unpacks in a process of its own, and prints what came of it. */
final class LoadingProgram {
    private LoadingProgram() {}

    /**
     * With "load" loads the native half as the player's class does, with "surface" that of the
     * desktop's classes before it; with "unpack" and a name only unpacks, and prints the sum of
     * that file as it finds it at once.
     */
    public static void main(String[] arguments) throws IOException {
        System.out.println("ready");
        System.in.read();
        try {
            System.out.println(run(arguments));
        } catch (UnsatisfiedLinkError e) {
            System.out.println(e.getMessage());
        }
    }

    private static String run(String[] arguments) throws IOException {
        switch (arguments[0]) {
            case "surface":
                new FrameReader().close();
                new OrvMediaPlayer().close();
                return "loaded " + mapped("liborv_platform.so");
            case "unpack":
                return Digests.crc32(Files.readAllBytes(NativeJar.library(arguments[1])));
            default:
                new OrvMediaPlayer().close();
                return "loaded " + mapped("libmediaplayer_orv.so");
        }
    }

    /** The files of that name in this process, of which each has its own copy of the library. */
    private static List<String> mapped(String name) throws IOException {
        return Files.readAllLines(Path.of("/proc/self/maps")).stream()
                .filter(line -> line.endsWith("/" + name))
                .map(line -> line.substring(line.indexOf('/')))
                .distinct()
                .toList();
    }
}
