// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;

import com.quintora.mmp.Media;
import com.quintora.orv.player.GpuUse;
import com.quintora.orv.player.PlayOptions;
import com.quintora.orv.player.Session;
import java.awt.Frame;
import javax.swing.JLabel;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** What becomes of the player's refusals. */
class ConductorWindowTest {
    private final Stage stage = new Stage("test", new PictureWay(GpuUse.NEVER));
    private Session session;
    private Conductor conductor;

    @BeforeEach
    void open() throws Exception {
        PlayOptions options = PlayOptions.of("--no-memory", Media.path("short.mp4"));
        conductor = new Conductor(stage, options, options.playlist());
        session = conductor.playing().session();
        SwingUtilities.invokeAndWait(() -> stage.open(conductor, () -> {}));
    }

    @AfterEach
    void close() throws Exception {
        conductor.end();
        SwingUtilities.invokeAndWait(stage::close);
    }

    @Test
    void whatTheEngineRefusesIsAFailure() throws Exception {
        conductor.playing().failOn(() -> {
            throw new IllegalStateException("the engine refused start()");
        });
        assertEquals("the engine refused start()", conductor.failure().getMessage());
        assertNotNull(label("This cannot be played"));
    }

    @Test
    void noExceptionIsLost() {
        conductor.playing().failOn(() -> {
            throw new UnsupportedOperationException("later");
        });
        assertEquals(
                "the player failed: java.lang.UnsupportedOperationException: later",
                conductor.failure().getMessage());
    }

    @Test
    void theFirstFailureIsTheOneThatIsTold() {
        for (String words : new String[] {"first", "second"}) {
            conductor.playing().failOn(() -> {
                throw new IllegalStateException(words);
            });
        }
        assertEquals("first", conductor.failure().getMessage());
    }

    @Test
    void whatFailsAsTheWindowClosesIsNoFailure() {
        session.close();
        conductor.playing().failOn(() -> session.player().start());
        assertNull(conductor.failure());
    }

    private static JLabel label(String name) throws Exception {
        return WindowFixture.onWindow(() -> {
            for (Frame frame : Frame.getFrames()) {
                JLabel label = WindowFixture.find(frame, JLabel.class, name);
                if (label != null && label.isShowing()) {
                    return label;
                }
            }
            return null;
        });
    }
}
