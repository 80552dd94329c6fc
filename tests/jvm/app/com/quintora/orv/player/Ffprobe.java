// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.google.gson.JsonElement;
import com.google.gson.JsonObject;
import com.google.gson.JsonParser;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.List;

/** What ffprobe says of media. */
final class Ffprobe {
    private Ffprobe() {}

    /** Null for what ffprobe takes for no media. */
    static JsonObject describe(String path) throws IOException, InterruptedException {
        JsonObject all = run("-show_streams", "-show_format", "-show_chapters", path);
        return all != null && all.has("format") ? all : null;
    }

    /** The bits of each pixel format's first component, by its name. */
    static JsonObject bitDepths() throws IOException, InterruptedException {
        JsonObject depths = new JsonObject();
        for (JsonElement format : run("-show_pixel_formats").getAsJsonArray("pixel_formats")) {
            JsonObject one = format.getAsJsonObject();
            if (one.has("components") && !one.getAsJsonArray("components").isEmpty()) {
                JsonObject first = one.getAsJsonArray("components").get(0).getAsJsonObject();
                depths.add(one.get("name").getAsString(), first.get("bit_depth"));
            }
        }
        return depths;
    }

    private static JsonObject run(String... arguments) throws IOException, InterruptedException {
        List<String> command =
                new ArrayList<>(List.of("ffprobe", "-v", "quiet", "-print_format", "json"));
        command.addAll(List.of(arguments));
        Process process =
                new ProcessBuilder(command)
                        .redirectError(ProcessBuilder.Redirect.DISCARD)
                        .start();
        String text =
                new String(process.getInputStream().readAllBytes(), StandardCharsets.UTF_8);
        return process.waitFor() == 0 ? JsonParser.parseString(text).getAsJsonObject() : null;
    }
}
