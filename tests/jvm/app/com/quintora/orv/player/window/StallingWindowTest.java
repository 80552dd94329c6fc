// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.orv.player.StallingServer;
import java.io.ByteArrayOutputStream;
import java.io.PrintStream;
import java.net.ServerSocket;
import java.nio.charset.StandardCharsets;
import java.util.concurrent.TimeUnit;
import javax.swing.JLabel;
import javax.swing.JTextArea;
import org.junit.jupiter.api.Test;

/** What the window shows while a server keeps it waiting, and how it closes then. */
class StallingWindowTest extends WindowFixture {
    @Test
    void theNameShowsWhileMediaOpens() throws Exception {
        PrintStream err = System.err;
        ByteArrayOutputStream said = new ByteArrayOutputStream();
        System.setErr(new PrintStream(said, true, StandardCharsets.UTF_8));
        try (ServerSocket silent = new ServerSocket(0)) {
            String url = "http://127.0.0.1:" + silent.getLocalPort() + "/film.mkv";
            openSource(url);
            Wait.until("it says so", () -> "Opening…".equals(message()));
            assertNotNull(find(JLabel.class, url));
            press("Q");
            assertEquals(0, playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        } finally {
            System.setErr(err);
        }
        assertEquals("", said.toString(StandardCharsets.UTF_8));
    }

    @Test
    void thePictureFollowsWhenItHasCome() throws Exception {
        try (StallingServer server = new StallingServer(Media.path("long.mkv"), 0)) {
            openSource(server.url());
            Wait.until("it says so", () -> "Opening…".equals(message()));
            server.goOn();
            awaitPicture();
            assertEquals(null, message());
        }
    }

    @Test
    void itSaysThatItWaitsForData() throws Exception {
        try (StallingServer server = new StallingServer(Media.path("long.mkv"), 0.1)) {
            openSource(server.url());
            awaitPicture();
            Wait.until("it says so", () -> "Buffering…".equals(notice()));
            assertNotNull(button("Pause (Space)"));
            press("SPACE");
            awaitButton("Play (Space)");
            press("SPACE");
            awaitButton("Pause (Space)");
            server.goOn();
            Wait.until("it goes on", () -> "".equals(notice()));
        }
    }

    /** Keys, the bar and the window itself are as quick as ever. */
    @Test
    void aSeekThatWaitsHoldsNothingUp() throws Exception {
        try (StallingServer server = new StallingServer(Media.path("long.mkv"), 0.5)) {
            openSource(server.url());
            awaitPicture();
            press("PAGE_DOWN");
            for (int i = 0; i < 30; i++) {
                press("LEFT");
                press("RIGHT");
            }
            press("SPACE");
            awaitButton("Play (Space)");
            press("M");
            awaitButton("Unmute (M)");
            Wait.until("it says what it does", () -> "Seeking…".equals(notice()));
            press("Q");
            assertEquals(0, playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
        }
    }

    /** What stands in place of the picture, or null. */
    private String message() throws Exception {
        JTextArea text = find(JTextArea.class, null);
        return text == null ? null : onWindow(text::getText);
    }
}
