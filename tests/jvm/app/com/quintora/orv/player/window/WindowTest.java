// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.util.concurrent.TimeUnit;
import javax.swing.JLabel;
import javax.swing.JPopupMenu;
import javax.swing.JTextArea;
import org.junit.jupiter.api.Test;

/** The window, on a display, with real media. */
class WindowTest extends WindowFixture {
    @Test
    void itShowsThePictureAndPlaysOn() throws Exception {
        open("long.mkv");
        awaitPicture();
        Wait.until("the time moves", () -> !label().equals("0:00"));
        assertEquals("long.mkv", frame.getTitle());
    }

    @Test
    void spacePausesAndPlays() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("SPACE");
        awaitButton("Pause (Space)");
    }

    @Test
    void keysMoveInTime() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("RIGHT");
        press("RIGHT");
        awaitSecond(18, 21);
        press("LEFT");
        awaitSecond(7, 11);
        press("HOME");
        awaitSecond(0, 0);
    }

    /** Key frames are 15 seconds apart. */
    @Test
    void skipsAreExactBetweenKeyFrames() throws Exception {
        open("distant.mkv", "--start", "12");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        int start = second();
        assertTrue(start >= 11, start + " s");
        press("shift RIGHT");
        awaitSecond(start + 1, start + 1);
        Wait.until("it says so", () -> ("+ 1 s  " + label()).equals(notice()));
        press("LEFT");
        awaitSecond(start - 9, start - 9);
        Wait.until("it says so", () -> ("− 10 s  " + label()).equals(notice()));
        press("HOME");
        awaitSecond(0, 0);
    }

    @Test
    void aSkipBeyondTheEndSaysHowFarItWent() throws Exception {
        open("distant.mkv", "--start", "25");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("PAGE_DOWN");
        awaitSecond(29, 29);
        Wait.until("it says so", () -> notice().matches("\\+ [2-5](\\.\\d)? s  0:29"));
    }

    @Test
    void whatPlayedPlaysOnAfterASkip() throws Exception {
        open("distant.mkv");
        awaitButton("Pause (Space)");
        press("RIGHT");
        awaitSecond(10, 12);
        awaitButton("Pause (Space)");
        int before = second();
        Wait.until("it goes on", () -> second() > before);
    }

    @Test
    void aStepPauses() throws Exception {
        open("distant.mkv");
        awaitButton("Pause (Space)");
        press("PERIOD");
        awaitButton("Play (Space)");
        press("HOME");
        awaitSecond(0, 0);
        press("COMMA");
        Wait.until("it says so", () -> "This is the first frame".equals(notice()));
    }

    @Test
    void tracksAreOfferedWhereThereAreSome() throws Exception {
        open("tracks.mkv");
        awaitButton("Pause (Space)");
        assertTrue(button("Audio track (A)").isEnabled());
        assertTrue(button("Subtitles (S)").isEnabled());
    }

    @Test
    void whatHasNoSubtitlesOffersNone() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        assertFalse(button("Subtitles (S)").isEnabled());
        press("S");
        Wait.until("it says so", () -> "No subtitles".equals(notice()));
        assertNull(find(JPopupMenu.class, null));
    }

    @Test
    void theKeysAreListedOnRequest() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        press("H");
        assertNotNull(find(Help.class, null));
        assertNotNull(find(JLabel.class, "Play or pause"));
        press("ESCAPE");
        assertNull(find(Help.class, null));
    }

    @Test
    void aSoundFileShowsItsCover() throws Exception {
        open("covered.mp3");
        awaitPicture();
    }

    @Test
    void noticesStandOnAMessageToo() throws Exception {
        open("tone.mp3");
        awaitButton("Pause (Space)");
        NoticePane room = find(NoticePane.class, null);
        Wait.until("the title shows", () -> find(MessagePanel.class, null) != null);
        assertTrue(brightest(room, 37) < 100, "nothing stands there");
        press("S");
        Wait.until("it says so", () -> brightest(room, 37) > 100);
    }

    @Test
    void aFailureIsSaidInTheWindow() throws Exception {
        open("noise.bin");
        Wait.until("it says so", () -> find(JLabel.class, "This cannot be played") != null);
        JTextArea sentence = find(JTextArea.class, null);
        assertTrue(sentence.getText().startsWith(Media.path("noise.bin")), sentence.getText());
        assertFalse(button("Play (Space)").isEnabled());
        press("Q");
        assertEquals(1, playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
    }
}
