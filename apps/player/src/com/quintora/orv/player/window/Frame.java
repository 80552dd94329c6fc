// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.nio.ByteBuffer;

/**
 * A frame where the player drew it.
 *
 * @param pixels rows of 32-bit pixels that read 0xXXRRGGBB
 * @param stride bytes from row to row
 */
record Frame(ByteBuffer pixels, int width, int height, int stride) {
    /** Copies some rows to the start of an array, without what is between them. */
    void copyRows(int first, int count, int[] target) {
        var source = pixels.asIntBuffer();
        for (int row = 0; row < count; row++) {
            source.get((first + row) * (stride / 4), target, row * width, width);
        }
    }
}
