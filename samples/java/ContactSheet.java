// SPDX-License-Identifier: Apache-2.0
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.Thumbnail;
import java.awt.Color;
import java.awt.Graphics2D;
import java.awt.image.BufferedImage;
import java.io.File;
import java.io.IOException;
import java.nio.ByteOrder;
import java.util.Optional;
import javax.imageio.ImageIO;

/** Pictures from all over a film, with their times, in one PNG file. */
public final class ContactSheet {
    private static final int COLUMNS = 4;
    private static final int ROWS = 4;
    private static final int WIDTH = 240;
    private static final int TEXT = 16; // Rows for the time below each picture.
    private static final int GAP = 8;

    private ContactSheet() {}

    public static void main(String[] args) throws Exception {
        if (args.length != 2) {
            System.err.println("usage: ContactSheet FILM SHEET.png");
            System.exit(2);
        }
        try (MediaPlayer player = new OrvMediaPlayer()) {
            player.setDataSource(args[0]);
            player.prepareAndWait();
            if (player.getVideoWidth() == 0 || player.getDuration() == 0) {
                System.err.println(args[0] + ": has no picture, or no known length");
                System.exit(1);
            }
            ImageIO.write(draw(player), "png", new File(args[1]));
        } catch (MediaException e) {
            System.err.println(e.getMessage() + "; " + e.error().advice());
            System.exit(1);
        } catch (IOException e) {
            System.err.println(args[1] + ": cannot be written: " + e.getMessage());
            System.exit(1);
        }
    }

    private static BufferedImage draw(MediaPlayer player) {
        int height = Math.min(255, WIDTH * player.getVideoHeight() / player.getVideoWidth());
        int cellWidth = WIDTH + GAP;
        int cellHeight = height + TEXT + GAP;
        BufferedImage sheet = new BufferedImage(COLUMNS * cellWidth + GAP,
                ROWS * cellHeight + GAP, BufferedImage.TYPE_INT_RGB);
        Graphics2D ink = sheet.createGraphics();
        ink.setColor(Color.WHITE);
        for (int cell = 0; cell < COLUMNS * ROWS; cell++) {
            int x = GAP + cell % COLUMNS * cellWidth;
            int y = GAP + cell / COLUMNS * cellHeight;
            // In the middle of its part of the film: the very start is often black.
            player.seekToAndWait((int) (player.getDuration() * (cell + 0.5) / (COLUMNS * ROWS)));
            Optional<Thumbnail> picture =
                    player.pictures().thumbnailAndWait(WIDTH, height, ColorMode.XRGB8888);
            picture.ifPresent(drawn -> sheet.setRGB(x, y, WIDTH, height, pixels(drawn), 0, WIDTH));
            int seconds = player.getCurrentPosition() / 1000;
            ink.drawString(String.format("%d:%02d:%02d", seconds / 3600, seconds / 60 % 60,
                    seconds % 60), x, y + height + TEXT - 3);
        }
        ink.dispose();
        return sheet;
    }

    private static int[] pixels(Thumbnail picture) {
        int[] pixels = new int[picture.width() * picture.height()];
        picture.pixels().order(ByteOrder.LITTLE_ENDIAN).asIntBuffer().get(pixels);
        return pixels;
    }
}
