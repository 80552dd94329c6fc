// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.TrackFlags;
import com.quintora.mmp.VideoTrack;
import java.util.ArrayList;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;

/** All that a player knows of its media; its JSON form is what info --json prints. */
record MediaInfo(
        String source,
        String container,
        int durationMs,
        int bitRate,
        Map<String, Object> metadata,
        List<Video> video,
        List<Audio> audio,
        List<Subtitle> subtitles,
        List<Mark> chapters) {

    record Video(
            int index,
            String codec,
            int width,
            int height,
            double frameRate,
            int bitRate,
            List<String> flags) {}

    record Audio(
            int index,
            String codec,
            String codecName,
            String language,
            String title,
            int channels,
            String channelLayout,
            int sampleRate,
            int bitsPerSample,
            int bitRate,
            List<String> flags) {}

    record Subtitle(int index, String codec, String language, String title, List<String> flags) {}

    record Mark(int index, String title, int startMs, int endMs) {}

    static MediaInfo of(String source, OrvMediaPlayer player) {
        var tracks = player.tracks();
        var metadata = tracks.metadata();
        return new MediaInfo(
                source,
                metadata.map(MediaMetadata::container).orElse(""),
                player.getDuration(),
                metadata.map(MediaMetadata::bitRate).orElse(0),
                metadata.map(MediaInfo::known).orElse(Map.of()),
                tracks.video().stream().map(MediaInfo::video).toList(),
                tracks.audio().stream().map(MediaInfo::audio).toList(),
                tracks.subtitles().stream().map(MediaInfo::subtitle).toList(),
                tracks.chapters().stream().map(MediaInfo::mark).toList());
    }

    /** The metadata that the media has, by name, in the usual order. */
    private static Map<String, Object> known(MediaMetadata data) {
        Map<String, Object> known = new LinkedHashMap<>();
        known.put("title", data.title());
        known.put("artist", data.artist());
        known.put("album", data.album());
        known.put("track", data.trackNumber());
        known.put("year", data.year());
        known.put("genre", data.genre());
        known.put("composer", data.composer());
        known.put("comment", data.comment());
        known.values().removeIf(value -> value.equals("") || value.equals(0));
        return known;
    }

    private static Video video(VideoTrack track) {
        return new Video(
                track.index(),
                track.codec().strip(),
                track.width(),
                track.height(),
                track.frameRate(),
                track.bitRate(),
                flags(track.flags()));
    }

    private static Audio audio(AudioTrack track) {
        return new Audio(
                track.index(),
                track.codec().strip(),
                track.codecName(),
                track.language(),
                track.title(),
                track.channels(),
                track.channelLayout(),
                track.sampleRate(),
                track.bitsPerSample(),
                track.bitRate(),
                flags(track.flags()));
    }

    private static Subtitle subtitle(SubtitleTrack track) {
        return new Subtitle(
                track.index(),
                track.codec().strip(),
                track.language(),
                track.title(),
                flags(track.flags()));
    }

    private static Mark mark(Chapter chapter) {
        return new Mark(
                chapter.index(), chapter.title(), chapter.startMillis(), chapter.endMillis());
    }

    private static List<String> flags(TrackFlags flags) {
        List<String> names = new ArrayList<>();
        if (flags.isDefault()) {
            names.add("default");
        }
        if (flags.isForced()) {
            names.add("forced");
        }
        if (flags.isExternal()) {
            names.add("external");
        }
        return names;
    }
}
