// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.Wait;
import java.awt.event.MouseEvent;
import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import javax.swing.JPanel;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.Test;

/** What one click does, and what two. */
class ClicksTest {
    private final List<String> calls = Collections.synchronizedList(new ArrayList<>());
    private final Clicks clicks = new Clicks(() -> calls.add("one"), () -> calls.add("two"));

    @Test
    void oneIsOneAfterAWhile() throws Exception {
        click(MouseEvent.BUTTON1, 1);
        Wait.until("it is one", () -> calls.equals(List.of("one")));
    }

    @Test
    void ofTwoTheFirstDoesNothing() throws Exception {
        click(MouseEvent.BUTTON1, 1, 2);
        assertEquals(List.of("two"), calls);
        click(MouseEvent.BUTTON1, 1);
        Wait.until("the next is one again", () -> calls.equals(List.of("two", "one")));
    }

    @Test
    void whatASlowFirstOneDidIsUndone() throws Exception {
        click(MouseEvent.BUTTON1, 1);
        Wait.until("it is one", () -> calls.equals(List.of("one")));
        click(MouseEvent.BUTTON1, 2);
        assertEquals(List.of("one", "one", "two"), calls);
    }

    @Test
    void otherButtonsDoNothing() throws Exception {
        click(MouseEvent.BUTTON3, 1, 2);
        click(MouseEvent.BUTTON1, 1);
        Wait.until("a click is one", () -> calls.equals(List.of("one")));
    }

    private void click(int button, int... counts) throws Exception {
        SwingUtilities.invokeAndWait(
                () -> {
                    for (int count : counts) {
                        clicks.mouseClicked(
                                new MouseEvent(new JPanel(), MouseEvent.MOUSE_CLICKED, 0, 0, 0, 0,
                                        count, false, button));
                    }
                });
    }
}
