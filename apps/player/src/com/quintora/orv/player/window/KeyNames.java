// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.util.Arrays;
import java.util.Locale;
import java.util.Map;
import java.util.stream.Collectors;

/** Keys as they are written on a keyboard. */
final class KeyNames {
    private static final Map<String, String> SIGNS =
            Map.ofEntries(
                    Map.entry("OPEN_BRACKET", "["),
                    Map.entry("CLOSE_BRACKET", "]"),
                    Map.entry("COMMA", ","),
                    Map.entry("PERIOD", "."),
                    Map.entry("MINUS", "-"),
                    Map.entry("EQUALS", "="),
                    Map.entry("PLUS", "+"),
                    Map.entry("SLASH", "/"),
                    Map.entry("BACK_SLASH", "\\"),
                    Map.entry("SEMICOLON", ";"),
                    Map.entry("QUOTE", "'"),
                    Map.entry("control", "Ctrl"));

    private KeyNames() {}

    /** Of a name of KeyStroke's: "Shift+Page Up" of "shift PAGE_UP", "?" of "typed ?". */
    static String of(String keyStroke) {
        return Arrays.stream(keyStroke.split(" "))
                .filter(word -> !word.equals("typed"))
                .map(KeyNames::key)
                .collect(Collectors.joining("+"));
    }

    private static String key(String word) {
        String sign = SIGNS.get(word);
        return sign != null
                ? sign
                : Arrays.stream(word.split("_"))
                        .map(part -> part.substring(0, 1).toUpperCase(Locale.ROOT)
                                + part.substring(1).toLowerCase(Locale.ROOT))
                        .collect(Collectors.joining(" "));
    }
}
