// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.view.SurfaceView;
import com.quintora.mmp.Wait;
import java.awt.Component;
import java.awt.Frame;
import java.awt.Window;
import java.io.ByteArrayOutputStream;
import java.io.PrintStream;
import java.nio.charset.StandardCharsets;
import java.util.Arrays;
import java.util.concurrent.TimeUnit;
import javax.swing.JWindow;
import org.junit.jupiter.api.Test;

/** The player's window while the graphics processor, software here, draws its picture. */
class GpuWindowTest extends WindowFixture {
    @Test
    void thePictureShowsAndFollowsTheFullScreenAndTheWindowsSize() throws Exception {
        open("video.mp4", "--gpu");
        awaitScreen();
        press("F");
        awaitScreen();
        assertTrue(shownView().getWidth() > 1000, "over the whole screen");
        press("F");
        awaitScreen();
        onWindow(() -> {
            frame.setSize(700, 600);
            return null;
        });
        Wait.until("the view is as wide", () -> shownView().getWidth() > 650);
        awaitScreen();
        onWindow(() -> {
            frame.setState(Frame.ICONIFIED);
            frame.setState(Frame.NORMAL);
            return null;
        });
        awaitScreen();
    }

    @Test
    void keysAreListedInPlaceOfThePicture() throws Exception {
        open("video.mp4", "--gpu");
        awaitScreen();
        press("H");
        Wait.until("the keys are listed", () -> find(Help.class, null) != null);
        assertNull(find(SurfaceView.class, null));
        press("H");
        awaitScreen();
    }

    @Test
    void wordsLieOverThePicture() throws Exception {
        open("video.mp4", "--gpu");
        awaitScreen();
        press("UP");
        Wait.until("the volume is shown", GpuWindowTest::hasWords);
        Wait.until("it goes again", () -> !hasWords());
    }

    @Test
    void menusLieOverThePicture() throws Exception {
        open("video.mp4", "--gpu");
        awaitScreen();
        press("A");
        Wait.until("a menu is open", () -> onWindow(ChoiceMenu::isOpen));
        assertTrue(onWindow(() -> Arrays.stream(Window.getWindows())
                .anyMatch(window -> window instanceof JWindow && window.isShowing())));
    }

    @Test
    void statsTellTheWay() throws Exception {
        assertTrue(statsOf("--gpu").contains("drawn by the graphics processor: llvmpipe"));
    }

    @Test
    void statsTellWhyNot() throws Exception {
        assertTrue(statsOf("--no-gpu").contains("drawn by software: --no-gpu"));
    }

    private String statsOf(String option) throws Exception {
        ByteArrayOutputStream bytes = new ByteArrayOutputStream();
        PrintStream before = System.out;
        System.setOut(new PrintStream(bytes, true, StandardCharsets.UTF_8));
        try {
            open("video.mp4", option, "--stats");
            awaitSecond(1, 9);
            press("Q");
            assertEquals(0, playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        } finally {
            System.setOut(before);
        }
        String out = bytes.toString(StandardCharsets.UTF_8);
        assertTrue(out.matches("(?s).*; [1-9]\\d+ frames shown.*"), out);
        assertFalse(out.isEmpty());
        return out;
    }

    private SurfaceView shownView() throws Exception {
        return find(SurfaceView.class, null);
    }

    private static boolean hasWords() throws Exception {
        return onWindow(() -> Arrays.stream(Window.getWindows())
                .anyMatch(window -> window instanceof JWindow && window.isShowing()));
    }

    /** Waits until the screen shows a picture where the view is. */
    private void awaitScreen() throws Exception {
        Wait.until("the screen shows a picture", () -> {
            Component view = shownView();
            return view != null && brightestOnScreen(view) > 100;
        });
    }
}
