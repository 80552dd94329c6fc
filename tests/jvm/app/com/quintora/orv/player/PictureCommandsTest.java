// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import java.awt.image.BufferedImage;
import java.nio.file.Files;
import java.nio.file.Path;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** Thumbnails and covers. */
class PictureCommandsTest {
    // Two scalers and two decoders' rounding lie between the pictures that are compared.
    private static final double ALIKE_DB = 28;
    private static final double EQUAL_DB = 50;

    @TempDir Path folder;

    @Test
    void aThumbnailIsTheFrameOfItsMoment() throws Exception {
        Path out = folder.resolve("out.png");
        Cli thumbnail =
                Cli.run("thumbnail", Media.path("video.mp4"), "--at", "4", "--size", "320x180",
                        out.toString());
        assertEquals(0, thumbnail.status(), thumbnail.err());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertEquals(320, drawn.getWidth());
        assertEquals(180, drawn.getHeight());
        assertTrue(Psnr.of(frame("video.mp4", "4"), drawn) > ALIKE_DB);
        assertTrue(Psnr.of(frame("video.mp4", "8"), drawn) < ALIKE_DB);
    }

    @Test
    void aMomentBetweenKeyFramesIsMetToo() throws Exception {
        Path out = folder.resolve("out.png");
        Cli thumbnail =
                Cli.run("thumbnail", Media.path("video.mp4"), "--at", "5.4", "--size", "320x180",
                        out.toString());
        assertEquals(0, thumbnail.status(), thumbnail.err());
        assertTrue(Psnr.of(frame("video.mp4", "5.4"), ImageIO.read(out.toFile())) > ALIKE_DB);
    }

    /** In formats without an index, also past the last key frame; 11 ms are the sound's alone. */
    @ParameterizedTest
    @CsvSource({
        "stream.ts, 7.311, 7.3", "stream.ts, 8.611, 8.6", "distant.ts, 13.311, 13.3",
        "stream.mpg, 7.331, 7.32", "stream.vob, 7.331, 7.32",
        "distant.mpg, 12.431, 12.4", "distant.mpg, 19.931, 19.92"
    })
    void aMomentOfABroadcastIsMet(String media, String at, String frame) throws Exception {
        Path out = folder.resolve("out.png");
        Cli thumbnail =
                Cli.run("thumbnail", Media.path(media), "--at", at, "--size", "320x180",
                        out.toString());
        assertEquals(0, thumbnail.status(), thumbnail.err());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertTrue(Psnr.of(decoded(media, frame), drawn) > ALIKE_DB);
    }

    @ParameterizedTest
    @CsvSource({
        "lying90.mp4, 101x180", "lying180.mp4, 320x180", "lying90mirrored.mp4, 101x180",
        "wide-pixels.mkv, 240x180"
    })
    void withoutASizeItHasTheShapeOfTheDisplay(String media, String size) throws Exception {
        Path out = folder.resolve("out.png");
        assertEquals(0, Cli.run("thumbnail", Media.path(media), out.toString()).status());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertEquals(size, drawn.getWidth() + "x" + drawn.getHeight());
    }

    @Test
    void withoutASizeItHasTheShapeOfTheVideo() throws Exception {
        Path out = folder.resolve("out.PNG");
        assertEquals(0, Cli.run("thumbnail", Media.path("video.mp4"), out.toString()).status());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertEquals("320x180", drawn.getWidth() + "x" + drawn.getHeight());
    }

    /** As libavcodec decodes it, pixel by pixel. */
    @Test
    void thePictureInTheVideosOwnSizeIsTheFrame() throws Exception {
        Path out = folder.resolve("out.png");
        Cli thumbnail =
                Cli.run("thumbnail", Media.path("hd709.mp4"), "--at", "0.5", "--size", "full",
                        out.toString());
        assertEquals(0, thumbnail.status(), thumbnail.err());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertEquals("1280x720", drawn.getWidth() + "x" + drawn.getHeight());
        assertTrue(Psnr.of(hdFrame("1280x720"), drawn) > EQUAL_DB);
    }

