// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.graphics.Bitmap;
import com.quintora.mmp.util.ThumbnailInfo;
import java.util.Optional;

/**
 * Still pictures of a player's media. Thread-safe; all methods throw {@link IllegalStateException}
 * after release and block while the engine works, for milliseconds as a rule.
 */
public final class Pictures {
    /** The most rows that a thumbnail can have: the native half counts them in 8 bits. */
    public static final int MAX_THUMBNAIL_HEIGHT = 255;

    /** The most pixels that a row of a thumbnail can have. */
    public static final int MAX_THUMBNAIL_WIDTH = 8192;

    private final OrvMediaPlayer player;

    Pictures(OrvMediaPlayer player) {
        this.player = player;
    }

    /**
     * Draws the picture of the present position in a size of one's own; the shape follows the size.
     *
     * @param width pixels, 1 to {@link #MAX_THUMBNAIL_WIDTH}
     * @param height rows, 1 to {@link #MAX_THUMBNAIL_HEIGHT}
     * @param colorMode the pixels' format
     * @return the picture; empty when the media has none or is not prepared
     * @throws IllegalArgumentException for a size out of range and when the format is null
     */
    public Optional<Thumbnail> thumbnail(int width, int height, ColorMode colorMode) {
        player.states.requireAlive("thumbnail()");
        requireRange("width", width, MAX_THUMBNAIL_WIDTH);
        requireRange("height", height, MAX_THUMBNAIL_HEIGHT);
        ThumbnailInfo request = new ThumbnailInfo(
                Arguments.require(colorMode, "the pixels' format").number(), width, height);
        return player.ask("thumbnail()",
                        () -> Optional.ofNullable(player.native_getThumbnailInfo(request)))
                .map(bytes -> new Thumbnail(width, height, colorMode, bytes));
    }

    /**
     * The picture inside the media, such as an album's cover.
     *
     * @return the bytes of an image file, as they stand in the media; empty when there is none
     */
    public Optional<byte[]> embedded() {
        return player.ask("embedded()",
                () -> Optional.ofNullable(player.native_getEmbeddedPicture(0)));
    }

    /**
     * The frame at a time, on platforms whose native half can grab frames.
     *
     * @param millis milliseconds from the start
     * @return the frame; empty on platforms that cannot, see {@link #thumbnail} there
     */
    public Optional<Bitmap> frameAt(int millis) {
        return player.ask("frameAt()",
                () -> Optional.ofNullable(player.native_getFrameAt(millis)));
    }

    private static void requireRange(String name, int value, int most) {
        if (value < 1 || value > most) {
            throw new IllegalArgumentException(
                    "a thumbnail's " + name + " must be 1 to " + most + ": " + value);
        }
    }
}
