// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.google.gson.JsonElement;
import com.google.gson.JsonObject;
import java.util.LinkedHashMap;
import java.util.Map;
import java.util.Set;

/** The fields of an object of info --json, with those of inner objects as "outer.inner". */
final class InfoFields {
    private static final Set<String> INNER = Set.of("metadata", "color");

    private InfoFields() {}

    static Map<String, JsonElement> of(String prefix, JsonObject object) {
        Map<String, JsonElement> fields = new LinkedHashMap<>();
        object.entrySet().forEach(entry -> {
            if (entry.getValue().isJsonObject()) {
                String inner = prefix + entry.getKey() + ".";
                fields.putAll(of(inner, entry.getValue().getAsJsonObject()));
            } else {
                fields.put(prefix + entry.getKey(), entry.getValue());
            }
        });
        return fields;
    }

    /** Whether a field is one of the objects with that prefix; "" for the whole. */
    static boolean isIn(String prefix, String field) {
        if (!field.startsWith(prefix)) {
            return false;
        }
        String rest = field.substring(prefix.length());
        int dot = rest.indexOf('.');
        return dot < 0 || INNER.contains(rest.substring(0, dot));
    }
}
