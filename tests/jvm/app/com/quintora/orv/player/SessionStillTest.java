// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Wait;
import java.awt.image.BufferedImage;
import java.nio.file.Path;
import java.util.concurrent.atomic.AtomicLong;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Pictures that are kept of what a session shows. */
class SessionStillTest {
    // Nothing is scaled, and colours are turned by the same rules.
    private static final double EQUAL_DB = 40;

    @TempDir Path folder;
    private final AtomicLong shown = new AtomicLong();
    private volatile int shownWidth;

    @Test
    void aStillIsTheFrameInTheVideosOwnSizeWhateverTheWindowsIs() throws Exception {
        try (Session session = open("hd709.mp4", "--start", "0.5")) {
            session.requestFrameSize(320, 180);
            Still still = session.still(true);
            assertEquals(480, still.timeMs(), 1);
            assertEquals(1280, still.image().getWidth());
            assertTrue(Psnr.of(frame("hd709.mp4", "0.479"), still.image()) > EQUAL_DB);
            awaitShownWidth(320);
        }
    }

    @Test
    void subtitlesAreInItOrNotAndShowOn() throws Exception {
        try (Session session =
                open("video.mp4", "--start", "5", "--subtitle", Media.path("lines.srt"))) {
            BufferedImage with = session.still(true).image();
            BufferedImage without = session.still(false).image();
            BufferedImage again = session.still(true).image();
            BufferedImage frame = frame("video.mp4", "4.999");
            assertTrue(Psnr.of(frame, without) > EQUAL_DB, "without subtitles: the frame alone");
            assertTrue(Psnr.of(frame, with) < EQUAL_DB, "subtitles are words on it");
            assertEquals(Double.POSITIVE_INFINITY, Psnr.of(with, again), "they show on");
        }
    }

    @Test
    void whatPlaysPlaysOn() throws Exception {
        try (Session session = open("video.mp4")) {
            session.start();
            Wait.until("it plays", () -> session.player().getCurrentPosition() > 500);
            Still still = session.still(false);
            assertTrue(still.timeMs() >= 400, "it is at " + still.timeMs());
            assertEquals(PlayerState.STARTED, session.player().getState());
            long before = shown.get();
            Wait.until("frames show", () -> shown.get() > before + 2);
            assertEquals(0, session.snapshot().framesDropped());
        }
    }

    @Test
    void aStillAtTheEndIsTheLastFrame() throws Exception {
        try (Session session = open("silent.mp4")) {
            session.start();
            session.ended().await();
            assertEquals(2_000 - 33, session.still(true).timeMs(), 2);
        }
    }

    @Test
    void soundHasNoPictureToKeep() throws Exception {
        try (Session session = open("tone.flac")) {
            Failure none = assertThrows(Failure.class, () -> session.still(true));
            assertEquals("the media has no picture to keep", none.getMessage());
        }
    }

    private void awaitShownWidth(int width) throws Exception {
        Wait.until("a frame of the window's size shows", () -> shownWidth == width);
    }

    private BufferedImage frame(String media, String from) throws Exception {
        Path file = folder.resolve("frame.png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-i", Media.path(media), "-vf",
                "select=gte(t\\," + from + "),scale=in_color_matrix=auto", "-frames:v", "1",
                file.toString());
        return ImageIO.read(file.toFile());
    }

    private Session open(String media, String... arguments) throws Exception {
        String[] all = new String[arguments.length + 1];
        System.arraycopy(arguments, 0, all, 1, arguments.length);
        all[0] = Media.path(media);
        Session session =
                new Session(
                        PlayOptions.of(all),
                        image -> {
                            shownWidth = image.getWidth();
                            shown.incrementAndGet();
                        });
        session.open();
        return session;
    }
}
