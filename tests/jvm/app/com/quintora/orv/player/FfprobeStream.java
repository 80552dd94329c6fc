// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.google.gson.JsonElement;
import com.google.gson.JsonObject;
import java.util.stream.Stream;

/** An object of ffprobe's JSON: a stream, the format or a chapter. */
record FfprobeStream(JsonObject json) {
    /** Empty for what is missing or unknown. */
    String text(String name) {
        JsonElement value = json.get(name);
        String text = value == null ? "" : value.getAsString();
        return text.equals("unknown") || text.equals("N/A") ? "" : text;
    }

    /** NaN for what is missing. */
    double number(String name) {
        String text = text(name);
        return text.isEmpty() ? Double.NaN : Double.parseDouble(text);
    }

    /** A tag whatever its case; empty for none. */
    String tag(String name) {
        if (!json.has("tags")) {
            return "";
        }
        return json.getAsJsonObject("tags").entrySet().stream()
                .filter(tag -> tag.getKey().equalsIgnoreCase(name))
                .map(tag -> tag.getValue().getAsString())
                .findFirst()
                .orElse("");
    }

    boolean has(String disposition) {
        return json.getAsJsonObject("disposition").get(disposition).getAsInt() != 0;
    }

    /** A value of the side data of a type; empty for none. */
    String sideData(String type, String name) {
        if (!json.has("side_data_list")) {
            return "";
        }
        for (JsonElement data : json.getAsJsonArray("side_data_list")) {
            JsonObject one = data.getAsJsonObject();
            if (one.get("side_data_type").getAsString().startsWith(type) && one.has(name)) {
                return one.get(name).getAsString();
            }
        }
        return "";
    }

    /** a/b as a number; NaN for none. */
    static double quotient(String text) {
        String[] parts = text.split("[/:]");
        return parts.length == 2
                ? Double.parseDouble(parts[0]) / Double.parseDouble(parts[1])
                : Double.NaN;
    }

    /** The display matrix's a, b, c, d: (1, 0) is shown at (a, b), (0, 1) at (c, d). */
    int[] turning() {
        String matrix = sideData("Display Matrix", "displaymatrix");
        if (matrix.isEmpty()) {
            return new int[] {1, 0, 0, 1};
        }
        int[] numbers =
                matrix.lines()
                        .filter(line -> line.contains(":"))
                        .flatMap(line -> Stream.of(line.split(":")[1].trim().split(" +")))
                        .mapToInt(Integer::parseInt)
                        .map(Integer::signum)
                        .toArray();
        return new int[] {numbers[0], numbers[1], numbers[3], numbers[4]};
    }
}