    @ParameterizedTest
    @CsvSource({"640x360", "1280x256", "300x700"})
    void aPictureOfMoreRowsIsTheFrameInThatShape(String size) throws Exception {
        Path out = folder.resolve("out.png");
        Cli thumbnail =
                Cli.run("thumbnail", Media.path("hd709.mp4"), "--at", "0.5", "--size", size,
                        out.toString());
        assertEquals(0, thumbnail.status(), thumbnail.err());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertEquals(size, drawn.getWidth() + "x" + drawn.getHeight());
        assertTrue(Psnr.of(hdFrame(size), drawn) > ALIKE_DB);
    }

    @ParameterizedTest
    @CsvSource({
        "lying90.mp4, 90x160", "lying180.mp4, 160x90", "wide-pixels.mkv, 120x90",
        "anamorphic.mkv, 192x108"
    })
    void inFullSizeItHasTheShapeOfTheDisplay(String media, String size) throws Exception {
        Path out = folder.resolve("out.png");
        Cli thumbnail =
                Cli.run("thumbnail", Media.path(media), "--size", "full", out.toString());
        assertEquals(0, thumbnail.status(), thumbnail.err());
        BufferedImage drawn = ImageIO.read(out.toFile());
        assertEquals(size, drawn.getWidth() + "x" + drawn.getHeight());
    }

    @Test
    void whatCannotBeDrawnIsRefusedInASentence() throws Exception {
        String media = Media.path("video.mp4");
        String out = folder.resolve("out.png").toString();
        assertRefused(1, "at most as large as the video, which has 320x180",
                Cli.run("thumbnail", media, "--size", "320x256", out));
        assertRefused(1, "at most as large as the video",
                Cli.run("thumbnail", media, "--size", "8193x10", out));
        assertRefused(2, "'huge' is not a size",
                Cli.run("thumbnail", media, "--size", "huge", out));
        assertRefused(2, "a PNG file", Cli.run("thumbnail", media, folder + "/out.jpg"));
        assertRefused(1, "ends at 0:10", Cli.run("thumbnail", media, "--at", "60", out));
        assertRefused(1, "there is no video", Cli.run("thumbnail", Media.path("tone.mp3"), out));
        assertRefused(1, "its folder does not exist",
                Cli.run("thumbnail", media, folder + "/none/out.png"));
        assertTrue(Files.notExists(Path.of(out)));
    }

    @Test
    void aCoverIsWrittenByteForByte() throws Exception {
        Path out = folder.resolve("cover.jpg");
        Cli cover = Cli.run("cover", Media.path("covered.mp3"), out.toString());
        assertEquals(0, cover.status(), cover.err());
        assertArrayEquals(
                Files.readAllBytes(Path.of(Media.path("front.jpg"))), Files.readAllBytes(out));
    }

    @Test
    void mediaWithoutACoverLeaveNoFile() throws Exception {
        Path out = folder.resolve("cover.jpg");
        assertRefused(1, "there is no picture inside",
                Cli.run("cover", Media.path("tone.mp3"), out.toString()));
        assertTrue(Files.notExists(out));
    }

    private static void assertRefused(int status, String words, Cli run) {
        assertEquals(status, run.status(), run.err());
        assertTrue(run.errLines().get(0).contains(words), run.err());
    }

    private BufferedImage frame(String media, String at) throws Exception {
        Path file = folder.resolve("frame-" + at + ".png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-ss", at, "-i", Media.path(media),
                "-frames:v", "1", file.toString());
        return ImageIO.read(file.toFile());
    }

    /** That of 0.5 s. */
    private BufferedImage hdFrame(String size) throws Exception {
        Path file = folder.resolve("hd.png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-i", Media.path("hd709.mp4"),
                "-vf",
                "select=gte(t\\,0.479),scale=in_color_matrix=bt709,format=rgb24,"
                        + "scale=" + size + ":flags=area",
                "-frames:v", "1", file.toString());
        return ImageIO.read(file.toFile());
    }

    /** Without a seek of ffmpeg's, which goes wrong in formats without an index. */
    private BufferedImage decoded(String media, String at) throws Exception {
        Path file = folder.resolve("decoded.png");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-y", "-i", Media.path(media),
                "-map", "0:v:0", "-vsync", "passthrough",
                "-vf", "select=gte(t\\," + at + "-0.001),scale=320:180",
                "-frames:v", "1", file.toString());
        return ImageIO.read(file.toFile());
    }
}
