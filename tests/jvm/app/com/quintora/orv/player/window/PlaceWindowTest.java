// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import com.quintora.orv.player.Times;
import java.awt.Color;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.HashSet;
import java.util.List;
import java.util.Set;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import javax.swing.JLabel;
import javax.swing.JPanel;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** Ways to a place in the media, and how the window shows it. */
class PlaceWindowTest extends WindowFixture {
    private static final Pattern TIME = Pattern.compile("distant-0000h00m(\\d\\d)s(\\d{3}).*");

    @TempDir Path folder;
    private final Set<String> known = new HashSet<>();

    @Test
    void keysAndTheMenuLeadToChapters() throws Exception {
        open("feature.mkv", "--no-gpu");
        pause();
        press("shift N");
        awaitNotice("Глава вторая  0:02");
        awaitSecond(2, 2);
        press("shift N");
        awaitNotice("終章  0:06");
        press("shift N");
        awaitNotice("This is the last chapter");
        press("shift P");
        awaitNotice("Глава вторая  0:02");
        press("C");
        Wait.until("the chapters are listed", () -> onWindow(ChoiceMenu::isOpen));
        press("DOWN");
        press("ENTER");
        awaitNotice("終章  0:06");
        awaitSecond(6, 6);
    }

    /** Key frames are 15 seconds apart; a screenshot's name has the time of the frame that shows. */
    @Test
    void aSkipShowsTheFrameThatTheNoticeSays() throws Exception {
        open("distant.mkv", "--no-gpu", "--screenshot-folder", folder.toString());
        pause();
        int from = shownMillis(1);
        press("RIGHT");
        awaitNotice("+ 10 s  " + Times.clock(from + 10_000));
        assertEquals(from + 10_000, shownMillis(2), 34);
        press("shift LEFT");
        awaitNotice("− 1 s  " + Times.clock(from + 9_000));
        assertEquals(from + 9_000, shownMillis(3), 34);
    }

    @Test
    void mediaWithoutChaptersSayIt() throws Exception {
        open("video.mp4", "--no-gpu");
        pause();
        press("shift N");
        awaitNotice("The media has no chapters");
        press("C");
        awaitNotice("No chapters");
    }

    @Test
    void aSectionIsMarkedByKeysShownRepeatedAndEnded() throws Exception {
        open("video.mp4", "--no-gpu");
        pause();
        press("shift B");
        awaitNotice("A section ends after its beginning, which is to be marked first");
        assertEquals(0, marked());
        goTo(4);
        press("shift A");
        awaitNotice("A section begins at 0:04");
        goTo(6);
        Wait.until("its beginning is shown", () -> marked() == 2);
        press("shift B");
        awaitNotice("Repeats 0:04 to 0:06");
        Wait.until("it is shown", () -> Math.abs(marked() - barWidth() / 5) < 8);
        press("SPACE");
        for (int round = 0; round < 2; round++) {
            awaitSecond(5, 5);
            awaitSecond(4, 4);
        }
        press("BACK_SPACE");
        awaitNotice("No section is repeated");
        assertEquals(0, marked());
        awaitSecond(7, 9);
    }

    @Test
    void aSectionOfTheOptionsIsShown() throws Exception {
        open("video.mp4", "--no-gpu", "--ab", "4:6");
        awaitPicture();
        Wait.until("it is shown", () -> Math.abs(marked() - barWidth() / 5) < 8);
        press("BACK_SPACE");
        awaitSecond(7, 9);
        assertEquals(0, marked());
    }

    @Test
    void aClickOnTheLengthShowsWhatRemains() throws Exception {
        open("video.mp4", "--no-gpu");
        pause();
        goTo(4);
        JLabel length = length();
        Wait.until("it is the length", () -> "0:10".equals(onWindow(length::getText)));
        click(length);
        Wait.until("it is the rest", () -> "−0:06".equals(onWindow(length::getText)));
        click(length);
        Wait.until("it is the length", () -> "0:10".equals(onWindow(length::getText)));
    }

    @ParameterizedTest
    @ValueSource(strings = {"--no-gpu", "--gpu"})
    void theWheelChangesTheVolumeAndTwoClicksTheScreen(String way) throws Exception {
        open("long.mkv", way, "--loop");
        awaitPicture();
        awaitButton("Pause (Space)");
        NoticePane picture = find(NoticePane.class, null);
        pointAt(picture, 0.5, 0.6);
        robot().mouseWheel(2);
        awaitNotice("Volume 90%");
        robot().mouseWheel(-1);
        awaitNotice("Volume 95%");
        click(picture);
        click(picture);
        Wait.until("the picture fills the screen", () -> onWindow(frame::isUndecorated));
        awaitButton("Pause (Space)");
    }

    /** Of so many pictures, the new one's time. */
    private int shownMillis(int count) throws Exception {
        press("shift S");
        Wait.until("there are " + count + " pictures", () -> pictures().size() == count);
        String newest = pictures().stream().filter(known::add).findFirst().orElseThrow();
        Matcher time = TIME.matcher(newest);
        assertTrue(time.matches(), newest);
        return Integer.parseInt(time.group(1)) * 1000 + Integer.parseInt(time.group(2));
    }

    private List<String> pictures() throws IOException {
        try (var files = Files.list(folder)) {
            return files.map(file -> file.getFileName().toString())
                    .filter(name -> name.endsWith(".png"))
                    .toList();
        }
    }

    private void pause() throws Exception {
        awaitPicture();
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
    }

    /** While it rests, on key frames and elsewhere alike. */
    private void goTo(int second) throws Exception {
        SeekBar bar = find(SeekBar.class, null);
        onWindow(() -> {
            bar.set(second / 10.0);
            return null;
        });
        awaitSecond(second, second);
    }

    private int barWidth() throws Exception {
        SeekBar bar = find(SeekBar.class, null);
        return onWindow(bar::getWidth);
    }

    /** How many columns of the bar have the colour of sections. */
    private int marked() throws Exception {
        SeekBar bar = find(SeekBar.class, null);
        return onWindow(() -> {
            var image =
                    new BufferedImage(bar.getWidth(), bar.getHeight(), BufferedImage.TYPE_INT_RGB);
            bar.paint(image.getGraphics());
            int columns = 0;
            for (int x = 0; x < image.getWidth(); x++) {
                Color color = new Color(image.getRGB(x, image.getHeight() / 2));
                columns += color.equals(Theme.SECTION) ? 1 : 0;
            }
            return columns;
        });
    }

    private JLabel length() throws Exception {
        SeekBar bar = find(SeekBar.class, null);
        return onWindow(() -> (JLabel) ((JPanel) bar.getParent()).getComponent(2));
    }

    private void awaitNotice(String words) throws Exception {
        Wait.until("it says: " + words, () -> words.equals(notice()));
    }
}
