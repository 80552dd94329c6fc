// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;
import java.util.function.UnaryOperator;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** The user's folder for pictures, as the desktop's settings name it. */
final class PicturesFolder {
    private static final Pattern SETTING =
            Pattern.compile("\\s*XDG_PICTURES_DIR\\s*=\\s*\"(\\$HOME)?(/(?:[^\"\\\\]|\\\\.)*)\"\\s*");

    private PicturesFolder() {}

    /** Reads the settings; where they name no folder that is there, it is the user's own one. */
    static Path find() {
        return find(System::getenv, Path.of(System.getProperty("user.home")));
    }

    /** The same for other variables of the environment, and another folder of the user's own. */
    static Path find(UnaryOperator<String> environment, Path home) {
        String settings = environment.apply("XDG_CONFIG_HOME");
        Path folder =
                settings == null || settings.isEmpty() ? home.resolve(".config") : Path.of(settings);
        return named(folder.resolve("user-dirs.dirs"), home);
    }

    private static Path named(Path settings, Path home) {
        Path folder = home;
        for (String line : linesOf(settings)) {
            Matcher match = SETTING.matcher(line);
            if (match.matches()) {
                folder = existing(match.group(1) != null, unescaped(match.group(2)), home);
            }
        }
        return folder;
    }

    private static Path existing(boolean isBelowHome, String path, Path home) {
        try {
            Path folder = Path.of(isBelowHome ? home + path : path);
            return Files.isDirectory(folder) ? folder : home;
        } catch (InvalidPathException e) {
            return home;
        }
    }

    private static String unescaped(String path) {
        return path.replaceAll("\\\\(.)", "$1");
    }

    private static List<String> linesOf(Path file) {
        try {
            return Files.readAllLines(file, StandardCharsets.UTF_8);
        } catch (IOException e) {
            return List.of(); // Desktops without it are usual.
        }
    }
}
