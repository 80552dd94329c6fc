// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.util.ThumbnailInfo;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Optional;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.EnumSource;
import org.junit.jupiter.params.provider.ValueSource;

class PicturesTest extends PlayerFixture {
    // Decibels that a thumbnail must keep to ffmpeg's picture of the same time: the scalers
    // differ, and the smaller formats have 4 to 6 bits for a colour.
    private static final double LIKE = 27;
    private static final double LIKE_WITH_FEW_BITS = 24;
    private static final double UNLIKE = 20;

    @ParameterizedTest
    @CsvSource({"64, 36", "50, 28", "320, 180", "1, 1", "33, 1", "17, 255", "453, 255"})
    void thumbnailsLookLikeTheFrame(int width, int height) throws Exception {
        prepare("video.mp4");
        player.seekToAndWait(4000);
        Frame thumbnail = decode(thumbnail(width, height, ColorMode.XRGB8888));
        Frame expected = ffmpegFrame("video.mp4", 4, width, height);
        double psnr = thumbnail.psnr(expected);
        assertTrue(psnr > LIKE || width * height < 100, width + "x" + height + ": " + psnr);
    }

    @ParameterizedTest
    @EnumSource(ColorMode.class)
    void everyColourModeShowsTheFrame(ColorMode mode) throws Exception {
        prepare("video.mp4");
        player.seekToAndWait(4000);
        Frame thumbnail = decode(thumbnail(160, 90, mode));
        Frame expected = ffmpegFrame("video.mp4", 4, 160, 90);
        double psnr = thumbnail.psnr(mode == ColorMode.GRAY16 ? grey(expected) : expected);
        assertTrue(psnr > (mode.bytesPerPixel() == 4 ? LIKE : LIKE_WITH_FEW_BITS),
                mode + ": " + psnr);
    }

    @Test
    void thumbnailsFollowThePosition() throws Exception {
        prepare("video.mp4");
        player.seekToAndWait(8000);
        Frame thumbnail = decode(thumbnail(160, 90, ColorMode.XRGB8888));
        assertTrue(thumbnail.psnr(ffmpegFrame("video.mp4", 8, 160, 90)) > LIKE);
        assertFalse(thumbnail.psnr(ffmpegFrame("video.mp4", 2, 160, 90)) > UNLIKE);
    }

    @Test
    void alphaIsOpaqueWhereTheMediaIs() throws Exception {
        prepare("video.mp4");
        byte[] pixels = thumbnail(16, 9, ColorMode.RGBA8888).toByteArray();
        for (int i = 3; i < pixels.length; i += 4) {
            assertEquals((byte) 255, pixels[i]);
        }
    }

    @ParameterizedTest
    @CsvSource({"0, 10", "-1, 10", "8193, 10", "10, 0", "10, -1", "10, 256",
        "2147483647, 2147483647", "-2147483648, 1"})
    void sizesOutOfRangeAreRefused(int width, int height) throws Exception {
        prepare("video.mp4");
        assertThrows(IllegalArgumentException.class,
                () -> player.pictures().thumbnailAndWait(width, height, ColorMode.RGB565));
    }

    @ParameterizedTest
    @ValueSource(ints = {-1, 0, 1, 2, 6, 8, 13, 14, 19, Integer.MAX_VALUE, Integer.MIN_VALUE})
    void colourModesThatAreNotDrawnGiveNothing(int mode) throws Exception {
        prepare("video.mp4");
        assertNull(player.native_getThumbnailInfo(new ThumbnailInfo(mode, 16, 16)));
        assertNull(player.native_getThumbnailInfo(new ThumbnailInfo(5, 0, 16)));
        assertNull(player.native_getThumbnailInfo(new ThumbnailInfo(5, 16, 0)));
    }

    @Test
    void mediaWithoutAPictureHasNoThumbnail() throws Exception {
        assertEquals(Optional.empty(), player.pictures().thumbnailAndWait(16, 9, ColorMode.RGB565));
        prepare("tone.mp3");
        assertEquals(Optional.empty(), player.pictures().thumbnailAndWait(16, 9, ColorMode.RGB565));
        assertEquals(Optional.empty(), player.pictures().embedded());
    }

    @ParameterizedTest
    @ValueSource(strings = {"covered.mp3", "covered.flac", "covered.m4a", "covered.mkv"})
    void theCoverIsTheFilesOwnBytes(String media) throws Exception {
        prepare(media);
        byte[] cover = Files.readAllBytes(Path.of(Media.path("front.jpg")));
        assertArrayEquals(cover, player.pictures().embedded().orElseThrow());
    }

