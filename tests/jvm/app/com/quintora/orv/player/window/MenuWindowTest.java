// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import javax.swing.JMenuItem;
import javax.swing.MenuElement;
import javax.swing.MenuSelectionManager;
import org.junit.jupiter.api.Test;

/** The window's menus under the keyboard. */
class MenuWindowTest extends WindowFixture {
    @Test
    void arrowsMoveAndEnterChooses() throws Exception {
        open("tracks.mkv", "--loop");
        awaitButton("Pause (Space)");
        openMenu("A");
        String first = selected();
        int volume = volume();
        press("DOWN");
        String second = selected();
        assertTrue(!first.equals(second), first + " and " + second);
        press("UP");
        assertEquals(first, selected());
        press("DOWN");
        press("ENTER");
        assertFalse(menuShows());
        assertEquals(100, volume);
        assertEquals(volume, volume(), "the arrows are the menu's");
        openMenu("A");
        Wait.until("the chosen one is where the keyboard begins", () -> {
            if (second.equals(selected())) {
                return true;
            }
            press("ESCAPE");
            openMenu("A");
            return false;
        });
    }

    @Test
    void escapeClosesTheMenuAlone() throws Exception {
        open("tracks.mkv", "--loop");
        awaitButton("Pause (Space)");
        press("F");
        openMenu("S");
        press("ESCAPE");
        assertFalse(menuShows());
        assertNotNull(button("Leave full screen (F)"));
        press("ESCAPE");
        assertNotNull(button("Full screen (F)"));
    }

    @Test
    void theOtherKeysRest() throws Exception {
        open("tracks.mkv", "--loop");
        awaitButton("Pause (Space)");
        openMenu("S");
        for (String key : new String[] {"K", "M", "F", "H", "Q", "CLOSE_BRACKET", "LEFT"}) {
            press(key);
        }
        assertNull(find(Help.class, null));
        assertNotNull(button("Full screen (F)"));
        assertNotNull(button("Mute (M)"));
        assertNotNull(button("Pause (Space)"));
        press("ESCAPE");
        press("M");
        awaitButton("Unmute (M)");
    }

    private void openMenu(String key) throws Exception {
        press(key);
        Wait.until("the menu shows", MenuWindowTest::menuShows);
        Wait.until("the keyboard is in it", () -> selected() != null);
    }

    private int volume() throws Exception {
        return onWindow(find(LevelBar.class, "Volume")::value);
    }

    /** In the window, or in one of its own. */
    private static boolean menuShows() throws Exception {
        return onWindow(() -> {
            MenuElement[] path = MenuSelectionManager.defaultManager().getSelectedPath();
            return path.length > 0 && path[0].getComponent().isShowing();
        });
    }

    /** The text of the menu's item at which the keyboard is, or null. */
    private static String selected() throws Exception {
        return onWindow(() -> {
            MenuElement[] path = MenuSelectionManager.defaultManager().getSelectedPath();
            MenuElement last = path.length == 0 ? null : path[path.length - 1];
            return last instanceof JMenuItem item ? item.getText() : null;
        });
    }
}
