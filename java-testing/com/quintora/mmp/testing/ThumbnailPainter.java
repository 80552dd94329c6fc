// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.ColorMode;
import com.quintora.mmp.Thumbnail;
import java.time.Duration;
import java.util.Optional;

/** Draws the thumbnails of a {@link FakeMedia}. Called on the thread that asks for one. */
@FunctionalInterface
public interface ThumbnailPainter {
    /**
     * Draws the picture of a position.
     *
     * @param position where the player stands
     * @param width pixels
     * @param height rows
     * @param colorMode the pixels' format
     * @return the picture, of that size and format; empty for none
     */
    Optional<Thumbnail> paint(Duration position, int width, int height, ColorMode colorMode);
}
