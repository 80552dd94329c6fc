// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.MediaStream;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.TrackFlags;
import java.util.ArrayList;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;
import java.util.Optional;

/**
 * All that a player knows of its media; its JSON form is what info --json prints. What is unknown
 * is null and left out of that, or 0 or empty where programs know it so. Names of formats, codecs
 * and colours are FFmpeg's.
 */
record MediaInfo(
        String source,
        String container,
        String format,
        int durationMs,
        Long startUs,
        int bitRate,
        Long sizeBytes,
        Map<String, Object> metadata,
        List<VideoInfo> video,
        List<AudioInfo> audio,
        List<Subtitle> subtitles,
        List<VideoInfo> pictures,
        List<Attachment> attachments,
        List<Mark> chapters) {

    /** stream is the place in the container, codec FFmpeg's name, fourcc the engine's code. */
    record Subtitle(
            int index,
            Integer stream,
            String codec,
            String codecName,
            String fourcc,
            String language,
            String title,
            List<String> flags) {}

    record Attachment(int stream, String fileName, String mimeType, Long sizeBytes) {}

    record Mark(int index, String title, int startMs, int endMs) {}

    static MediaInfo of(String source, OrvMediaPlayer player) {
        var tracks = player.tracks();
        var metadata = tracks.metadata();
        var description = tracks.description();
        var streams = new Streams(description.map(MediaDescription::streams).orElse(List.of()));
        return new MediaInfo(
                source,
                metadata.map(MediaMetadata::container).orElse(""),
                description.map(MediaDescription::format).orElse(null),
                player.getDuration(),
                description.map(found -> Streams.orNull(found.startMicros())).orElse(null),
                metadata.map(MediaMetadata::bitRate).orElse(0),
                description.map(found -> Streams.orNull(found.size())).orElse(null),
                metadata.map(MediaInfo::known).orElse(Map.of()),
                tracks.video().stream().map(track -> VideoInfo.of(track, streams)).toList(),
                tracks.audio().stream().map(track -> AudioInfo.of(track, streams)).toList(),
                tracks.subtitles().stream().map(track -> subtitle(track, streams)).toList(),
                streams.of(MediaStream.Kind.PICTURE).map(VideoInfo::of).toList(),
                streams.of(MediaStream.Kind.ATTACHMENT).map(MediaInfo::attachment).toList(),
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

    private static Subtitle subtitle(SubtitleTrack track, Streams streams) {
        Optional<MediaStream> stream = streams.of(MediaStream.Kind.SUBTITLE, track.index());
        return new Subtitle(
                track.index(),
                stream.map(MediaStream::index).orElse(null),
                stream.map(MediaStream::codec).orElse(null),
                stream.map(MediaStream::codecName).orElse(null),
                track.codec().strip(),
                track.language(),
                track.title(),
                flags(track.flags()));
    }

    private static Attachment attachment(MediaStream stream) {
        var file = stream.attachment().orElseThrow();
        return new Attachment(
                stream.index(),
                file.fileName().orElse(null),
                file.mimeType().orElse(null),
                Streams.orNull(file.size()));
    }

    private static Mark mark(Chapter chapter) {
        return new Mark(
                chapter.index(), chapter.title(), chapter.startMillis(), chapter.endMillis());
    }

    static List<String> flags(TrackFlags flags) {
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
