// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import java.nio.file.InvalidPathException;
import java.nio.file.Path;

/**
 * One media of a playlist.
 *
 * @param source a path or a URL; "-" is standard input
 * @param title what the playlist calls it, or empty
 */
public record Entry(String source, String title) {
    public Entry(String source) {
        this(source, "");
    }

    /** The title, or else the file's name, or the whole URL. */
    public String name() {
        if (!title.isEmpty()) {
            return title;
        }
        if (source.equals("-")) {
            return "standard input";
        }
        return isUrl(source) ? source : fileName();
    }

    private String fileName() {
        try {
            return String.valueOf(Path.of(source).getFileName());
        } catch (InvalidPathException e) {
            return source;
        }
    }

    /** Whether that is an address, not a path. */
    public static boolean isUrl(String source) {
        return source.contains("://");
    }
}
