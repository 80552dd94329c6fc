// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.google.gson.JsonElement;
import com.google.gson.JsonObject;
import com.google.gson.JsonPrimitive;
import java.util.Arrays;
import java.util.LinkedHashMap;
import java.util.Map;
import java.util.function.Function;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/**
 * How each field of info --json follows from ffprobe's. Fields that are unknown are missing, empty
 * or 0 in one and missing, "unknown" or "N/A" in the other.
 */
final class InfoRules {
    /** Null when the field is right, or what it should be. */
    interface Rule {
        String expected(JsonElement ours, FfprobeStream theirs);
    }

    /** Fields about which ffprobe says nothing: numbering and names of our own. */
    private static final Rule OUR_OWN = (ours, theirs) -> null;

    private final JsonObject bitDepths;
    private final Map<String, Rule> rules = new LinkedHashMap<>();

    InfoRules(JsonObject bitDepths) {
        this.bitDepths = bitDepths;
        addMedia();
        addPictures("video");
        addPictures("pictures");
        addSound();
        addRest();
    }

    Map<String, Rule> rules() {
        return rules;
    }

    private void addMedia() {
        rules.put("source", OUR_OWN);
        rules.put("container", same("format_long_name"));
        rules.put("format", same("format_name"));
        // mpv reads further than ffprobe where the file does not say how long it is, and counts
        // the last frame where that does not: half a second, or 1 %.
        rules.put("durationMs", number(f -> f.number("duration") * 1000, 500, 0.01));
        rules.put("startUs", number(f -> f.number("start_time") * 1e6, 1, 0));
        rules.put("bitRate", number(f -> f.number("bit_rate"), 1, 0));
        rules.put("sizeBytes", number(f -> f.number("size"), 0, 0));
        for (String tag : new String[] {"title", "artist", "album", "genre", "composer"}) {
            rules.put("metadata." + tag, cut(f -> f.tag(tag)));
        }
        rules.put("metadata.comment",
                cut(f -> f.tag("comment").isEmpty() ? f.tag("description") : f.tag("comment")));
        rules.put("metadata.year", text(f -> first("\\d{4}", f.tag("date"))));
        rules.put("metadata.track", text(f -> first("^\\d+", f.tag("track"))));
    }

    private void addCodec(String kind) {
        rules.put(kind + ".index", OUR_OWN);
        rules.put(kind + ".stream", number(f -> f.number("index"), 0, 0));
        rules.put(kind + ".fourcc", OUR_OWN);
        rules.put(kind + ".codec", same("codec_name"));
        rules.put(kind + ".codecName", same("codec_long_name"));
        rules.put(kind + ".language", text(f ->
                f.tag("language").equals("und") ? "" : f.tag("language")));
        rules.put(kind + ".title", cut(f -> f.tag("title")));
        // Of what the table has: containers' other flags are not in it.
        rules.put(kind + ".flags", (ours, f) -> {
            boolean isRight = Arrays.stream(new String[] {"default", "forced"})
                    .allMatch(flag -> f.has(flag)
                            == ours.getAsJsonArray().contains(new JsonPrimitive(flag)));
            return isRight ? null : f.json().get("disposition").toString();
        });
    }

    private void addPictures(String kind) {
        addCodec(kind);
        rules.put(kind + ".profile", same("profile"));
        rules.put(kind + ".level", number(f -> Math.max(f.number("level"), 0), 0, 0));
        rules.put(kind + ".width", number(f -> f.number("width"), 0, 0));
        rules.put(kind + ".height", number(f -> f.number("height"), 0, 0));
        rules.put(kind + ".displayWidth",
                number(f -> isLying(f) ? f.number("height") : squareWidth(f), 0.5, 0));
        rules.put(kind + ".displayHeight",
                number(f -> isLying(f) ? squareWidth(f) : f.number("height"), 0.5, 0));
        rules.put(kind + ".pixelAspect", same("sample_aspect_ratio"));
        rules.put(kind + ".displayAspect", same("display_aspect_ratio"));
        rules.put(kind + ".rotation", number(f -> rotation(f.turning()), 0, 0));
        rules.put(kind + ".mirrored", text(f -> String.valueOf(isMirrored(f.turning()))));
        rules.put(kind + ".pixelFormat", same("pix_fmt"));
        rules.put(kind + ".bitDepth", number(this::bitDepth, 0, 0));
        rules.put(kind + ".fieldOrder", same("field_order"));
        rules.put(kind + ".color.primaries", same("color_primaries"));
        rules.put(kind + ".color.transfer", same("color_transfer"));
        rules.put(kind + ".color.matrix", same("color_space"));
        rules.put(kind + ".color.range", same("color_range"));
        rules.put(kind + ".color.chromaLocation", text(f ->
                f.text("chroma_location").equals("unspecified") ? "" : f.text("chroma_location")));
        rules.put(kind + ".color.highDynamicRange", text(f -> switch (f.text("color_transfer")) {
            case "smpte2084" -> "PQ";
            case "arib-std-b67" -> "HLG";
            default -> "";
        }));
        rules.put(kind + ".color.masteringMinLuminance", mastering("min_luminance"));
        rules.put(kind + ".color.masteringMaxLuminance", mastering("max_luminance"));
        rules.put(kind + ".color.maxContentLight", content("max_content"));
        rules.put(kind + ".color.maxFrameAverageLight", content("max_average"));
        rules.put(kind + ".color.dolbyVisionProfile",
                text(f -> f.sideData("DOVI configuration record", "dv_profile")));
        // The engine's record has thousandths.
        rules.put(kind + ".frameRate",
                number(f -> FfprobeStream.quotient(f.text("avg_frame_rate")), 0.001, 0));
        rules.put(kind + ".bitRate", bitRate());
    }

