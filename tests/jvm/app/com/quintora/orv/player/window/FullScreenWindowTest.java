// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertNotNull;

import com.quintora.mmp.Wait;
import javax.swing.JPopupMenu;
import org.junit.jupiter.api.Test;

/** The window over the whole screen. */
class FullScreenWindowTest extends WindowFixture {
    @Test
    void fullScreenCoversTheScreenAndComesBack() throws Exception {
        open("long.mkv");
        awaitPicture();
        Wait.until("it has the video's size", () -> frame.getWidth() < 854);
        int width = frame.getWidth();
        press("F");
        int screen = frame.getToolkit().getScreenSize().width;
        Wait.until("it is as wide as the screen", () -> frame.getWidth() == screen);
        assertNotNull(button("Leave full screen (F)"));
        press("ESCAPE");
        Wait.until("it has its old width", () -> frame.getWidth() == width);
        Wait.until("it plays on", () -> button("Pause (Space)") != null);
    }

    @Test
    void aMenuBringsTheHiddenControlsBack() throws Exception {
        open("tracks.mkv", "--loop");
        awaitButton("Pause (Space)");
        press("F");
        Wait.until("the controls hide", () -> find(ControlBar.class, null) == null);
        press("A");
        Wait.until("the menu shows", () -> find(JPopupMenu.class, null) != null);
        assertNotNull(find(ControlBar.class, null));
    }
}
