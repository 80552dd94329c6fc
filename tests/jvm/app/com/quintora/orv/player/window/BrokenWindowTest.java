// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.orv.player.Failure;
import com.quintora.orv.player.PlayOptions;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.FutureTask;
import java.util.concurrent.TimeUnit;
import javax.swing.JComponent;
import javax.swing.UIManager;
import javax.swing.plaf.ComponentUI;
import javax.swing.plaf.basic.BasicRootPaneUI;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** A window that cannot be opened although there is a display. */
class BrokenWindowTest {
    /** Cannot be put into a window. */
    public static final class TornCanvas extends BasicRootPaneUI {
        public static ComponentUI createUI(JComponent component) {
            return new TornCanvas();
        }

        @Override
        public void installUI(JComponent component) {
            throw new IllegalStateException("the canvas is torn");
        }
    }

    @AfterEach
    void mend() {
        UIManager.put("RootPaneUI", null);
    }

    @Test
    void itEndsThePlaybackInASentence() throws Exception {
        UIManager.put("RootPaneUI", TornCanvas.class.getName());
        PlayOptions options = PlayOptions.of("--no-memory", Media.path("short.mp4"));
        FutureTask<Integer> playing = new FutureTask<>(() -> PlayerWindow.play(options));
        new Thread(playing, "main").start();
        var thrown =
                assertThrows(
                        ExecutionException.class,
                        () -> playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        assertEquals(Failure.class, thrown.getCause().getClass());
        String sentence = thrown.getCause().getMessage();
        assertTrue(sentence.contains("the canvas is torn"), sentence);
        assertTrue(sentence.contains("--no-window"), sentence);
    }
}
