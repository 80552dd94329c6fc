// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.nio.file.Path;
import java.util.HashMap;
import java.util.Map;
import java.util.Optional;
import java.util.regex.Pattern;

/** What the run is to do: {@code name=value} arguments, which tools/soak/soak.py has checked. */
final class Settings {
    private final Map<String, String> values = new HashMap<>();

    Settings(String[] arguments) {
        for (String argument : arguments) {
            int split = argument.indexOf('=');
            values.put(argument.substring(0, split), argument.substring(split + 1));
        }
    }

    long seed() {
        return Long.parseLong(values.get("seed"));
    }

    /** How long cycles are begun; without limit when cycles are counted. */
    double minutes() {
        return Double.parseDouble(values.getOrDefault("minutes", "Infinity"));
    }

    int cycles() {
        return Integer.parseInt(values.getOrDefault("cycles", "" + Integer.MAX_VALUE));
    }

    /** The number of the first cycle, so that one alone can be repeated. */
    int first() {
        return Integer.parseInt(values.get("first"));
    }

    int workers() {
        return Integer.parseInt(values.get("workers"));
    }

    /** Cycles from checkpoint to checkpoint. */
    int batch() {
        return Integer.parseInt(values.get("batch"));
    }

    /** Seconds after which an action hangs. */
    int limit() {
        return Integer.parseInt(values.get("limit"));
    }

    Plant plant() {
        return Plant.of(values.getOrDefault("plant", ""));
    }

    /** Which kinds of media are used. */
    Pattern only() {
        return Pattern.compile(values.getOrDefault("only", ""));
    }

    Path media() {
        return Path.of(values.get("media"));
    }

    Path folder() {
        return Path.of(values.get("folder"));
    }

    /** A file system that is small enough to be filled. */
    Optional<Path> smallDisk() {
        return Optional.ofNullable(values.get("disk")).map(Path::of);
    }

    /** Where a sound server listens that this program starts and ends. */
    Optional<Path> soundSocket() {
        return Optional.ofNullable(values.get("sound")).map(Path::of);
    }
}
