// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.image.BufferedImage;

/** How alike two pictures are. */
final class Psnr {
    private Psnr() {}

    /** In decibels, of the first picture's place in the second. */
    static double of(BufferedImage one, BufferedImage other) {
        double squares = 0;
        for (int y = 0; y < one.getHeight(); y++) {
            for (int x = 0; x < one.getWidth(); x++) {
                for (int shift = 0; shift < 24; shift += 8) {
                    int difference =
                            (one.getRGB(x, y) >> shift & 255) - (other.getRGB(x, y) >> shift & 255);
                    squares += difference * difference;
                }
            }
        }
        return 10 * Math.log10(255.0 * 255 * 3 * one.getWidth() * one.getHeight() / squares);
    }
}
