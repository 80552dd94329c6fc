// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.image.BufferedImage;
import java.io.ByteArrayOutputStream;
import java.io.IOException;
import java.io.UncheckedIOException;
import java.nio.file.Path;
import java.util.Locale;
import javax.imageio.ImageIO;

/** Pictures as PNG. */
final class PngFile {
    private PngFile() {}

    static boolean isNamedSo(Path file) {
        return file.toString().toLowerCase(Locale.ROOT).endsWith(".png");
    }

    static byte[] encode(BufferedImage image) {
        // Not by way of a temporary file.
        ImageIO.setUseCache(false);
        var bytes = new ByteArrayOutputStream();
        try {
            ImageIO.write(image, "png", bytes);
        } catch (IOException e) {
            throw new UncheckedIOException(e);
        }
        return bytes.toByteArray();
    }
}
