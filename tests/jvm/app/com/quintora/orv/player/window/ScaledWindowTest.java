// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.Wait;
import java.awt.Dimension;
import org.junit.jupiter.api.Test;

/** The window on a screen with a scale factor of 2. */
class ScaledWindowTest extends WindowFixture {
    static {
        // Read once, when the first window class is loaded.
        System.setProperty("sun.java2d.uiScale", "2");
    }

    @Test
    void framesHaveTheScreensOwnPixels() throws Exception {
        open("long.mkv");
        awaitPicture();
        VideoPane video = find(VideoPane.class, null);
        assertEquals(2, frame.getGraphicsConfiguration().getDefaultTransform().getScaleX());
        awaitFramesOf(video);
        press("F");
        int screen = frame.getToolkit().getScreenSize().width;
        Wait.until("it is as wide as the screen", () -> video.getWidth() == screen);
        awaitFramesOf(video);
    }

    private static void awaitFramesOf(VideoPane video) throws Exception {
        Wait.until(
                "a frame is as wide, or as high, as the room has pixels",
                () -> {
                    Dimension room = new Dimension(2 * video.getWidth(), 2 * video.getHeight());
                    Dimension picture = onWindow(video::pictureSize);
                    return picture.width == room.width && picture.height <= room.height
                            || picture.height == room.height && picture.width <= room.width;
                });
    }
}
