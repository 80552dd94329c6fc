// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.awt.Dimension;
import java.awt.event.WindowEvent;
import java.awt.image.BufferedImage;
import java.util.Arrays;
import javax.swing.RepaintManager;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** The window draws nothing that nobody sees, and nothing twice. */
class SparingWindowTest extends WindowFixture {
    private VideoPane video;

    @BeforeEach
    void openFilm() throws Exception {
        open("long.mkv");
        awaitPicture();
        video = find(VideoPane.class, null);
        Wait.until("frames are as large as shown", () -> onWindow(() -> {
            Dimension room = video.room();
            Dimension frame = video.pictureSize();
            return frame.equals(
                    VideoPane.fit(frame.width, frame.height, room.width, room.height).getSize());
        }));
    }

    @Test
    void paintingAFrameCopiesItOnceAndScalesNothing() throws Exception {
        pause();
        VideoPane.Work before = work();
        press("SPACE");
        awaitSecond(second() + 2, 59);
        pause();
        VideoPane.Work after = work();
        long paintings = after.paintings() - before.paintings();
        assertTrue(paintings > 10, paintings + " paintings");
        Dimension frame = onWindow(video::pictureSize);
        assertEquals(
                paintings * frame.width * frame.height,
                after.copiedPixels() - before.copiedPixels());
        assertEquals(before.scalings(), after.scalings());
    }

    @Test
    void theControlsAreRepaintedWithoutThePicture() throws Exception {
        pause();
        ControlBar bar = find(ControlBar.class, null);
        VideoPane.Work before = work();
        SwingUtilities.invokeAndWait(() -> {
            bar.repaint();
            bar.seekBar().showPosition(3_000, 10_000, 0);
            RepaintManager.currentManager(bar).paintDirtyRegions();
        });
        assertEquals(before, work());
    }

    @Test
    void aMinimisedWindowDrawsNothingAndShowsTheNewestPictureAfterwards() throws Exception {
        int[] last = picture();
        report(WindowEvent.WINDOW_ICONIFIED);
        // Carried out in turn: the window counts as minimised when these are.
        pause();
        VideoPane.Work before = work();
        press("SPACE");
        awaitSecond(second() + 2, 59);
        pause();
        assertEquals(before, work());
        report(WindowEvent.WINDOW_DEICONIFIED);
        Wait.until("a picture is drawn", () -> work().paintings() > before.paintings());
        assertFalse(Arrays.equals(last, picture()), "it is another picture");
    }

    private void pause() throws Exception {
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
    }

    // Without a window manager no window can be minimised.
    private void report(int event) throws Exception {
        SwingUtilities.invokeAndWait(() -> frame.dispatchEvent(new WindowEvent(frame, event)));
    }

    private VideoPane.Work work() throws Exception {
        return onWindow(video::work);
    }

    private int[] picture() throws Exception {
        return onWindow(() -> {
            int width = video.getWidth();
            int height = video.getHeight();
            var image = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
            video.paint(image.getGraphics());
            return image.getRGB(0, 0, width, height, null, 0, width);
        });
    }
}
