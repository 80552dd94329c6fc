// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.Thumbnail;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.nio.ByteOrder;

/** Thumbnails as Java's own pictures. */
final class ThumbnailImage {
    private ThumbnailImage() {}

    /** Of one in the format XRGB8888. */
    static BufferedImage of(Thumbnail picture) {
        var image =
                new BufferedImage(picture.width(), picture.height(), BufferedImage.TYPE_INT_RGB);
        int[] pixels = ((DataBufferInt) image.getRaster().getDataBuffer()).getData();
        picture.pixels().order(ByteOrder.LITTLE_ENDIAN).asIntBuffer().get(pixels);
        return image;
    }
}
