// SPDX-License-Identifier: Apache-2.0
package android.graphics;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import org.junit.jupiter.api.Test;

class BitmapTest {
    private final int[] colors = {1, 2, 3, 4, 5, 0xff000006};
    private final Bitmap bitmap = Bitmap.createBitmap(colors, 3, 2, Bitmap.Config.ARGB_8888);

    @Test
    void keepsACopyOfThePixels() {
        colors[5] = 0;
        assertEquals(3, bitmap.getWidth());
        assertEquals(2, bitmap.getHeight());
        assertEquals(Bitmap.Config.ARGB_8888, bitmap.getConfig());
        assertEquals(4, bitmap.getPixel(0, 1));
        assertEquals(0xff000006, bitmap.getPixel(2, 1));
    }

    @Test
    void copiesRectanglesOut() {
        int[] out = new int[6];
        bitmap.getPixels(out, 1, 3, 1, 0, 2, 2);
        assertArrayEquals(new int[] {0, 2, 3, 0, 5, 6 | 0xff000000}, out);
        bitmap.getPixels(out, 3, -3, 0, 0, 3, 2);
        assertArrayEquals(new int[] {4, 5, 0xff000006, 1, 2, 3}, out);
    }

    @Test
    void refusesWhatDoesNotFit() {
        Bitmap.Config config = Bitmap.Config.ARGB_8888;
        int[] out = new int[6];
        assertThrows(IllegalArgumentException.class,
                () -> Bitmap.createBitmap(colors, 0, 2, config));
        assertThrows(ArrayIndexOutOfBoundsException.class,
                () -> Bitmap.createBitmap(colors, 4, 2, config));
        assertThrows(ArrayIndexOutOfBoundsException.class,
                () -> Bitmap.createBitmap(colors, 65536, 65536, config));
        assertThrows(IllegalArgumentException.class, () -> bitmap.getPixel(3, 0));
        assertThrows(IllegalArgumentException.class, () -> bitmap.getPixel(0, -1));
        assertThrows(IllegalArgumentException.class,
                () -> bitmap.getPixels(out, 0, 3, 1, 0, 3, 2));
        assertThrows(IllegalArgumentException.class,
                () -> bitmap.getPixels(out, 0, 2, 0, 0, 3, 2));
        assertThrows(ArrayIndexOutOfBoundsException.class,
                () -> bitmap.getPixels(out, 1, 3, 0, 0, 3, 2));
    }
}
