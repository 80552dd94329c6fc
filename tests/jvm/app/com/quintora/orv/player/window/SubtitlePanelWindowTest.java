// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import com.quintora.orv.player.memory.Memory;
import java.awt.Color;
import java.awt.Component;
import java.awt.Window;
import java.awt.image.BufferedImage;
import java.io.File;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.function.Predicate;
import javax.swing.JFileChooser;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Subtitles that change in the picture, by real pointer and keys. The picture is dark grey. */
class SubtitlePanelWindowTest extends WindowFixture {
    @TempDir Path folder;

    @Override
    boolean remembers() {
        return true;
    }

    @Override
    String[] usualOptions() {
        return new String[] {"--memory", file().toString(), "--no-gpu"};
    }

    private Path file() {
        return folder.resolve("player.conf");
    }

    @Test
    void aColourIsSeenAtOnceAndRemembered() throws Exception {
        open("plain.mkv", "--subtitle", subtitles("0:00:00", "0:00:29"));
        Wait.until("white letters", () -> count(SubtitlePanelWindowTest::isWhite) > 50);
        assertEquals(0, count(SubtitlePanelWindowTest::isYellow));
        press("T");
        click(choice("Colour of letters: Yellow"));
        Wait.until("yellow letters", () -> count(SubtitlePanelWindowTest::isYellow) > 20);
        assertEquals(0, count(SubtitlePanelWindowTest::isWhite));
        press("Q");
        playing.get();
        assertEquals("#FFFFE040", Memory.in(file()).read().get("subtitles.color"));
        open("plain.mkv", "--subtitle", subtitles("0:00:00", "0:00:29"));
        Wait.until("yellow again", () -> count(SubtitlePanelWindowTest::isYellow) > 20);
    }

    @Test
    void sizeBackgroundAndHeightAreSeenAtOnce() throws Exception {
        open("plain.mkv", "--subtitle", subtitles("0:00:00", "0:00:29"));
        Wait.until("white letters", () -> count(SubtitlePanelWindowTest::isWhite) > 50);
        press("T");
        awaitButton("Larger letters");
        int before = count(SubtitlePanelWindowTest::isWhite);
        click(button("Larger letters"));
        click(button("Larger letters"));
        Wait.until(
                "larger letters", () -> count(SubtitlePanelWindowTest::isWhite) > before * 3 / 2);
        double low = middle(SubtitlePanelWindowTest::isWhite);
        for (int i = 0; i < 6; i++) {
            click(button("Subtitles higher"));
        }
        Wait.until("higher", () -> middle(SubtitlePanelWindowTest::isWhite) < low - 0.1);
        click(choice("Background of subtitles: Blue"));
        Wait.until("a ground", () -> count(SubtitlePanelWindowTest::isBlue) > 1000);
        click(button("Subtitles as usual"));
        Wait.until("none", () -> count(SubtitlePanelWindowTest::isBlue) == 0);
        Wait.until(
                "as before",
                () -> Math.abs(middle(SubtitlePanelWindowTest::isWhite) - low) < 0.05);
    }

    @Test
    void keysMoveSubtitlesInTime() throws Exception {
        open("plain.mkv", "--subtitle", subtitles("0:00:13", "0:00:39"));
        awaitGrey();
        press("SPACE");
        assertEquals(0, count(SubtitlePanelWindowTest::isWhite));
        Wait.until("they come earlier", () -> {
            press("shift X");
            return count(SubtitlePanelWindowTest::isWhite) > 50;
        });
        assertTrue(notice().matches("Subtitles -\\d+\\.\\d s"), notice());
    }

    @Test
    void aFileIsAddedWhileItPlaysAndASecondOneAfterIt() throws Exception {
        open("plain.mkv");
        awaitGrey();
        assertEquals(0, count(SubtitlePanelWindowTest::isWhite));
        add(subtitles("0:00:00", "0:00:29"));
        Wait.until("the first", () -> count(SubtitlePanelWindowTest::isWhite) > 50);
        add(subtitles("0:00:40", "0:00:50"));
        Wait.until("the second", () -> count(SubtitlePanelWindowTest::isWhite) == 0);
    }

    @Test
    void aFileWithoutSubtitlesIsOneSentence() throws Exception {
        open("plain.mkv");
        awaitGrey();
        Path words = Files.writeString(folder.resolve("words.srt"), "nothing");
        add(words.toString());
        Wait.until("it is said", () -> notice() != null && notice().contains("words.srt"));
    }

    private void add(String path) throws Exception {
        press("shift T");
        Wait.until("there is a dialog", () -> chooser() != null);
        JFileChooser chooser = chooser();
        onWindow(() -> {
            chooser.setSelectedFile(new File(path));
            chooser.approveSelection();
            return null;
        });
        Wait.until("it is closed", () -> chooser() == null);
    }

    private static JFileChooser chooser() throws Exception {
        return onWindow(() -> {
            for (Window window : Window.getWindows()) {
                JFileChooser found = find(window, JFileChooser.class, null);
                if (found != null) {
                    return found;
                }
            }
            return null;
        });
    }

    private String subtitles(String from, String to) throws Exception {
        Path made = Files.createTempFile(folder, "lines", ".srt");
        Files.writeString(made, "1\n0" + from + ",000 --> 0" + to + ",000\nMMMMMM\n");
        return made.toString();
    }

    private Component choice(String name) throws Exception {
        Wait.until("there is " + name, () -> find(ChoiceButton.class, name) != null);
        return find(ChoiceButton.class, name);
    }

    private void awaitGrey() throws Exception {
        Wait.until("the picture shows", () -> count(color -> isNear(color, 0x404040)) > 1000);
    }

    private static boolean isWhite(Color color) {
        return isNear(color, 0xFFFFFF);
    }

    /** Of any brightness from that of a letter's edge on: mpv 0.40 draws small letters darker. */
    private static boolean isYellow(Color color) {
        int red = color.getRed();
        return red > 150 && color.getGreen() > red * 3 / 4 && color.getBlue() < red / 2;
    }

    private static boolean isBlue(Color color) {
        return isNear(color, 0x102060);
    }

    private static boolean isNear(Color color, int rgb) {
        Color wanted = new Color(rgb);
        return Math.abs(color.getRed() - wanted.getRed()) < 20
                && Math.abs(color.getGreen() - wanted.getGreen()) < 20
                && Math.abs(color.getBlue() - wanted.getBlue()) < 20;
    }

    private int count(Predicate<Color> isMeant) throws Exception {
        return (int) rows(isMeant)[0];
    }

    /** The middle row of such pixels, as a part of the height. */
    private double middle(Predicate<Color> isMeant) throws Exception {
        return rows(isMeant)[1];
    }

    // Where the picture is; words of the window itself are above.
    private double[] rows(Predicate<Color> isMeant) throws Exception {
        VideoPane video = find(VideoPane.class, null);
        if (video == null) {
            return new double[2];
        }
        BufferedImage image = onWindow(() -> {
            var made = new BufferedImage(
                    video.getWidth(), video.getHeight(), BufferedImage.TYPE_INT_RGB);
            video.paint(made.getGraphics());
            return made;
        });
        int count = 0;
        long sum = 0;
        for (int y = 0; y < image.getHeight(); y++) {
            for (int x = 0; x < image.getWidth(); x++) {
                if (isMeant.test(new Color(image.getRGB(x, y)))) {
                    count++;
                    sum += y;
                }
            }
        }
        return new double[] {count, sum / Math.max(1.0, count) / image.getHeight()};
    }
}
