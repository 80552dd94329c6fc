// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.util.ArrayList;
import java.util.List;
import java.util.Locale;

/** What is known of media, as lines for people. */
final class InfoTable {
    private final List<String> lines = new ArrayList<>();

    private InfoTable() {}

    static List<String> of(MediaInfo info) {
        InfoTable table = new InfoTable();
        table.addGeneral(info);
        info.video().forEach(table::addVideo);
        info.audio().forEach(table::addAudio);
        info.subtitles().forEach(table::addSubtitle);
        info.pictures().forEach(table::addPicture);
        info.attachments().forEach(table::addAttachment);
        info.chapters().forEach(table::addChapter);
        return table.lines;
    }

    private void addGeneral(MediaInfo info) {
        add("source", info.source());
        add("container", info.container());
        add("duration", info.durationMs() > 0 ? precise(info.durationMs()) : "unknown");
        add("bit rate", bitRate(info.bitRate()));
        info.metadata().forEach((name, value) -> add(name, value.toString()));
    }

    private void addVideo(VideoInfo track) {
        add(
                "video " + track.index(),
                join(
                        CodecNames.of(track.codec(), track.codecName(), track.fourcc()),
                        text(track.profile()),
                        named(text(track.language()), text(track.title())),
                        InfoWords.size(track),
                        track.frameRate() > 0 ? number(track.frameRate()) + " fps" : "",
                        InfoWords.look(track),
                        bitRate(track.bitRate()),
                        String.join(", ", track.flags())));
    }

    private void addPicture(VideoInfo picture) {
        add(
                "picture",
                join(
                        CodecNames.of(picture.codec(), picture.codecName(), ""),
                        text(picture.title()),
                        InfoWords.size(picture)));
    }

    private void addAttachment(MediaInfo.Attachment file) {
        add(
                "attachment",
                join(
                        text(file.fileName()),
                        text(file.mimeType()),
                        file.sizeBytes() == null ? "" : file.sizeBytes() + " bytes"));
    }

    private void addAudio(AudioInfo track) {
        add(
                "audio " + track.index(),
                join(
                        CodecNames.of(track.codec(), track.codecName(), track.fourcc()),
                        text(track.profile()),
                        named(track.language(), track.title()),
                        track.channelLayout().isEmpty()
                                ? track.channels() + " channels"
                                : track.channelLayout(),
                        track.sampleRate() + " Hz",
                        bitRate(track.bitRate()),
                        String.join(", ", track.flags())));
    }

    private void addSubtitle(MediaInfo.Subtitle track) {
        add(
                "subtitles " + track.index(),
                join(
                        CodecNames.of(track.codec(), track.codecName(), track.fourcc()),
                        named(track.language(), track.title()),
                        String.join(", ", track.flags())));
    }

    private void addChapter(MediaInfo.Mark mark) {
        add("chapter " + mark.index(), join(precise(mark.startMs()), mark.title()));
    }

    private void add(String name, String value) {
        String text = Printable.of(value);
        if (!text.isEmpty()) {
            lines.add(String.format("%-12s  %s", name, text));
        }
    }

    private static String text(String value) {
        return value == null ? "" : value;
    }

    private static String named(String language, String title) {
        String name = language.isEmpty() ? "" : TrackNames.language(language);
        return title.isEmpty() ? name : (name.isEmpty() ? "" : name + " ") + "\"" + title + "\"";
    }

    private static String join(String... parts) {
        return String.join("  ", List.of(parts).stream().filter(part -> !part.isEmpty()).toList());
    }

    private static String bitRate(int bitsPerSecond) {
        return bitsPerSecond > 0 ? Math.round(bitsPerSecond / 1000.0) + " kbit/s" : "";
    }

    private static String precise(int millis) {
        return String.format(Locale.ROOT, "%s.%03d", Times.clock(millis), millis % 1000);
    }

    private static String number(double value) {
        String text = String.format(Locale.ROOT, "%.3f", value);
        return text.replaceAll("\\.?0+$", "");
    }
}
