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
    void aFrameIsCopiedAndPaintedOnceAndNotScaled() throws Exception {
        VideoPane.Work before = work();
        awaitSecond(second() + 2, 59);
        pause();
        VideoPane.Work after = work();
        long frames = after.copies() - before.copies();
        assertTrue(frames > 10, frames + " frames");
        // One that was copied before the first look may be painted after it.
        assertTrue(after.paintings() - before.paintings() <= frames + 1, after + " - " + before);
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
        Wait.until("a picture is drawn", () -> work().copies() > before.copies());
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
            var image = new BufferedImage(
                    video.getWidth(), video.getHeight(), BufferedImage.TYPE_INT_RGB);
            video.paint(image.getGraphics());
            return image.getRGB(0, 0, image.getWidth(), image.getHeight(), null, 0, image.getWidth());
        });
    }
}
