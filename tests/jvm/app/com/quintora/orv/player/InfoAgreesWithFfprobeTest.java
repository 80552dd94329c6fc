// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.google.gson.JsonElement;
import com.google.gson.JsonObject;
import com.google.gson.JsonParser;
import com.quintora.mmp.Media;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.HashSet;
import java.util.List;
import java.util.Map;
import java.util.Set;
import org.junit.jupiter.api.Test;

/** info --json says what ffprobe says, of all media of the tests. */
class InfoAgreesWithFfprobeTest {
    private static final List<String> KINDS =
            List.of("video", "audio", "subtitles", "pictures", "attachments", "chapters");

    /** Without sound and picture, or without a format of their own: ffprobe reads more than mpv. */
    private static final Set<String> NOT_PLAYED =
            Set.of("lines.srt", "latin1.srt", "lines.ass", "words.idx", "words.sub",
                    "languages.idx", "languages.sub", "subtitles-only.mkv", "tone-s16le.pcm",
                    "tone-s16be.pcm");

    /** Fields that no media here has: no encoder of Debian's makes it. */
    private static final Set<String> UNSEEN = Set.of("video.color.dolbyVisionProfile");

    private final List<String> differences = new ArrayList<>();
    private final Set<String> seen = new HashSet<>();
    private InfoRules rules;

    @Test
    void onEveryFieldThatBothHave() throws Exception {
        rules = new InfoRules(Ffprobe.bitDepths());
        int compared = 0;
        for (String name : names()) {
            String path = Media.path(name);
            JsonObject theirs = Files.isRegularFile(Path.of(path)) ? Ffprobe.describe(path) : null;
            if (theirs != null && compare(name, path, theirs)) {
                compared++;
            }
        }
        assertEquals(List.of(), differences, String.join("\n", differences));
        assertTrue(compared > 60, compared + " files");
        // A rule that nothing is held to would be no rule. Pictures have those of video.
        Set<String> unused = new HashSet<>(rules.rules().keySet());
        unused.removeIf(field -> seen.contains(field) || field.startsWith("pictures."));
        unused.removeAll(UNSEEN);
        assertEquals(Set.of(), unused);
    }

    private static List<String> names() throws Exception {
        Process process =
                new ProcessBuilder(System.getProperty("orv.test.make-media"), "--list")
                        .redirectError(ProcessBuilder.Redirect.INHERIT)
                        .start();
        byte[] list = process.getInputStream().readAllBytes();
        assertEquals(0, process.waitFor());
        return new String(list, StandardCharsets.UTF_8).lines().toList();
    }

    private boolean compare(String name, String path, JsonObject theirs) {
        Cli info = Cli.run("info", "--json", path);
        if (NOT_PLAYED.contains(name)) {
            assertEquals(1, info.status(), name);
            return false;
        }
        if (info.status() != 0) {
            differences.add(name + ": " + info.err());
            return false;
        }
        JsonObject ours = JsonParser.parseString(info.out()).getAsJsonObject();
        for (String kind : KINDS) {
            compareAll(name, kind, ours, theirs);
            ours.remove(kind);
        }
        compareFields(name, "", ours, new FfprobeStream(format(theirs)));
        return true;
    }

    /** Ogg has the tags of the whole in its stream. */
    private static JsonObject format(JsonObject theirs) {
        JsonObject format = theirs.getAsJsonObject("format");
        JsonObject first = theirs.getAsJsonArray("streams").get(0).getAsJsonObject();
        if (!format.has("tags") && first.has("tags")) {
            format.add("tags", first.get("tags"));
        }
        return format;
    }

    private void compareAll(String name, String kind, JsonObject ours, JsonObject theirs) {
        List<FfprobeStream> expected = of(kind, theirs);
        var found = ours.getAsJsonArray(kind);
        assertNotNull(found, kind);
        if (found.size() != expected.size()) {
            differences.add(name + ": " + found.size() + " " + kind + ", not " + expected.size());
            return;
        }
        for (int i = 0; i < found.size(); i++) {
            String where = name + " " + i;
            compareFields(where, kind + ".", found.get(i).getAsJsonObject(), expected.get(i));
        }
    }

    private static List<FfprobeStream> of(String kind, JsonObject theirs) {
        List<FfprobeStream> all = new ArrayList<>();
        String list = kind.equals("chapters") ? "chapters" : "streams";
        for (JsonElement element : theirs.getAsJsonArray(list)) {
            FfprobeStream stream = new FfprobeStream(element.getAsJsonObject());
            if (kind.equals("chapters") || kindOf(stream).equals(kind)) {
                all.add(stream);
            }
        }
        return all;
    }

    private static String kindOf(FfprobeStream stream) {
        return switch (stream.text("codec_type")) {
            case "video" -> stream.has("attached_pic") ? "pictures" : "video";
            case "audio" -> "audio";
            case "subtitle" -> "subtitles";
            case "attachment" -> "attachments";
            default -> "";
        };
    }

    /** Those that we have, and those that only ffprobe has. */
    private void compareFields(
            String where, String prefix, JsonObject ours, FfprobeStream theirs) {
        Map<String, JsonElement> fields = InfoFields.of(prefix, ours);
        for (String field : fields.keySet()) {
            if (!rules.rules().containsKey(field)) {
                differences.add(where + ": no rule for " + field);
            }
        }
        rules.rules().forEach((field, rule) -> {
            if (!InfoFields.isIn(prefix, field)) {
                return;
            }
            JsonElement value = fields.get(field);
            String expected = rule.expected(value, theirs);
            if (expected != null) {
                differences.add(where + ": " + field + " is " + value + ", not " + expected);
            }
            if (value != null) {
                seen.add(field);
            }
        });
    }
}
