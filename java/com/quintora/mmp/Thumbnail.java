// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * A picture of the media.
 *
 * @param width pixels
 * @param height rows
 * @param colorMode the pixels' format
 * @param pixels {@code width * height * colorMode.bytesPerPixel()} bytes, row by row from the top,
 *     without padding; not copied
 */
public record Thumbnail(int width, int height, ColorMode colorMode, byte[] pixels) {}
