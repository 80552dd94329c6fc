// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaStream;
import com.quintora.mmp.MediaStream.Attachment;
import com.quintora.mmp.PictureDetails;
import com.quintora.mmp.PictureDetails.Color;
import com.quintora.mmp.PictureDetails.Light;
import com.quintora.mmp.PictureDetails.Ratio;
import com.quintora.mmp.SoundDetails;
import java.util.ArrayList;
import java.util.List;
import java.util.Locale;
import java.util.Optional;
import java.util.OptionalInt;

/** Reads the engine's description, whose format orvtarn/MediaDescription.h has. */
final class DescriptionText {
    private DescriptionText() {}

    /** Empty for an empty text. What cannot be understood counts as unknown. */
    static Optional<MediaDescription> parse(String text) {
        DescriptionSection media = null;
        List<DescriptionSection> streams = new ArrayList<>();
        DescriptionSection section = new DescriptionSection();
        for (String line : text.split("\n")) {
            if (line.startsWith("[")) {
                section = new DescriptionSection();
            }
            if (line.equals("[media]")) {
                media = section;
            } else if (line.equals("[stream]")) {
                streams.add(section);
            } else {
                section.addLine(line);
            }
        }
        return Optional.ofNullable(media).map(found -> description(found, streams));
    }

    private static MediaDescription description(
            DescriptionSection media, List<DescriptionSection> streams) {
        return new MediaDescription(
                media.text("format").orElse(""),
                media.text("formatName").orElse(""),
                media.large("durationUs"),
                media.large("startUs"),
                media.large("bitRate"),
                media.large("size"),
                streams.stream().map(DescriptionText::stream).toList());
    }

    private static MediaStream stream(DescriptionSection section) {
        MediaStream.Kind kind = kind(section.text("kind").orElse(""));
        return new MediaStream(
                section.number("index").orElse(0),
                kind,
                section.number("track"),
                section.text("codec").orElse(""),
                section.text("codecName").orElse(""),
                section.text("codecTag"),
                section.text("profile"),
                section.number("level"),
                section.text("language"),
                section.text("title"),
                section.text("flags").map(flags -> List.of(flags.split(","))).orElse(List.of()),
                section.large("startUs"),
                section.large("durationUs"),
                section.large("bitRate"),
                Optional.of(kind).filter(DescriptionText::hasPictures).map(k -> picture(section)),
                Optional.of(kind).filter(MediaStream.Kind.AUDIO::equals).map(k -> sound(section)),
                Optional.of(kind)
                        .filter(MediaStream.Kind.ATTACHMENT::equals)
                        .map(k -> attachment(section)));
    }

    private static MediaStream.Kind kind(String name) {
        try {
            return MediaStream.Kind.valueOf(name.toUpperCase(Locale.ROOT));
        } catch (IllegalArgumentException e) {
            return MediaStream.Kind.DATA; // A kind that a later engine knows.
        }
    }

    private static boolean hasPictures(MediaStream.Kind kind) {
        return kind == MediaStream.Kind.VIDEO || kind == MediaStream.Kind.PICTURE;
    }

    private static PictureDetails picture(DescriptionSection section) {
        return new PictureDetails(
                section.number("width").orElse(0),
                section.number("height").orElse(0),
                section.number("displayWidth").orElse(0),
                section.number("displayHeight").orElse(0),
                section.pair("pixelAspect", ":").map(DescriptionText::ratio),
                section.pair("displayAspect", ":").map(DescriptionText::ratio),
                section.number("rotation").orElse(0),
                section.number("mirrored").equals(OptionalInt.of(1)),
                section.text("pixelFormat"),
                section.number("bitDepth"),
                section.text("fieldOrder"),
                new Color(
                        section.text("primaries"),
                        section.text("transfer"),
                        section.text("matrix"),
                        section.text("range"),
                        section.text("chromaLocation")),
                section.quotient("frameRate"),
                new Light(
                        section.real("masteringMinLuminance"),
                        section.real("masteringMaxLuminance"),
                        section.real("maxContentLight"),
                        section.real("maxFrameAverageLight"),
                        section.number("dolbyVisionProfile")));
    }

    private static Ratio ratio(int[] pair) {
        return new Ratio(pair[0], pair[1]);
    }

    private static SoundDetails sound(DescriptionSection section) {
        return new SoundDetails(
                section.number("sampleRate"),
                section.number("channels"),
                section.text("channelLayout"),
                section.text("sampleFormat"),
                section.number("bitsPerSample"));
    }

    private static Attachment attachment(DescriptionSection section) {
        return new Attachment(
                section.text("fileName"), section.text("mimeType"), section.large("size"));
    }
}
