// SPDX-License-Identifier: Apache-2.0
package com.quintora.samples.window;

import static org.junit.jupiter.api.Assertions.assertTrue;
import static org.junit.jupiter.api.Assumptions.assumeTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.samples.Sample;
import java.awt.Frame;
import java.awt.Rectangle;
import java.awt.Robot;
import java.awt.Toolkit;
import java.awt.event.WindowEvent;
import java.awt.image.BufferedImage;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.concurrent.FutureTask;
import java.util.concurrent.TimeUnit;
import java.util.function.IntPredicate;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** The samples' windows show the films' pictures, and their programs end with them. */
class WindowSamplesTest {
    private static final int BLUE = 0x3060C0;
    private static final int GREEN = 0x30A040;
    private static final int ORANGE = 0xD08020;
    private static final int CELL = 320 * 180;

    @TempDir
    Path folder;

    @Test
    void swingShowsTheFilm() throws Exception {
        FutureTask<Void> program = run("PlayInSwing", film(BLUE));
        awaitPixels("the film", near(BLUE), CELL * 9 / 10);
        closeWindow(program);
    }

    @Test
    void javaFxShowsTheFilm() throws Exception {
        assumeTrue(Sample.canRun("PlayInJavaFx"));
        try (Sample sample = Sample.start("PlayInJavaFx", film(GREEN))) {
            awaitPixels("the film", near(GREEN), CELL * 9 / 10);
            assertTrue(sample.isRunning());
        }
        awaitNone(near(GREEN));
    }

    @Test
    void aWallShowsAllFilms() throws Exception {
        FutureTask<Void> program = run("Wall", film(BLUE), film(GREEN), film(ORANGE));
        Robot robot = new Robot();
        Wait.until("the screen shows all films at once", () -> {
            int[] screen = capture(robot);
            return IntStream.of(BLUE, GREEN, ORANGE)
                    .allMatch(colour -> count(screen, near(colour)) >= CELL * 8 / 10);
        });
        closeWindow(program);
    }

    @Test
    void karaokeGoesThroughTheColours() throws Exception {
        FutureTask<Void> program = run("Karaoke", Media.path("plain.mp4"), Media.path("lines.srt"));
        for (int shift : new int[] {16, 8, 0}) {
            awaitPixels("words of another colour", mostly(shift), 300);
        }
        closeWindow(program);
    }

    private String film(int colour) throws Exception {
        Path file = folder.resolve(Integer.toHexString(colour) + ".mp4");
        Media.run("ffmpeg", "-v", "error", "-nostdin", "-y", "-f", "lavfi", "-i",
                String.format("color=c=0x%06X:size=320x180:rate=25:duration=30", colour),
                "-c:v", "libx264", "-preset", "ultrafast", "-pix_fmt", "yuv420p", file.toString());
        return file.toString();
    }

    /** In this program, so that its window can be closed as a user does; it has no package. */
    private static FutureTask<Void> run(String name, String... args) throws Exception {
        var main = Class.forName(name).getMethod("main", String[].class);
        FutureTask<Void> program = new FutureTask<>(() -> {
            main.invoke(null, (Object) args);
            return null;
        });
        new Thread(program, name).start();
        return program;
    }

    private static void closeWindow(FutureTask<Void> program) throws Exception {
        for (Frame frame : Frame.getFrames()) {
            if (frame.isShowing()) {
                Toolkit.getDefaultToolkit().getSystemEventQueue().postEvent(
                        new WindowEvent(frame, WindowEvent.WINDOW_CLOSING));
            }
        }
        program.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
    }

    private static void awaitPixels(String what, IntPredicate wanted, int least) throws Exception {
        Robot robot = new Robot();
        Wait.until("the screen shows " + what, () -> count(capture(robot), wanted) >= least);
    }

    private static void awaitNone(IntPredicate wanted) throws Exception {
        Robot robot = new Robot();
        Wait.until("the window is gone", () -> count(capture(robot), wanted) == 0);
    }

    private static int[] capture(Robot robot) {
        BufferedImage screen = robot.createScreenCapture(
                new Rectangle(Toolkit.getDefaultToolkit().getScreenSize()));
        return screen.getRGB(
                0, 0, screen.getWidth(), screen.getHeight(), null, 0, screen.getWidth());
    }

    private static long count(int[] pixels, IntPredicate wanted) {
        return Arrays.stream(pixels).filter(wanted).count();
    }

    private static IntPredicate near(int colour) {
        return pixel -> {
            int most = 0;
            for (int shift = 0; shift < 24; shift += 8) {
                most = Math.max(most,
                        Math.abs((pixel >> shift & 0xFF) - (colour >> shift & 0xFF)));
            }
            return most <= 12;
        };
    }

    /** Of red, green or blue much more than of the other two. */
    private static IntPredicate mostly(int shift) {
        return pixel -> {
            int wanted = pixel >> shift & 0xFF;
            int others = Math.max(pixel >> (shift + 8) % 24 & 0xFF, pixel >> (shift + 16) % 24 & 0xFF);
            return wanted > 150 && others < 110;
        };
    }
}