    @Test
    void framesAreNotGrabbedHere() throws Exception {
        prepare("video.mp4");
        assertEquals(Optional.empty(), player.pictures().frameAtAndWait(1000));
    }

    private Thumbnail thumbnail(int width, int height, ColorMode mode) {
        Thumbnail thumbnail = player.pictures().thumbnailAndWait(width, height, mode).orElseThrow();
        assertEquals(width * height * mode.bytesPerPixel(), thumbnail.pixels().remaining());
        return thumbnail;
    }

    private static Frame ffmpegFrame(String media, int seconds, int width, int height)
            throws Exception {
        byte[] bytes = Media.run("ffmpeg", "-nostdin", "-v", "error", "-ss", "" + seconds,
                "-i", Media.path(media), "-frames:v", "1", "-vf",
                "scale=" + width + ":" + height + ":flags=area",
                "-f", "rawvideo", "-pix_fmt", "bgr0", "-");
        return decode(new Thumbnail(width, height, ColorMode.XRGB8888, bytes));
    }

    private static Frame grey(Frame frame) {
        int[] pixels = frame.pixels().clone();
        for (int i = 0; i < pixels.length; i++) {
            int luma = (int) Math.round(0.299 * (pixels[i] >> 16 & 0xFF)
                    + 0.587 * (pixels[i] >> 8 & 0xFF) + 0.114 * (pixels[i] & 0xFF));
            pixels[i] = luma * 0x10101;
        }
        return new Frame(frame.width(), frame.height(), pixels);
    }

    private static Frame decode(Thumbnail thumbnail) {
        ByteBuffer bytes = thumbnail.pixels().order(ByteOrder.nativeOrder());
        int[] pixels = new int[thumbnail.width() * thumbnail.height()];
        for (int i = 0; i < pixels.length; i++) {
            pixels[i] = pixel(thumbnail.colorMode(), bytes, i);
        }
        return new Frame(thumbnail.width(), thumbnail.height(), pixels);
    }

    private static int pixel(ColorMode mode, ByteBuffer bytes, int i) {
        if (mode.bytesPerPixel() == 4) {
            int[] order = switch (mode) { // Where red, green and blue stand.
                case RGBA8888 -> new int[] {0, 1, 2};
                case ABGR8888 -> new int[] {3, 2, 1};
                default -> new int[] {2, 1, 0};
            };
            return (bytes.get(4 * i + order[0]) & 0xFF) << 16
                    | (bytes.get(4 * i + order[1]) & 0xFF) << 8
                    | bytes.get(4 * i + order[2]) & 0xFF;
        }
        int word = bytes.getShort(2 * i) & 0xFFFF;
        return switch (mode) {
            case RGB565 -> rgb(word >> 11, 5, word >> 5, 6, word, 5);
            case BGR565 -> rgb(word, 5, word >> 5, 6, word >> 11, 5);
            case ARGB1555 -> rgb(word >> 10, 5, word >> 5, 5, word, 5);
            case ARGB4444 -> rgb(word >> 8, 4, word >> 4, 4, word, 4);
            case GRAY16 -> (word >> 8) * 0x10101;
            case UYVY422 -> yuv(bytes, i, 1, 0, 2);
            default -> yuv(bytes, i, 0, 1, 3);
        };
    }

    private static int rgb(int r, int rBits, int g, int gBits, int b, int bBits) {
        return scaled(r, rBits) << 16 | scaled(g, gBits) << 8 | scaled(b, bBits);
    }

    private static int scaled(int value, int bits) {
        int most = (1 << bits) - 1;
        return (value & most) * 255 / most;
    }

    private static int yuv(ByteBuffer bytes, int i, int yAt, int uAt, int vAt) {
        double y = 1.164 * ((bytes.get(2 * i + yAt) & 0xFF) - 16);
        int pair = 4 * (i / 2);
        int u = (bytes.get(pair + uAt) & 0xFF) - 128;
        int v = (bytes.get(pair + vAt) & 0xFF) - 128;
        return clamped(y + 1.596 * v) << 16 | clamped(y - 0.392 * u - 0.813 * v) << 8
                | clamped(y + 2.017 * u);
    }

    private static int clamped(double value) {
        return (int) Math.max(0, Math.min(255, Math.round(value)));
    }
}
