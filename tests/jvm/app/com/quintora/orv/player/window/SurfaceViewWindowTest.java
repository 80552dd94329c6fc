// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.view.SurfaceHolder;
import com.quintora.mmp.Media;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.Wait;
import com.quintora.mmp.desktop.DesktopSurfaceView;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.EventQueue;
import java.awt.Frame;
import java.awt.Point;
import java.awt.Rectangle;
import java.awt.Robot;
import java.awt.image.BufferedImage;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.Callable;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** A surface of the desktop, drawn on by OpenGL, which is software here, and without. */
class SurfaceViewWindowTest {
    private final List<String> calls = new ArrayList<>();
    private final OrvMediaPlayer player = new OrvMediaPlayer();
    private Frame frame;
    private DesktopSurfaceView view;
    private volatile boolean keepsSurface;

    @AfterEach
    void close() throws Exception {
        EventQueue.invokeAndWait(() -> frame.dispose());
        player.close();
    }

    private void open(boolean byGpu) throws Exception {
        EventQueue.invokeAndWait(
                () -> {
                    view = new DesktopSurfaceView(byGpu);
                    view.getHolder().addCallback(new Calls());
                    frame = new Frame();
                    frame.setUndecorated(true);
                    frame.add(view);
                    frame.setBounds(50, 50, 320, 180);
                    frame.setVisible(true);
                });
        Wait.until("the surface has a size", () -> onEvents(() -> calls.contains("320 x 180")));
        player.setDataSource(Media.path("video.mp4"));
        player.prepareAndWait();
        player.start();
        awaitPicture();
        assertEquals(byGpu, view.isDrawnByGpu(), view.describeDrawing());
        assertTrue(view.describeDrawing().contains("llvmpipe"), view.describeDrawing());
    }

    @ParameterizedTest
    @ValueSource(booleans = {true, false})
    void itsPictureFollowsItsSize(boolean byGpu) throws Exception {
        open(byGpu);
        EventQueue.invokeAndWait(() -> frame.setSize(640, 360));
        Wait.until("the size is reported", () -> onEvents(() -> calls.contains("640 x 360")));
        Wait.until("the picture fills it", () -> brightest(500, 600, 250) > 100);
        EventQueue.invokeAndWait(() -> frame.setLocation(200, 100));
        awaitPicture();
    }

    @ParameterizedTest
    @ValueSource(booleans = {true, false})
    void itGoesAndComesWithItsWindow(boolean byGpu) throws Exception {
        open(byGpu);
        EventQueue.invokeAndWait(() -> frame.dispose());
        assertEquals("destroyed", calls.get(calls.size() - 1));
        assertNull(view.getHolder().getSurface());
        int before = player.getCurrentPosition();
        Wait.until("it plays on", () -> player.getCurrentPosition() > before);
        EventQueue.invokeAndWait(() -> frame.setVisible(true));
        awaitPicture();
        assertEquals(byGpu, view.isDrawnByGpu());
        assertTrue(player.isPlaying());
    }

    @ParameterizedTest
    @ValueSource(booleans = {true, false})
    void itMayGoWhileAPlayerStillHasIt(boolean byGpu) throws Exception {
        open(byGpu);
        keepsSurface = true;
        EventQueue.invokeAndWait(() -> frame.dispose());
        int before = player.getCurrentPosition();
        Wait.until("it plays on", () -> player.getCurrentPosition() > before);
    }

    @ParameterizedTest
    @ValueSource(booleans = {true, false})
    void itKeepsItsPictureWhileItIsHeld(boolean byGpu) throws Exception {
        open(byGpu);
        player.pause();
        view.hold(true);
        player.seekToAndWait(5_000);
        while (view.awaitFrame(100) >= 0) {
            // Those from before.
        }
        player.seekToAndWait(7_000);
        assertEquals(-1, view.awaitFrame(300));
        view.hold(false);
        Wait.until(
                "the newest frame shows",
                () ->
                        Math.abs(view.awaitFrame(100) / 1_000_000 - player.getCurrentPosition())
                                < 20);
    }

    private void awaitPicture() throws Exception {
        Wait.until("a picture shows", () -> brightest(20, 300, 120) > 100);
    }

    /** The brightest red or blue on the screen, in a row of the view. */
    private int brightest(int from, int to, int row) throws Exception {
        Point place = onEvents(() -> view.isShowing() ? view.getLocationOnScreen() : null);
        if (place == null) {
            return 0;
        }
        Dimension size = new Dimension(to - from, 1);
        BufferedImage screen =
                new Robot()
                        .createScreenCapture(
                                new Rectangle(
                                        new Point(place.x + from, place.y + row), size));
        int brightest = 0;
        for (int x = 0; x < size.width; x++) {
            Color color = new Color(screen.getRGB(x, 0));
            brightest = Math.max(brightest, Math.max(color.getRed(), color.getBlue()));
        }
        return brightest;
    }

    private static <T> T onEvents(Callable<T> question) throws Exception {
        return WindowFixture.onWindow(question);
    }

    private final class Calls implements SurfaceHolder.Callback {
        @Override
        public void surfaceCreated(SurfaceHolder holder) {
            calls.add("created");
            player.setSurface(holder.getSurface());
        }

        @Override
        public void surfaceChanged(SurfaceHolder holder, int format, int width, int height) {
            calls.add(width + " x " + height);
        }

        @Override
        public void surfaceDestroyed(SurfaceHolder holder) {
            calls.add("destroyed");
            if (!keepsSurface) {
                player.setSurface(null);
            }
        }
    }
}
