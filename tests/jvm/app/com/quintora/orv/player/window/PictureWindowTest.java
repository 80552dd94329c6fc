// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.awt.Dimension;
import java.awt.Graphics2D;
import java.awt.Rectangle;
import java.awt.image.BufferedImage;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.util.concurrent.atomic.AtomicInteger;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** The picture on screens of several scales, pixel by pixel. */
class PictureWindowTest {
    private static final int BACKGROUND = Theme.STAGE.getRGB();

    private final AtomicInteger changes = new AtomicInteger();
    private final VideoPane pane = new VideoPane(changes::incrementAndGet);

    @ParameterizedTest
    @CsvSource({
        "1, 320, 200", "1.25, 320, 200", "1.25, 321, 203", "1.5, 321, 203", "1.75, 333, 177",
        "2, 321, 203"
    })
    void aFrameOfTheRoomsSizeIsShownPixelByPixel(double scale, int width, int height)
            throws Exception {
        pane.setSize(width, height);
        paint(scale, 0, 0);
        Dimension room = pane.room();
        assertEquals(Math.ceil(width * scale - 0.5), room.width);
        assertEquals(Math.ceil(height * scale - 0.5), room.height);
        Rectangle place = VideoPane.fit(320, 180, room.width, room.height);
        BufferedImage picture = checkered(place.width, place.height);
        show(picture);
        BufferedImage screen = paint(scale, 0, 0);
        for (int y = 0; y < room.height; y++) {
            for (int x = 0; x < room.width; x++) {
                int expected = place.contains(x, y)
                        ? picture.getRGB(x - place.x, y - place.y)
                        : BACKGROUND;
                assertEquals(expected, screen.getRGB(x, y), "at " + x + ", " + y);
            }
        }
    }

    /** In a window the picture need not begin at a whole pixel of the screen. */
    @ParameterizedTest
    @CsvSource({"1.25, 1, 3", "1.5, 5, 7", "2, 1, 1"})
    void itIsAsSharpWhereverItLies(double scale, int x, int y) throws Exception {
        pane.setSize(200, 100);
        paint(scale, x, y);
        Dimension room = pane.room();
        BufferedImage picture = checkered(room.width, room.height);
        show(picture);
        BufferedImage screen = paint(scale, x, y);
        int left = (int) Math.ceil(x * scale - 0.5);
        int top = (int) Math.ceil(y * scale - 0.5);
        for (int column = 0; column < room.width; column++) {
            assertEquals(
                    picture.getRGB(column, room.height / 2),
                    screen.getRGB(left + column, top + room.height / 2),
                    "column " + column);
        }
    }

    @Test
    void anotherScreenIsAnotherRoom() throws Exception {
        pane.setSize(320, 180);
        paint(1, 0, 0);
        paint(1, 0, 0);
        assertEquals(1, changes.get(), "nothing changed the second time");
        paint(2, 0, 0);
        assertEquals(2, changes.get());
        assertEquals(new Dimension(640, 360), pane.room());
    }

    /** By each way: in bands, and the whole where it is scaled. */
    @ParameterizedTest
    @CsvSource({"1, 0", "2, 1"})
    void everyPixelIsCopiedOnceForAPainting(int scale, int scalings) throws Exception {
        pane.setSize(700, 480);
        pane.draw(bytesOf(checkered(700, 480), 2816), 700, 480, 2816);
        assertEquals(new VideoPane.Work(0, 0, 0), work(), "nothing is painted yet");
        paint(scale, 0, 0);
        assertEquals(new VideoPane.Work(700 * 480, 1, scalings), work());
    }

    /** Rows lie further apart in memory than they are wide, and there are several bands. */
    @Test
    void aFrameInMemoryIsShownPixelByPixel() throws Exception {
        pane.setSize(700, 480);
        var picture = new BufferedImage(700, 480, BufferedImage.TYPE_INT_RGB);
        for (int i = 0; i < 700 * 480; i++) {
            picture.setRGB(i % 700, i / 700, i);
        }
        pane.draw(bytesOf(picture, 2816), 700, 480, 2816);
        BufferedImage screen = paint(1, 0, 0);
        for (int y = 0; y < 480; y++) {
            for (int x = 0; x < 700; x++) {
                assertEquals(picture.getRGB(x, y), screen.getRGB(x, y), "at " + x + ", " + y);
            }
        }
    }

    @Test
    void onlyAPictureOfAnotherSizeIsScaled() throws Exception {
        pane.setSize(64, 36);
        show(checkered(64, 36));
        paint(1, 0, 0);
        assertEquals(new VideoPane.Work(0, 1, 0), work());
        paint(2, 0, 0);
        assertEquals(new VideoPane.Work(0, 2, 1), work());
        show(checkered(128, 72));
        paint(2, 0, 0);
        assertEquals(new VideoPane.Work(0, 3, 1), work());
    }

    private void show(BufferedImage picture) throws Exception {
        SwingUtilities.invokeAndWait(() -> pane.draw(picture));
    }

    private static ByteBuffer bytesOf(BufferedImage picture, int stride) {
        ByteBuffer bytes = ByteBuffer.allocateDirect(stride * picture.getHeight());
        bytes.order(ByteOrder.LITTLE_ENDIAN);
        for (int y = 0; y < picture.getHeight(); y++) {
            for (int x = 0; x < picture.getWidth(); x++) {
                bytes.putInt(y * stride + 4 * x, picture.getRGB(x, y));
            }
        }
        return bytes;
    }

    private VideoPane.Work work() throws Exception {
        return WindowFixture.onWindow(pane::work);
    }

    private static BufferedImage checkered(int width, int height) {
        var picture = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        for (int y = 0; y < height; y++) {
            for (int x = 0; x < width; x++) {
                picture.setRGB(x, y, (x + y) % 2 == 0 ? 0xFFFFFF : 0x0000FF);
            }
        }
        return picture;
    }

    /** As a window on a screen of that scale paints it. */
    private BufferedImage paint(double scale, int x, int y) throws Exception {
        var screen = new BufferedImage(800, 500, BufferedImage.TYPE_INT_RGB);
        SwingUtilities.invokeAndWait(() -> {
            Graphics2D g = screen.createGraphics();
            g.scale(scale, scale);
            g.translate(x, y);
            pane.paint(g);
            g.dispose();
        });
        // What it reports comes after the painting.
        SwingUtilities.invokeAndWait(() -> {});
        return screen;
    }
}