    private void addSound() {
        addCodec("audio");
        rules.put("audio.profile", same("profile"));
        rules.put("audio.channels", number(f -> f.number("channels"), 0, 0));
        rules.put("audio.channelLayout", same("channel_layout"));
        rules.put("audio.sampleRate", number(f -> f.number("sample_rate"), 0, 0));
        rules.put("audio.sampleFormat", same("sample_fmt"));
        rules.put("audio.bitsPerSample", number(f ->
                f.text("bits_per_raw_sample").isEmpty()
                        ? f.number("bits_per_sample")
                        : f.number("bits_per_raw_sample"), 0, 0));
        rules.put("audio.bitRate", bitRate());
    }

    private void addRest() {
        addCodec("subtitles");
        rules.put("attachments.stream", number(f -> f.number("index"), 0, 0));
        rules.put("attachments.fileName", text(f -> f.tag("filename")));
        rules.put("attachments.mimeType", text(f -> f.tag("mimetype")));
        rules.put("attachments.sizeBytes", number(f -> f.number("extradata_size"), 0, 0));
        rules.put("chapters.index", OUR_OWN);
        rules.put("chapters.title", cut(f -> f.tag("title")));
        rules.put("chapters.startMs", number(f -> f.number("start_time") * 1000, 0.5, 0));
        rules.put("chapters.endMs", number(f -> f.number("end_time") * 1000, 0.5, 0));
    }

    private static String first(String pattern, String text) {
        Matcher found = Pattern.compile(pattern).matcher(text);
        return found.find() ? found.group() : "";
    }

    private static Rule text(Function<FfprobeStream, String> theirs) {
        return (ours, stream) -> {
            String expected = theirs.apply(stream);
            return expected.equals(known(ours)) ? null : expected;
        };
    }

    private static Rule same(String name) {
        return text(stream -> stream.text(name).equals("0:1") ? "" : stream.text(name));
    }

    /** Texts of the engine's records have 127 bytes or 128 units; what is missing is at the end. */
    private static Rule cut(Function<FfprobeStream, String> theirs) {
        return (ours, stream) -> {
            String expected = theirs.apply(stream);
            String known = known(ours);
            boolean isCut = known.length() >= 40 && expected.startsWith(known);
            return isCut || expected.equals(known) ? null : expected;
        };
    }

    private static Rule number(
            Function<FfprobeStream, Double> theirs, double tolerance, double relative) {
        return (ours, stream) -> {
            double expected = theirs.apply(stream);
            double known = ours == null ? 0 : ours.getAsDouble();
            double limit = Math.max(tolerance, Math.abs(expected) * relative);
            boolean isRight = Double.isNaN(expected)
                    ? known == 0
                    : Math.abs(known - expected) <= limit;
            return isRight ? null : String.valueOf(expected);
        };
    }

    /**
     * Where ffprobe does not know it, Matroska's statistics tag or mpv's measurement is better.
     * That of AAC in broadcast formats is an estimate from the packets that were read so far, of
     * which there may be one more: 2 %.
     */
    private static Rule bitRate() {
        Rule close = number(stream -> stream.number("bit_rate"), 1, 0.02);
        return (ours, stream) ->
                stream.text("bit_rate").isEmpty() ? null : close.expected(ours, stream);
    }

    private static Rule mastering(String name) {
        return number(stream -> FfprobeStream.quotient(
                stream.sideData("Mastering display metadata", name)), 0.00005, 0);
    }

    private static Rule content(String name) {
        return number(stream -> {
            String value = stream.sideData("Content light level metadata", name);
            return value.isEmpty() ? Double.NaN : Double.parseDouble(value);
        }, 0, 0);
    }

    private double bitDepth(FfprobeStream stream) {
        JsonElement depth = bitDepths.get(stream.text("pix_fmt"));
        return depth == null ? Double.NaN : depth.getAsDouble();
    }

    private static double squareWidth(FfprobeStream stream) {
        double pixel = FfprobeStream.quotient(stream.text("sample_aspect_ratio"));
        return stream.number("width") * (pixel > 0 ? pixel : 1);
    }

    private static boolean isLying(FfprobeStream stream) {
        return stream.turning()[0] == 0;
    }

    private static boolean isMirrored(int[] turning) {
        return turning[0] * turning[3] - turning[1] * turning[2] < 0;
    }

    private static double rotation(int[] turning) {
        int across = isMirrored(turning) ? -turning[0] : turning[0];
        return (Math.toDegrees(Math.atan2(turning[1], across)) + 360) % 360;
    }

    private static String known(JsonElement value) {
        return value == null ? "" : value.getAsString();
    }
}
