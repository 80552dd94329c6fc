// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.util;

/** A request for a thumbnail, as the native half reads it. */
public class ThumbnailInfo {
    /** The pixel format's number, see {@link com.quintora.mmp.ColorMode#number()}. */
    public int mCanvasColormode;

    /** Width in pixels. */
    public int mThumbnailWidth;

    /** Height in rows, at most 255. */
    public int mThumbnailHeight;

    /** A request of 0 x 0 pixels. */
    public ThumbnailInfo() {}

    /**
     * A request for a picture.
     *
     * @param colorMode the pixel format's number
     * @param width pixels
     * @param height rows
     */
    public ThumbnailInfo(int colorMode, int width, int height) {
        mCanvasColormode = colorMode;
        mThumbnailWidth = width;
        mThumbnailHeight = height;
    }
}
