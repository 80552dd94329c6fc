// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.awt.Toolkit;
import java.awt.datatransfer.DataFlavor;
import java.awt.event.KeyEvent;
import javax.swing.JTextArea;
import javax.swing.JTextField;
import org.junit.jupiter.api.Test;

/** What the panels of information and of the log say. */
class PanelsWindowTest extends WindowFixture {
    @Test
    void informationIsOfTheMediaAndFollowsIt() throws Exception {
        open("plain.mkv", "--no-gpu");
        awaitButton("Pause (Space)");
        press("I");
        Wait.until("it is there", () -> words("Information").contains("Picture: 640x360"));
        String words = words("Information");
        assertTrue(words.contains("plain.mkv"), words);
        assertTrue(words.contains("Frame rate: 30.000 per second"), words);
        assertTrue(words.contains("pictures drawn by software: --no-gpu"), words);
        assertTrue(words.contains("State: started"), words);
        Wait.until("frames are counted", () -> {
            String now = words("Information");
            return line(now, "Frames").matches("Frames: [1-9]\\d+ shown, \\d+ dropped")
                    && !line(now, "Frames").equals(line(words, "Frames"));
        });
        press("SPACE");
        Wait.until("it says so", () -> words("Information").contains("State: paused"));
    }

    @Test
    void linesOfTheLogAreFilteredAndCopied() throws Exception {
        open("plain.mkv", "--no-gpu");
        awaitButton("Pause (Space)");
        press("G");
        press("ESCAPE");
        Wait.until("it is closed", () -> find(JTextField.class, null) == null);
        press("M");
        press("G");
        Wait.until("it is open", () -> find(JTextField.class, null) != null);
        String name = "Lines of the log";
        Wait.until("lines come", () -> words(name).contains("OrvMedia"));
        type("getDuration");
        Wait.until(
                "only those",
                () -> !words(name).isEmpty()
                        && words(name).lines().allMatch(line -> line.contains("getDuration")));
        click(button("Copy the lines shown"));
        Wait.until("it is said", () -> "Copied".equals(notice()));
        String copied =
                (String) Toolkit.getDefaultToolkit()
                        .getSystemClipboard()
                        .getData(DataFlavor.stringFlavor);
        assertTrue(copied.lines().allMatch(line -> line.contains("getDuration")), copied);
        assertFalse(copied.isEmpty());
        press("Q");
        assertTrue(frame.isShowing(), "letters go into the field");
        press("ESCAPE");
        Wait.until("it is closed", () -> find(JTextField.class, null) == null);
    }

    @Test
    void fewerLinesShowFromAHigherPriorityOn() throws Exception {
        open("plain.mkv", "--no-gpu");
        awaitButton("Pause (Space)");
        press("G");
        Wait.until("lines come", () -> words("Lines of the log").contains("OrvMedia"));
        for (int i = 0; i < 3; i++) {
            click(button("Fewer lines"));
        }
        Wait.until("none is fatal", () -> words("Lines of the log").isEmpty());
        for (int i = 0; i < 5; i++) {
            click(button("More lines"));
        }
        Wait.until("there are lines", () -> words("Lines of the log").contains("OrvMedia"));
    }

    private void type(String text) throws Exception {
        JTextField field = find(JTextField.class, "Text to look for in the log");
        onWindow(() -> {
            for (char letter : text.toCharArray()) {
                field.dispatchEvent(
                        new KeyEvent(field, KeyEvent.KEY_TYPED, 0, 0, KeyEvent.VK_UNDEFINED,
                                letter));
            }
            return null;
        });
    }

    private String words(String name) throws Exception {
        JTextArea area = find(JTextArea.class, name);
        return area == null ? "" : onWindow(area::getText);
    }

    private static String line(String words, String start) {
        return words.lines().filter(line -> line.startsWith(start)).findFirst().orElse("");
    }
}
