// SPDX-License-Identifier: Apache-2.0
package android.graphics;

/** The formats of pixels that are read and drawn here. */
public class PixelFormat {
    /** 32 bits a pixel; one byte each of red, green, blue and alpha, in this order in memory. */
    public static final int RGBA_8888 = 1;

    /** As {@link #RGBA_8888}, but opaque: the fourth byte means nothing. */
    public static final int RGBX_8888 = 2;

    /** Makes an object without a use: the class holds constants alone. */
    public PixelFormat() {}
}
