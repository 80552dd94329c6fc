// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** Pictures that are kept by a key. */
class ScreenshotWindowTest extends WindowFixture {
    private static final Pattern NAME =
            Pattern.compile("hd709-(\\d{4})h(\\d\\d)m(\\d\\d)s(\\d{3})(-\\d+)?\\.png");

    // One pixel of a thousand may be another, by a rounding.
    private static final int MOST_DIFFERENCE = 3;

    @TempDir Path folder;
    @TempDir Path scratch;

    /** The name's time is that of the frame, which is decoded here by another program. */
    @ParameterizedTest
    @ValueSource(strings = {"--no-gpu", "--gpu"})
    void aKeyWritesTheVideosOwnPicture(String way) throws Exception {
        open("hd709.mp4", way, "--loop", "--screenshot-folder", folder.toString());
        awaitPicture();
        press("shift S");
        Path first = awaitFile(1);
        Wait.until("it is said where", () -> ("Saved as " + first).equals(notice()));
        assertIsFrame(first);
        awaitPicture();
    }

    @ParameterizedTest
    @ValueSource(strings = {"--no-gpu", "--gpu"})
    void noneIsOverwrittenAndSubtitlesAreInItOrNot(String way) throws Exception {
        open("hd709.mp4", way, "--loop", "--subtitle", Media.path("lines.srt"),
                "--screenshot-folder", folder.toString());
        awaitPicture();
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("control S");
        Path without = awaitFile(1);
        press("shift S");
        awaitFile(2);
        press("shift S");
        awaitFile(3);
        assertIsFrame(without);
        if (way.equals("--gpu")) {
            return; // A picture that rests may be drawn anew a frame further on a busy machine.
        }
        String stem = without.getFileName().toString().replace(".png", "");
        Path with = folder.resolve(stem + "-2.png");
        Path again = folder.resolve(stem + "-3.png");
        assertNotEquals(-1, Files.mismatch(without, with), "one has words on it");
        assertEquals(-1, Files.mismatch(with, again), "which show on");
        Wait.until("it is said where", () -> ("Saved as " + again).equals(notice()));
    }

    @Test
    void aFolderThatIsNotThereIsASentence() throws Exception {
        open("hd709.mp4", "--no-gpu", "--loop", "--screenshot-folder", folder + "/none");
        awaitPicture();
        press("shift S");
        Wait.until("it is said",
                () -> notice() != null && notice().contains("its folder does not exist"));
    }

    private Path awaitFile(int count) throws Exception {
        Wait.until("there are " + count + " pictures", () -> pictures().size() == count);
        return pictures().get(0);
    }

    // A name is taken before the picture stands there.
    private List<Path> pictures() throws IOException {
        try (var files = Files.list(folder)) {
            return files.filter(file -> file.toFile().length() > 0)
                    .filter(file -> !file.getFileName().toString().startsWith("."))
                    .sorted()
                    .toList();
        }
    }

    private void assertIsFrame(Path file) throws Exception {
        Matcher name = NAME.matcher(file.getFileName().toString());
        assertTrue(name.matches(), file.toString());
        int millis = Integer.parseInt(name.group(3)) * 1000 + Integer.parseInt(name.group(4));
        Path frame = scratch.resolve("frame.png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-i", Media.path("hd709.mp4"), "-vf",
                "select=gte(t\\," + (millis - 1) / 1000.0 + "),scale=in_color_matrix=bt709",
                "-frames:v", "1", frame.toString());
        assertAlike(ImageIO.read(frame.toFile()), ImageIO.read(file.toFile()));
    }

    private static void assertAlike(BufferedImage expected, BufferedImage actual) {
        assertEquals(expected.getWidth(), actual.getWidth());
        assertEquals(expected.getHeight(), actual.getHeight());
        int others = 0;
        for (int y = 0; y < expected.getHeight(); y++) {
            for (int x = 0; x < expected.getWidth(); x++) {
                others += isOther(expected.getRGB(x, y), actual.getRGB(x, y)) ? 1 : 0;
            }
        }
        assertTrue(others < expected.getWidth() * expected.getHeight() / 1000, others + " pixels");
    }

    private static boolean isOther(int one, int other) {
        for (int shift = 0; shift < 24; shift += 8) {
            if (Math.abs((one >> shift & 255) - (other >> shift & 255)) > MOST_DIFFERENCE) {
                return true;
            }
        }
        return false;
    }
}
