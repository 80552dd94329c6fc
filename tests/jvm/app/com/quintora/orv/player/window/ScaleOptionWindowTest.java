// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.Component;
import java.awt.Container;
import java.awt.Dimension;
import java.awt.Window;
import java.util.ArrayList;
import java.util.List;
import javax.swing.AbstractButton;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.JTextField;
import javax.swing.JViewport;
import javax.swing.SwingUtilities;
import javax.swing.UIManager;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** The window in the scales that Java does not know on X displays. */
class ScaleOptionWindowTest extends WindowFixture {
    private static final String[] PANELS = {"L", "T", "I", "shift L"};

    @AfterEach
    void beUsual() {
        Theme.scale(1);
    }

    @Test
    void controlsAndLettersGrowWithTheFactor() throws Exception {
        List<Integer> usual = measure("1");
        press("Q");
        playing.get();
        List<Integer> larger = measure("1.5");
        for (int i = 0; i < usual.size(); i++) {
            assertEquals(1.5 * usual.get(i), larger.get(i), 2, i + " of " + larger);
        }
    }

    private List<Integer> measure(String factor) throws Exception {
        open("long.mkv", "--loop", "--no-gpu", "--scale", factor);
        awaitButton("Pause (Space)");
        press("L");
        Wait.until("the list shows", () -> find(ListPanel.class, null) != null);
        return onWindow(() -> {
            frame.validate();
            Component bar = find(frame, ControlBar.class, null);
            Component play = find(frame, FlatButton.class, "Pause (Space)");
            return List.of(
                    bar.getHeight(),
                    play.getWidth(),
                    play.getHeight(),
                    find(frame, LevelBar.class, "Volume").getWidth(),
                    find(frame, LevelBar.class, "Position").getHeight(),
                    find(frame, ListPanel.class, null).getWidth(),
                    find(frame, JLabel.class, null).getFont().getSize(),
                    UIManager.getFont("Label.font").getSize(),
                    UIManager.getFont("ToolTip.font").getSize(),
                    UIManager.getFont("TextField.font").getSize());
        });
    }

    @ParameterizedTest
    @ValueSource(strings = {"1", "1.25", "1.5", "2"})
    void nothingIsCutOff(String factor) throws Exception {
        open("long.mkv", "--loop", "--no-gpu", "--scale", factor, Media.path("tracks.mkv"));
        awaitButton("Pause (Space)");
        awaitAllSeen("the bar");
        for (String key : PANELS) {
            press(key);
            awaitAllSeen(key);
        }
        Wait.until("the last one shows", () -> find(JTextField.class, "PIN") != null);
        press("ESCAPE");
        press("S");
        Wait.until("the menu shows", () -> onWindow(ChoiceMenu::isOpen));
        awaitAllSeen("the menu");
        press("ESCAPE");
        press("H");
        awaitAllSeen("the keys");
        press("H");
    }

    // It is laid out once more when the video's size is known.
    private static void awaitAllSeen(String what) throws Exception {
        List<String> last = new ArrayList<>();
        try {
            Wait.until("all is seen of " + what, () -> {
                last.clear();
                last.addAll(onWindow(ScaleOptionWindowTest::cutOff));
                return last.isEmpty();
            });
        } catch (AssertionError e) {
            assertEquals(List.of(), last, what);
        }
    }

    private static List<String> cutOff() {
        List<String> found = new ArrayList<>();
        int count = 0;
        for (Window window : Window.getWindows()) {
            if (window.isShowing()) {
                count += look(window, found);
            }
        }
        assertTrue(count > 10, "so few: " + count);
        return found;
    }

    /** Counts what has words or signs, and finds what has not enough room for them. */
    private static int look(Container parent, List<String> found) {
        int count = 0;
        for (Component child : parent.getComponents()) {
            if (!child.isShowing()) {
                continue;
            }
            if (child instanceof AbstractButton || child instanceof JLabel) {
                count++;
                if (isCut((JComponent) child)) {
                    found.add(child.getAccessibleContext().getAccessibleName() + " "
                            + child.getBounds() + " of " + child.getPreferredSize());
                }
            }
            count += child instanceof Container box ? look(box, found) : 0;
        }
        return count;
    }

    // What can be scrolled to is seen. Rows of boxes round by a pixel.
    private static boolean isCut(JComponent component) {
        Dimension seen = component.getVisibleRect().getSize();
        boolean scrolls =
                SwingUtilities.getAncestorOfClass(JViewport.class, component) != null;
        return component.getWidth() < widthOfWords(component)
                || component.getHeight() + 1 < heightOfWords(component)
                || !scrolls && !seen.equals(component.getSize());
    }

    private static int widthOfWords(JComponent component) {
        String words = words(component);
        return words.isEmpty()
                ? component.getPreferredSize().width
                : component.getFontMetrics(component.getFont()).stringWidth(words);
    }

    private static int heightOfWords(JComponent component) {
        return words(component).isEmpty()
                ? component.getPreferredSize().height
                : component.getFontMetrics(component.getFont()).getHeight();
    }

    private static String words(JComponent component) {
        String words =
                component instanceof JLabel label
                        ? label.getText()
                        : ((AbstractButton) component).getText();
        return words == null ? "" : words;
    }
}
