// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.awt.Dimension;
import java.awt.event.MouseEvent;
import java.awt.image.BufferedImage;
import java.util.stream.IntStream;
import javax.swing.JPopupMenu;
import javax.swing.SwingUtilities;
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

    @Test
    void theBarLiesOverThePictureWhichStaysAsItIs() throws Exception {
        open("long.mkv", "--loop");
        awaitButton("Pause (Space)");
        press("F");
        Dimension screen = frame.getToolkit().getScreenSize();
        VideoPane video = find(VideoPane.class, null);
        Wait.until("the controls hide", () -> find(ControlBar.class, null) == null);
        assertEquals(screen, onWindow(video::getSize));
        Wait.until("the picture is as wide", () -> video.pictureSize().width == screen.width);
        int bottom = (screen.height + video.pictureSize().height) / 2 - 3;
        assertTrue(colours(screen, bottom) > 1, "the picture's last rows show");
        moveMouse();
        Wait.until("the controls show", () -> find(ControlBar.class, null) != null);
        assertEquals(screen, onWindow(video::getSize));
        Wait.until("frames come", () -> video.pictureSize().width == screen.width);
        ControlBar bar = find(ControlBar.class, null);
        assertEquals(screen.height, onWindow(() -> bar.getY() + bar.getHeight()));
        // A new frame must not be painted over the bar.
        int shown = second();
        Wait.until("it goes on", () -> second() > shown);
        int free = onWindow(() -> bar.getY() + bar.getHeight()) - 3;
        assertEquals(1, colours(screen, free), "the bar's last rows cover what is below");
    }

    @Test
    void inAWindowTheBarIsBelowThePicture() throws Exception {
        open("long.mkv");
        awaitPicture();
        NoticePane picture = find(NoticePane.class, null);
        ControlBar bar = find(ControlBar.class, null);
        // The first picture may show before the window has its size.
        Wait.until("it is below", () -> isBelow(bar, picture));
        press("F");
        press("F");
        Wait.until("it is below again", () -> isBelow(bar, picture));
    }

    private boolean isBelow(ControlBar bar, NoticePane picture) throws Exception {
        return onWindow(() -> picture.getY() + picture.getHeight() == bar.getY());
    }

    private void moveMouse() throws Exception {
        VideoPane video = find(VideoPane.class, null);
        SwingUtilities.invokeAndWait(() -> video.dispatchEvent(
                new MouseEvent(video, MouseEvent.MOUSE_MOVED, 0, 0, 50, 50, 0, false)));
    }

    /** How many colours there are in a row of the window. */
    private long colours(Dimension screen, int y) throws Exception {
        return onWindow(() -> {
            var image =
                    new BufferedImage(screen.width, screen.height, BufferedImage.TYPE_INT_RGB);
            frame.getContentPane().paint(image.getGraphics());
            return IntStream.range(0, screen.width).map(x -> image.getRGB(x, y)).distinct().count();
        });
    }
}
