// SPDX-License-Identifier: Apache-2.0
package com.quintora.samples;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import java.awt.image.BufferedImage;
import java.nio.file.Path;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Every cell of a contact sheet is the film's picture of its time, as FFmpeg decodes it. */
class ContactSheetTest {
    private static final int WIDTH = 240;
    private static final int HEIGHT = 135;
    private static final double ALIKE_DB = 25;

    @TempDir
    Path folder;

    @Test
    void theCellsAreThePicturesOfTheirTimes() throws Exception {
        String film = Media.path("long.mkv"); // A minute, key frames every second.
        Path file = folder.resolve("sheet.png");
        try (Sample sample = Sample.start("ContactSheet", film, file.toString())) {
            Sample.Result result = sample.await();
            assertEquals(0, result.status(), () -> result.errors().toString());
        }
        BufferedImage sheet = ImageIO.read(file.toFile());
        assertEquals(4 * (WIDTH + 8) + 8, sheet.getWidth());
        assertEquals(4 * (HEIGHT + 24) + 8, sheet.getHeight());
        for (int cell = 0; cell < 16; cell++) {
            int second = (int) (60 * (cell + 0.5) / 16);
            int[] drawn = sheet.getRGB(8 + cell % 4 * (WIDTH + 8), 8 + cell / 4 * (HEIGHT + 24),
                    WIDTH, HEIGHT, null, 0, WIDTH);
            double same = psnr(drawn, frame(film, second));
            double other = psnr(drawn, frame(film, (second + 30) % 60));
            String what = "cell " + cell + ": " + same + " dB, of another time " + other + " dB";
            assertTrue(same > ALIKE_DB && same > other + 3, what);
        }
    }

    private static byte[] frame(String film, int second) throws Exception {
        return Media.run("ffmpeg", "-v", "error", "-nostdin", "-ss", String.valueOf(second), "-i",
                film, "-frames:v", "1", "-vf", "scale=" + WIDTH + ":" + HEIGHT, "-pix_fmt", "rgb24",
                "-f", "rawvideo", "-");
    }

    private static double psnr(int[] drawn, byte[] expected) {
        assertEquals(drawn.length * 3, expected.length);
        double sum = 0;
        for (int i = 0; i < expected.length; i++) {
            int value = drawn[i / 3] >> 16 - i % 3 * 8 & 0xFF;
            int difference = value - (expected[i] & 0xFF);
            sum += difference * difference;
        }
        return sum == 0 ? 100 : 10 * Math.log10(255.0 * 255.0 * expected.length / sum);
    }
}
