// SPDX-License-Identifier: Apache-2.0

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;
import static org.junit.jupiter.api.Assertions.fail;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.nio.ByteBuffer;
import java.util.function.BooleanSupplier;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** The Java player on top of the sample engine. */
class PatternEnginePlaysTest {
    private static final int LIMIT_MS = 20_000;
    private static final long FRAME_NS = 40_000_000;

    private final FrameReader reader = new FrameReader();
    private final OrvMediaPlayer player = new OrvMediaPlayer();

    private record Frame(long timeNs, int width, int height, int hash) {}

    @BeforeEach
    void open() throws Exception {
        player.setDataSource("pattern://60");
        player.setSurface(reader.getSurface());
        player.prepareAndWait();
    }

    @AfterEach
    void close() {
        player.close();
        reader.close();
    }

    @Test
    void isAMinuteLongWithItsFirstFrameOnTheSurface() throws Exception {
        assertEquals(60_000, player.getDuration());
        assertEquals(640, player.getVideoWidth());
        assertEquals(360, player.getVideoHeight());
        Frame first = frame();
        assertEquals(0, first.timeNs());
        assertEquals(640, first.width());
        assertEquals(360, first.height());
    }

    @Test
    void movesWhilePlayingAndStandsWhilePaused() throws Exception {
        Frame first = frame();
        player.start();
        assertTrue(player.isPlaying());
        Frame later = frame();
        assertTrue(later.timeNs() > first.timeNs());
        assertNotEquals(first.hash(), later.hash());
        int from = player.getCurrentPosition();
        await("the position moved on", () -> player.getCurrentPosition() > from + 100);

        player.pause();
        assertFalse(player.isPlaying());
        long frames = reader.getFrameCount();
        int stands = player.getCurrentPosition();
        try (OrvMediaPlayer other = new OrvMediaPlayer()) {
            other.setDataSource("pattern://60");
            other.prepareAndWait();
            other.start();
            await("another player moved", () -> other.getCurrentPosition() > 200);
        }
        assertEquals(stands, player.getCurrentPosition());
        assertEquals(frames, reader.getFrameCount());
    }

    @Test
    void seeksToAFrameThatIsShownWhenTheCallReturns() throws Exception {
        frame();
        player.seekToAndWait(30_010);
        assertEquals(30_000, player.getCurrentPosition());
        assertEquals(750 * FRAME_NS, frame().timeNs());
        player.trickPlay().stepAndWait(-1);
        assertEquals(749 * FRAME_NS, frame().timeNs());
    }

    @Test
    void completesAtItsEndAndPlaysAgain() throws Exception {
        player.seekToAndWait(59_800);
        player.start();
        await("the media ended", () -> player.getState().name().equals("COMPLETED"));
        assertEquals(60_000, player.getCurrentPosition());
        player.start();
        await("it played from the start", () -> player.getCurrentPosition() < 30_000);
        assertTrue(player.isPlaying());
    }

    @Test
    void beginsAgainWhileLooping() throws Exception {
        player.setLooping(true);
        player.seekToAndWait(59_800);
        player.start();
        await("it began again", () -> player.getCurrentPosition() < 30_000);
        assertTrue(player.isPlaying());
    }

    @Test
    void resetsToOtherMediaAndRefusesWhatItDoesNotKnow() throws Exception {
        player.resetAndWait();
        assertThrows(MediaException.class, () -> player.setDataSource("http://localhost/film"));
        player.setDataSource("pattern://2");
        player.prepareAndWait();
        assertEquals(2_000, player.getDuration());
    }

    private Frame frame() throws InterruptedException {
        try (VideoFrame image = reader.awaitFrame(LIMIT_MS)) {
            if (image == null) {
                return fail("no frame came");
            }
            ByteBuffer pixels = image.getPixels();
            return new Frame(image.getTimestamp(), image.getWidth(), image.getHeight(),
                    pixels.hashCode());
        }
    }

    private static void await(String what, BooleanSupplier condition) throws InterruptedException {
        long end = System.nanoTime() + LIMIT_MS * 1_000_000L;
        while (!condition.getAsBoolean()) {
            if (System.nanoTime() > end) {
                fail("waited in vain until " + what);
            }
            Thread.sleep(5);
        }
    }
}
