// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.orv.player.window.PlayerWindow;
import java.io.ByteArrayInputStream;
import java.io.ByteArrayOutputStream;
import java.io.IOException;
import java.io.OutputStream;
import java.io.PrintStream;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import javax.sound.sampled.AudioFileFormat;
import javax.sound.sampled.AudioFormat;
import javax.sound.sampled.AudioInputStream;
import javax.sound.sampled.AudioSystem;

/**
 * Runs each command once and shows nothing, for the virtual machine to archive the classes that
 * they load. The starting script calls it when the program was built.
 */
public final class Rehearsal {
    private static final int SIDE = 16; // pixels
    private static final int FRAMES = 4;
    private static final int SAMPLE_RATE = 48_000; // hertz

    private Rehearsal() {}

    /** Takes a folder for its files, which it leaves there. */
    public static void main(String[] arguments) throws Exception {
        Path folder = Path.of(arguments[0]);
        String media = makeVideo(folder.resolve("rehearsal.y4m")).toString();
        String sound = makeSound(folder.resolve("rehearsal.wav")).toString();
        System.setOut(new PrintStream(OutputStream.nullOutputStream()));
        System.setErr(System.out);
        NativeHalf.beginLoading();
        run("info", media);
        run("info", "--json", media);
        run("info", sound);
        run("thumbnail", media, folder.resolve("rehearsal.png").toString());
        run("cover", media, folder.resolve("rehearsal.jpg").toString());
        run("play", "--help");
        run("play", "--no-window", "--stats", media);
        if (PlayCommand.hasDisplay()) {
            String memory = makeMemory(folder.resolve("rehearsal.conf"), media).toString();
            PlayerWindow.rehearse(PlayOptions.of("--memory", memory, media));
        }
        System.exit(0);
    }

    private static void run(String... arguments) {
        Main.commandLine(arguments).execute(arguments);
    }

    /** Frames of one colour as YUV4MPEG2, a format that needs no encoder. */
    private static Path makeVideo(Path path) throws IOException {
        var bytes = new ByteArrayOutputStream();
        write(bytes, "YUV4MPEG2 W" + SIDE + " H" + SIDE + " F25:1 Ip A1:1 C420jpeg\n");
        for (int i = 0; i < FRAMES; i++) {
            write(bytes, "FRAME\n");
            bytes.write(new byte[SIDE * SIDE * 3 / 2]);
        }
        return Files.write(path, bytes.toByteArray());
    }

    private static Path makeSound(Path path) throws IOException {
        var format = new AudioFormat(SAMPLE_RATE, 16, 2, true, false);
        var silence = new ByteArrayInputStream(new byte[SAMPLE_RATE]);
        var sound = new AudioInputStream(silence, format, SAMPLE_RATE / format.getFrameSize());
        AudioSystem.write(sound, AudioFileFormat.Type.WAVE, path.toFile());
        return path;
    }

    private static Path makeMemory(Path path, String media) throws IOException {
        String text = "volume = 100\nwindow = 40 30 640x480\nrecent.01.source = " + media + "\n";
        return Files.writeString(path, text);
    }

    private static void write(OutputStream out, String text) throws IOException {
        out.write(text.getBytes(StandardCharsets.US_ASCII));
    }
}
