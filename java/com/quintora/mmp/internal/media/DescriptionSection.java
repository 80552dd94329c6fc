// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import java.util.HashMap;
import java.util.Map;
import java.util.Optional;
import java.util.OptionalDouble;
import java.util.OptionalInt;
import java.util.OptionalLong;

/** The lines of one section of the engine's description. Values of a wrong form are unknown. */
final class DescriptionSection {
    private final Map<String, String> values = new HashMap<>();

    /** Adds "name=value"; other lines say nothing. */
    void addLine(String line) {
        int separator = line.indexOf('=');
        if (separator > 0) {
            values.put(line.substring(0, separator), unescaped(line.substring(separator + 1)));
        }
    }

    Optional<String> text(String name) {
        return Optional.ofNullable(values.get(name));
    }

    OptionalLong large(String name) {
        try {
            return OptionalLong.of(Long.parseLong(values.getOrDefault(name, "")));
        } catch (NumberFormatException e) {
            return OptionalLong.empty();
        }
    }

    OptionalInt number(String name) {
        OptionalLong number = large(name);
        boolean fits = number.isPresent() && number.getAsLong() == (int) number.getAsLong();
        return fits ? OptionalInt.of((int) number.getAsLong()) : OptionalInt.empty();
    }

    OptionalDouble real(String name) {
        try {
            return OptionalDouble.of(Double.parseDouble(values.getOrDefault(name, "")));
        } catch (NumberFormatException e) {
            return OptionalDouble.empty();
        }
    }

    /** Two numbers above 0 with a separator between them. */
    Optional<int[]> pair(String name, String separator) {
        String[] parts = values.getOrDefault(name, "").split(separator);
        try {
            int[] pair = {Integer.parseInt(parts[0]), Integer.parseInt(parts[parts.length - 1])};
            boolean isPair = parts.length == 2 && pair[0] > 0 && pair[1] > 0;
            return isPair ? Optional.of(pair) : Optional.empty();
        } catch (NumberFormatException e) {
            return Optional.empty();
        }
    }

    /** A fraction's value. */
    OptionalDouble quotient(String name) {
        return pair(name, "/")
                .map(pair -> OptionalDouble.of((double) pair[0] / pair[1]))
                .orElse(OptionalDouble.empty());
    }

    private static String unescaped(String value) {
        StringBuilder text = new StringBuilder();
        for (int i = 0; i < value.length(); i++) {
            char character = value.charAt(i);
            if (character != '\\' || i + 1 == value.length()) {
                text.append(character);
                continue;
            }
            i++;
            switch (value.charAt(i)) {
                case 'n' -> text.append('\n');
                case 'r' -> text.append('\r');
                default -> text.append(value.charAt(i));
            }
        }
        return text.toString();
    }
}
