// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.graphics.Bitmap;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;

/**
 * Still pictures of a player's media. Thread-safe; all methods throw {@link IllegalStateException}
 * after release.
 */
public interface Pictures {
    /** The most rows that a thumbnail can have: the native half counts them in 8 bits. */
    int MAX_THUMBNAIL_HEIGHT = 255;

    /** The most pixels that a row of a thumbnail can have. */
    int MAX_THUMBNAIL_WIDTH = 8192;

    /**
     * Draws the picture of the present position; the shape follows the size. Does not block;
     * pictures are drawn in the order of their calls, each of the position at the time when it is
     * drawn.
     *
     * @param width pixels, 1 to {@link #MAX_THUMBNAIL_WIDTH}
     * @param height rows, 1 to {@link #MAX_THUMBNAIL_HEIGHT}
     * @param colorMode the pixels' format
     * @return completed with the picture, with an empty one when the media has none or is not
     *     prepared; exceptionally with an {@link IllegalStateException} after release
     * @throws IllegalArgumentException for a size out of range and when the format is null
     */
    CompletableFuture<Optional<Thumbnail>> thumbnail(int width, int height, ColorMode colorMode);

    /**
     * Draws the picture of the present position; as {@link #thumbnail}, but blocks while the engine
     * decodes it: for milliseconds as a rule, longer for large pictures far from a key frame.
     *
     * @param width pixels, 1 to {@link #MAX_THUMBNAIL_WIDTH}
     * @param height rows, 1 to {@link #MAX_THUMBNAIL_HEIGHT}
     * @param colorMode the pixels' format
     * @return the picture; empty when the media has none or is not prepared
     * @throws IllegalArgumentException for a size out of range and when the format is null
     */
    Optional<Thumbnail> thumbnailAndWait(int width, int height, ColorMode colorMode);

    /**
     * The picture inside the media, such as an album's cover. Does not wait for a server.
     *
     * @return the bytes of an image file, as they stand in the media, an array of the caller's own;
     *     empty when there is none
     */
    Optional<byte[]> embedded();

    /**
     * The frame at a time, on platforms whose native half can grab frames. Does not block.
     *
     * @param millis milliseconds from the start
     * @return completed with the frame, with an empty one on platforms that cannot, see {@link
     *     #thumbnail} there; exceptionally with an {@link IllegalStateException} after release
     */
    CompletableFuture<Optional<Bitmap>> frameAt(int millis);

    /**
     * The frame at a time, on platforms whose native half can grab frames. Blocks while it is
     * decoded.
     *
     * @param millis milliseconds from the start
     * @return the frame; empty on platforms that cannot, see {@link #thumbnail} there
     */
    Optional<Bitmap> frameAtAndWait(int millis);
}
