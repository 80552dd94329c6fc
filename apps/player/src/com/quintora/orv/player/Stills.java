// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.ColorMode;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.Pictures;
import com.quintora.mmp.Thumbnail;

/** Pictures of a media file at times and sizes of choice. Everything blocks; for one thread. */
final class Stills implements AutoCloseable {
    private final String source;
    private final OrvMediaPlayer player;
    private final Approach approach;
    private final Size size;

    private Stills(String source, OrvMediaPlayer player) {
        this.source = source;
        this.player = player;
        approach = Approach.of(player);
        size = ShownPicture.sizeOf(player);
    }

    static Stills open(String source) throws Failure {
        OrvMediaPlayer player = Media.open(source);
        if (player.getVideoWidth() == 0) {
            player.close();
            throw new Failure("there is no video in '" + source + "'");
        }
        return new Stills(source, player);
    }

    /** As displayed: turned, and with the pixels made square. */
    Size size() {
        return size;
    }

    /** In milliseconds, 0 when unknown. */
    int durationMs() {
        return player.getDuration();
    }

    /**
     * The frame that is shown at that time, without subtitles; the shape follows the size.
     *
     * @throws Failure for a time that the media does not have, and a picture that cannot be drawn
     */
    Still at(int millis, Size wanted) throws Failure {
        int duration = player.getDuration();
        if (duration > 0 && millis > duration) {
            throw Failure.endsBefore(source, duration, "that moment");
        }
        approach.to(millis);
        return isThumbnail(wanted) ? thumbnail(wanted) : frame(wanted);
    }

    /** Whether the player makes pictures of that size without a surface. */
    static boolean isThumbnail(Size size) {
        return size.width() <= Pictures.MAX_THUMBNAIL_WIDTH
                && size.height() <= Pictures.MAX_THUMBNAIL_HEIGHT;
    }

    private Still thumbnail(Size wanted) throws Failure {
        Thumbnail picture =
                player.pictures()
                        .thumbnailAndWait(wanted.width(), wanted.height(), ColorMode.XRGB8888)
                        .orElseThrow(() -> noPicture(null));
        return new Still(ThumbnailImage.of(picture), player.getCurrentPosition());
    }

    // The video's own size is scaled here: for surfaces, speed counts more than the looks.
    private Still frame(Size wanted) throws Failure {
        try {
            Still still = FrameGrabber.take(player, size, null);
            return new Still(Scaling.to(still.image(), wanted), still.timeMs());
        } catch (Failure e) {
            throw noPicture(e);
        }
    }

    private Failure noPicture(Exception cause) {
        return new Failure("no picture could be made of '" + source + "'", cause);
    }

    @Override
    public void close() {
        player.close();
    }
}
