// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.ScriptedHalf;
import com.quintora.mmp.Wait;
import java.awt.event.KeyEvent;
import javax.swing.JLabel;
import javax.swing.JPasswordField;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** The parental lock, on an engine that knows one. */
class ScriptedHalfLockWindowTest extends WindowFixture {
    private static final String REFUSED =
            "Not unlocked: the PIN is wrong, or nothing is locked here";

    private String taken = "";

    @AfterEach
    void forgetAnswers() {
        ScriptedHalf.answerWhenMade(null, 0);
    }

    @Test
    void aWrongPinIsRefusedAndTheRightOneUnlocks() throws Exception {
        open("short.mp4", "--no-gpu");
        awaitButton("Pause (Space)");
        openPanel();
        type("123");
        awaitAnswer("A PIN has 4 digits");
        ScriptedHalf.answer("setUnLockPin", -1);
        ScriptedHalf.takeCalls();
        type("1111");
        awaitAnswer(REFUSED);
        ScriptedHalf.answer("setUnLockPin", 0);
        type("0042");
        awaitAnswer("Unlocked");
        String calls = ScriptedHalf.takeCalls();
        assertTrue(calls.contains("setUnLockPin(1111)"), calls);
        assertTrue(calls.contains("setUnLockPin(42)"), calls);
        assertEquals("", onWindow(() -> new String(field().getPassword())), "is forgotten");
        press("ESCAPE");
        Wait.until("it is closed", () -> find(JPasswordField.class, null) == null);
    }

    @Test
    void whatWasLockedIsPlayedThen() throws Exception {
        ScriptedHalf.answerWhenMade("prepare", -1);
        open("short.mp4", "--no-gpu");
        Wait.until("it fails", () -> button("Open other files (O)").isShowing());
        ScriptedHalf.answerWhenMade(null, 0);
        openPanel();
        type("4711");
        Wait.until("another player plays it", () -> {
            taken += ScriptedHalf.takeCalls();
            return taken.contains("start(");
        });
        Wait.until("the picture is back", () -> !button("Open other files (O)").isShowing());
        int unlocked = taken.lastIndexOf("setUnLockPin(4711)");
        assertTrue(unlocked >= 0 && unlocked < taken.lastIndexOf("prepare"), taken);
    }

    private void openPanel() throws Exception {
        press("shift L");
        Wait.until("the panel shows", () -> find(JPasswordField.class, null) != null);
    }

    private JPasswordField field() {
        return find(frame, JPasswordField.class, "PIN");
    }

    /** As the keyboard does it, digit by digit, and Enter. */
    private void type(String digits) throws Exception {
        onWindow(() -> {
            for (char digit : digits.toCharArray()) {
                field().dispatchEvent(
                        new KeyEvent(field(), KeyEvent.KEY_TYPED, 0, 0, KeyEvent.VK_UNDEFINED,
                                digit));
            }
            return null;
        });
        press("ENTER");
    }

    private void awaitAnswer(String words) throws Exception {
        Wait.until("it says: " + words, () -> find(JLabel.class, words) != null);
    }
}
