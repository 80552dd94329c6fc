// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import com.quintora.mmp.desktop.VideoFrame;
import java.nio.ByteBuffer;
import java.util.Arrays;
import java.util.function.IntPredicate;

/**
 * A copy of a picture.
 *
 * @param pixels 0xRRGGBB, row by row
 */
record Frame(int width, int height, int[] pixels) {
    /** A box around pixels; empty when its width is 0. */
    record Box(int left, int top, int width, int height) {}

    static Frame of(VideoFrame frame) {
        int width = frame.getWidth();
        int height = frame.getHeight();
        int stride = frame.getRowStride();
        ByteBuffer rows = frame.getPixels();
        int[] pixels = new int[width * height];
        for (int y = 0; y < height; y++) {
            for (int x = 0; x < width; x++) {
                pixels[y * width + x] = rows.getInt(y * stride + x * 4) & 0xFFFFFF;
            }
        }
        return new Frame(width, height, pixels);
    }

    long count(IntPredicate wanted) {
        return Arrays.stream(pixels).filter(wanted).count();
    }

    Box bounds(IntPredicate wanted) {
        int left = width;
        int right = -1;
        int top = height;
        int bottom = -1;
        for (int i = 0; i < pixels.length; i++) {
            if (wanted.test(pixels[i])) {
                left = Math.min(left, i % width);
                right = Math.max(right, i % width);
                top = Math.min(top, i / width);
                bottom = Math.max(bottom, i / width);
            }
        }
        return right < 0 ? new Box(0, 0, 0, 0)
                : new Box(left, top, right - left + 1, bottom - top + 1);
    }

    /** The peak signal-to-noise ratio of two pictures of one size, in decibels. */
    double psnr(Frame other) {
        double sum = 0;
        for (int i = 0; i < pixels.length; i++) {
            for (int shift = 0; shift < 24; shift += 8) {
                int d = (pixels[i] >> shift & 0xFF) - (other.pixels[i] >> shift & 0xFF);
                sum += d * d;
            }
        }
        return sum == 0 ? 100 : 10 * Math.log10(255.0 * 255.0 * 3 * pixels.length / sum);
    }

    static IntPredicate near(int rgb, int tolerance) {
        return pixel -> {
            for (int shift = 0; shift < 24; shift += 8) {
                if (Math.abs((pixel >> shift & 0xFF) - (rgb >> shift & 0xFF)) > tolerance) {
                    return false;
                }
            }
            return true;
        };
    }
}
