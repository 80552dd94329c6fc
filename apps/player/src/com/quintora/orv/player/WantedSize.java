// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/**
 * How large a picture of a video shall be.
 *
 * @param size pixels, or null for as many as the video has
 */
record WantedSize(Size size) {
    private static final String FULL = "full";

    static WantedSize parse(String text) {
        return new WantedSize(text.trim().equalsIgnoreCase(FULL) ? null : Size.parse(text));
    }

    /**
     * Of a video that is so large.
     *
     * @throws Failure when that is more than there is
     */
    Size of(Size video) throws Failure {
        if (size == null) {
            return video;
        }
        boolean isWithin = size.width() <= video.width() && size.height() <= video.height();
        if (!isWithin && !Stills.isThumbnail(size)) {
            throw new Failure(
                    "a picture of more than 255 rows is at most as large as the video, which has "
                            + video);
        }
        return size;
    }
}
