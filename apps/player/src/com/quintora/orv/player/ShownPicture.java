// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaStream;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PictureDetails;
import java.util.List;
import java.util.Optional;

/** The picture of a prepared player that has one. */
final class ShownPicture {
    private ShownPicture() {}

    /** As displayed: turned, and with the pixels made square. */
    static Size sizeOf(OrvMediaPlayer player) {
        return details(player)
                .filter(picture -> picture.displayWidth() > 0 && picture.displayHeight() > 0)
                .map(picture -> new Size(picture.displayWidth(), picture.displayHeight()))
                .orElseGet(() -> new Size(player.getVideoWidth(), player.getVideoHeight()));
    }

    private static Optional<PictureDetails> details(OrvMediaPlayer player) {
        var shown = player.tracks().video().stream().filter(track -> track.flags().isSelected());
        List<MediaStream> streams =
                player.tracks().description().map(MediaDescription::streams).orElse(List.of());
        return shown.findFirst()
                .flatMap(track -> new Streams(streams).of(MediaStream.Kind.VIDEO, track.index()))
                .flatMap(MediaStream::picture);
    }
}
