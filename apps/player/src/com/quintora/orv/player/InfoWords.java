// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.util.ArrayList;
import java.util.List;
import java.util.stream.Stream;

/** How a video looks, in words for people. */
final class InfoWords {
    private InfoWords() {}

    /** As stored, and as displayed where that differs. */
    static String size(VideoInfo track) {
        String stored = track.width() + "x" + track.height();
        if (track.displayWidth() == null || track.displayWidth() == 0) {
            return stored;
        }
        String displayed = track.displayWidth() + "x" + track.displayHeight();
        return displayed.equals(stored) ? stored : stored + " shown as " + displayed;
    }

    /** Turning, pixels and colours, as far as they are known. */
    static String look(VideoInfo track) {
        List<String> words = new ArrayList<>();
        if (track.rotation() != null && track.rotation() != 0) {
            words.add("turned " + track.rotation() + "°");
        }
        if (Boolean.TRUE.equals(track.mirrored())) {
            words.add("mirrored");
        }
        if (track.pixelFormat() != null) {
            words.add(track.pixelFormat());
        }
        if (track.fieldOrder() != null && !track.fieldOrder().equals("progressive")) {
            words.add("interlaced");
        }
        if (track.color() != null) {
            words.addAll(colors(track.color()));
        }
        return String.join(", ", words);
    }

    private static List<String> colors(VideoInfo.Color color) {
        String hdr = color.highDynamicRange();
        return Stream.of(
                        hdr == null ? null : "HDR (" + hdr + ")",
                        color.dolbyVisionProfile() == null
                                ? null
                                : "Dolby Vision " + color.dolbyVisionProfile(),
                        color.matrix(),
                        "pc".equals(color.range()) ? "full range" : null)
                .filter(word -> word != null)
                .toList();
    }
}
