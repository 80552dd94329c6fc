// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.util.Map;

/** What people call codecs. */
final class CodecNames {
    /** Those whose usual name is not how FFmpeg's words for them begin. */
    private static final Map<String, String> USUAL =
            Map.ofEntries(
                    Map.entry("ac3", "AC-3"),
                    Map.entry("eac3", "E-AC-3"),
                    Map.entry("ac4", "AC-4"),
                    Map.entry("ass", "ASS"),
                    Map.entry("av1", "AV1"),
                    Map.entry("dts", "DTS"),
                    Map.entry("dvb_subtitle", "DVB"),
                    Map.entry("dvd_subtitle", "VobSub"),
                    Map.entry("ffv1", "FFV1"),
                    Map.entry("h263", "H.263"),
                    Map.entry("hdmv_pgs_subtitle", "PGS"),
                    Map.entry("hevc", "H.265"),
                    Map.entry("mjpeg", "JPEG"),
                    Map.entry("mov_text", "MP4 text"),
                    Map.entry("mp2", "MP2"),
                    Map.entry("mp3", "MP3"),
                    Map.entry("mpeg4", "MPEG-4"),
                    Map.entry("png", "PNG"),
                    Map.entry("subrip", "SubRip"),
                    Map.entry("vp8", "VP8"),
                    Map.entry("vp9", "VP9"),
                    Map.entry("webvtt", "WebVTT"));

    private CodecNames() {}

    /**
     * A short name for people.
     *
     * @param codec FFmpeg's short name; null when unknown
     * @param words FFmpeg's name in words; null when unknown
     * @param code the engine's code, which is better than nothing
     */
    static String of(String codec, String words, String code) {
        if (codec != null && USUAL.containsKey(codec)) {
            return USUAL.get(codec);
        }
        if (words != null && !words.isEmpty()) {
            return words.split(" / | \\(")[0];
        }
        return codec != null && !codec.isEmpty() ? codec : code == null ? "" : code;
    }
}
