// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.Component;
import java.awt.Point;
import java.awt.Rectangle;
import java.awt.Window;
import java.awt.image.BufferedImage;
import java.nio.file.Path;
import java.util.Arrays;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** Pictures of places while the pointer is on the seek bar. */
class PreviewWindowTest extends WindowFixture {
    private static final int EDGE = 4;

    @TempDir Path folder;

    /** Ten seconds with a key frame every two. */
    @ParameterizedTest
    @CsvSource({"--no-gpu, window", "--gpu, window", "--no-gpu, screen"})
    void thePictureOfThePlaceStandsAboveThePointer(String way, String where) throws Exception {
        open("video.mp4", way, "--loop");
        awaitPicture();
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        if (where.equals("screen")) {
            press("F");
            Wait.until("it fills the screen", () -> onWindow(frame::isUndecorated));
        }
        SeekBar bar = find(SeekBar.class, null);
        for (double place : new double[] {0.65, 0.25, 0.65}) {
            pointAt(bar, place, 0.5);
            int second = (int) (place * 10);
            Wait.until("it is open", () -> preview() != null);
            Wait.until("the time stands there", () -> words().equals("0:0" + second));
            BufferedImage expected = frame(second / 2 * 2);
            Wait.until("it is the key frame's picture",
                    () -> isAlike(expected, onScreen(preview())));
            Rectangle above = onWindow(() -> preview().getBounds());
            Point corner = onWindow(bar::getLocationOnScreen);
            assertEquals(
                    corner.x + bar.getWidth() * place, above.getCenterX(), 8, "above the pointer");
        }
        pointAt(find(NoticePane.class, null), 0.5, 0.5);
        Wait.until("it is closed", () -> preview() == null);
    }

    @Test
    void theChapterStandsBelowTheTime() throws Exception {
        open("feature.mkv", "--no-gpu");
        awaitPicture();
        awaitButton("Pause (Space)");
        pointAt(find(SeekBar.class, null), 0.35, 0.5);
        Wait.until("it is there", () -> preview() != null && words().equals("0:03  Глава вторая"));
    }

    @ParameterizedTest
    @CsvSource({"tone.flac, false", "video.mp4, true"})
    void whatIsNoFileOrHasNoPictureHasATimeAlone(String media, boolean isStream)
            throws Exception {
        open(media, isStream ? new String[] {"--stream", "--no-gpu"} : new String[] {"--no-gpu"});
        SeekBar bar = find(SeekBar.class, null);
        Wait.until("it is open", () -> onWindow(() -> bar.isEnabled() && bar.timeAt(9999) > 0));
        Wait.until("it plays", () -> button("Pause (Space)") != null || second() > 0);
        pointAt(bar, 0.4, 0.5);
        Wait.until("the time stands there", () -> preview() != null && words().startsWith("0:0"));
        assertEquals(true, onWindow(() -> preview().getHeight() < 40));
        assertFalse(Thread.getAllStackTraces().keySet().stream()
                .anyMatch(thread -> thread.getName().equals("previews")), "nobody makes pictures");
    }

    private static Window preview() {
        return Arrays.stream(Window.getWindows())
                .filter(window -> "preview".equals(window.getName()) && window.isShowing())
                .findFirst()
                .orElse(null);
    }

    private String words() throws Exception {
        return onWindow(() -> {
            Window open = preview();
            Component card = open == null ? null : find(open, PreviewCard.class, null);
            return card == null ? "" : card.getAccessibleContext().getAccessibleName();
        });
    }

    private BufferedImage onScreen(Window window) throws Exception {
        Rectangle place = onWindow(() -> window.isShowing()
                ? new Rectangle(window.getLocationOnScreen(), window.getSize()) : null);
        return place == null ? null : robot().createScreenCapture(place);
    }

    private BufferedImage frame(int second) throws Exception {
        Path file = folder.resolve("frame.png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-ss", String.valueOf(second), "-i",
                Media.path("video.mp4"), "-frames:v", "1", "-vf", "scale=192:108:flags=area",
                file.toString());
        return ImageIO.read(file.toFile());
    }

    // A few pixels around edges may be others: two scalers lie between.
    private static boolean isAlike(BufferedImage expected, BufferedImage card) {
        if (card == null || card.getHeight() < expected.getHeight() + EDGE) {
            return false;
        }
        int others = 0;
        for (int y = 0; y < expected.getHeight(); y++) {
            for (int x = 0; x < expected.getWidth(); x++) {
                int one = expected.getRGB(x, y);
                int other = card.getRGB(x + EDGE, y + EDGE);
                for (int shift = 0; shift < 24; shift += 8) {
                    others += Math.abs((one >> shift & 255) - (other >> shift & 255)) > 60 ? 1 : 0;
                }
            }
        }
        return others < expected.getWidth() * expected.getHeight() * 3 / 100;
    }
}
