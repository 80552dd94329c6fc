// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import java.awt.image.BufferedImage;
import java.nio.file.Files;
import java.nio.file.Path;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Sheets of pictures from all over a video. */
class SheetCommandTest {
    private static final double ALIKE_DB = 28;

    // The layout: a line above, gaps between, a time below each picture.
    private static final int TITLE = 36;
    private static final int TIME = 20;
    private static final int GAP = 8;

    @TempDir Path folder;

    /** Ten seconds in six parts: the pictures are of 0.83 s, 2.5 s, 4.17 s and so on. */
    @Test
    void itsPicturesAreOfTheMiddleOfEachPart() throws Exception {
        BufferedImage sheet = draw("video.mp4", "--sheet", "3x2", "--size", "160x90");
        assertEquals(GAP + 3 * (160 + GAP), sheet.getWidth());
        assertEquals(TITLE + 2 * (90 + TIME + GAP), sheet.getHeight());
        String[] frames = {"0.8", "2.48", "4.16", "5.8", "7.48", "9.16"};
        for (int i = 0; i < frames.length; i++) {
            int x = GAP + i % 3 * (160 + GAP);
            int y = TITLE + i / 3 * (90 + TIME + GAP);
            BufferedImage picture = sheet.getSubimage(x, y, 160, 90);
            double psnr = Psnr.of(frame(frames[i]), picture);
            assertTrue(psnr > ALIKE_DB, "picture " + i + ": " + psnr + " dB");
            assertTrue(isWrittenOn(sheet.getSubimage(x, y + 90, 160, TIME)), "time " + i);
        }
        assertTrue(isWrittenOn(sheet.getSubimage(0, 0, 100, TITLE)), "the title");
    }

    @Test
    void picturesOfMoreRowsThanAThumbnailsAreDrawnToo() throws Exception {
        BufferedImage sheet = draw("hd709.mp4", "--sheet", "2x1", "--size", "full");
        assertEquals(GAP + 2 * (1280 + GAP), sheet.getWidth());
        BufferedImage first = sheet.getSubimage(GAP, TITLE, 1280, 720);
        BufferedImage second = sheet.getSubimage(2 * GAP + 1280, TITLE, 1280, 720);
        assertTrue(Psnr.of(first, second) < ALIKE_DB, "two moments");
        assertTrue((first.getRGB(100, 300) & 0xFF0000) > 0xA00000, "testsrc2 is red there");
    }

    @Test
    void whatCannotBeDrawnIsRefusedInASentenceAndLeavesTheFileAsItWas() throws Exception {
        String video = Media.path("video.mp4");
        Path out = Files.writeString(folder.resolve("out.png"), "as it was");
        assertRefused(2, "is no number of columns and rows", video, "--sheet", "four");
        assertRefused(2, "1x1 to 20x20 pictures, not 0x4", video, "--sheet", "0x4");
        assertRefused(2, "1x1 to 20x20 pictures, not 4x21", video, "--sheet", "4x21");
        assertRefused(2, "leave --at out", video, "--sheet", "2x2", "--at", "1");
        assertRefused(1, "there is no video", Media.path("tone.mp3"), "--sheet", "2x2");
        assertRefused(1, "is too large", video, "--sheet", "20x20", "--size", "8000x200");
        assertRefused(1, "how long", rawVideo(), "--sheet", "2x2");
        assertEquals("as it was", Files.readString(out));
        try (var files = Files.list(folder)) {
            assertEquals(2, files.count(), "the picture and the raw video");
        }
    }

    /** A stream of pictures, such as nobody says the length of. */
    private String rawVideo() throws Exception {
        Path file = folder.resolve("raw.h264");
        if (Files.notExists(file)) {
            Media.run("ffmpeg", "-nostdin", "-v", "error", "-f", "lavfi", "-i",
                    "testsrc2=size=320x180:duration=1", "-c:v", "libx264", "-f", "h264",
                    file.toString());
        }
        return file.toString();
    }

    private BufferedImage draw(String media, String... options) throws Exception {
        Cli run = run(Media.path(media), options);
        assertEquals(0, run.status(), run.err());
        return ImageIO.read(folder.resolve("out.png").toFile());
    }

    private void assertRefused(int status, String words, String media, String... options) {
        Cli run = run(media, options);
        assertEquals(status, run.status(), run.err());
        assertTrue(run.errLines().get(0).contains(words), run.err());
    }

    private Cli run(String media, String... options) {
        String[] arguments = new String[options.length + 3];
        arguments[0] = "thumbnail";
        arguments[1] = media;
        System.arraycopy(options, 0, arguments, 2, options.length);
        arguments[options.length + 2] = folder.resolve("out.png").toString();
        return Cli.run(arguments);
    }

    private BufferedImage frame(String at) throws Exception {
        Path file = folder.resolve("frame.png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-i", Media.path("video.mp4"),
                "-vf", "select=gte(t\\," + at + "-0.001),scale=160:90:flags=area",
                "-frames:v", "1", file.toString());
        return ImageIO.read(file.toFile());
    }

    private static boolean isWrittenOn(BufferedImage ground) {
        for (int y = 0; y < ground.getHeight(); y++) {
            for (int x = 0; x < ground.getWidth(); x++) {
                if ((ground.getRGB(x, y) & 255) > 0xC0) {
                    return true;
                }
            }
        }
        return false;
    }
}
