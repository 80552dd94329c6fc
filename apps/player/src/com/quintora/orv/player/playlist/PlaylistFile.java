// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import java.net.URI;
import java.net.URISyntaxException;
import java.nio.ByteBuffer;
import java.nio.charset.CharacterCodingException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Locale;
import java.util.Map;
import java.util.TreeMap;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/**
 * Reads playlists: M3U, a line an entry with titles in lines "#EXTINF:SECONDS,TITLE", and PLS, keys
 * "File1" and "Title1" of an INI file.
 */
final class PlaylistFile {
    private static final Pattern PLS_KEY =
            Pattern.compile("(File|Title)(\\d{1,9})\\s*=\\s*(.*)", Pattern.CASE_INSENSITIVE);

    // HTTP Live Streaming calls its lists of segments the same: those are media.
    private static final String SEGMENTS = "#EXT-X-";

    private PlaylistFile() {}

    /** By the name alone. */
    static boolean isNamedSo(String source) {
        String name = source.toLowerCase(Locale.ROOT);
        return name.endsWith(".m3u") || name.endsWith(".m3u8") || name.endsWith(".pls");
    }

    /** Whether it is media itself, in pieces. */
    static boolean isOfSegments(String text) {
        return text.lines().anyMatch(line -> line.startsWith(SEGMENTS));
    }

    /** UTF-8 where it is, otherwise ISO 8859-1, as lists of before are written. */
    static String textOf(byte[] bytes) {
        String text;
        try {
            text = StandardCharsets.UTF_8.newDecoder().decode(ByteBuffer.wrap(bytes)).toString();
        } catch (CharacterCodingException e) {
            text = new String(bytes, StandardCharsets.ISO_8859_1);
        }
        return text.startsWith("\uFEFF") ? text.substring(1) : text;
    }

    /** The entries of a list that lies in that folder, or at that URL. */
    static List<Entry> parse(String name, String text, String base) {
        return name.toLowerCase(Locale.ROOT).endsWith(".pls")
                ? parsePls(text, base)
                : parseM3u(text, base);
    }

    private static List<Entry> parseM3u(String text, String base) {
        List<Entry> entries = new ArrayList<>();
        String title = "";
        for (String line : text.lines().map(String::strip).toList()) {
            if (line.startsWith("#EXTINF:")) {
                title = line.substring(line.indexOf(',') + 1).strip();
                title = line.contains(",") ? title : "";
            } else if (!line.isEmpty() && !line.startsWith("#")) {
                entries.add(new Entry(resolve(base, line), title));
                title = "";
            }
        }
        return entries;
    }

    private static List<Entry> parsePls(String text, String base) {
        Map<Integer, String> files = new TreeMap<>();
        Map<Integer, String> titles = new TreeMap<>();
        for (String line : text.lines().map(String::strip).toList()) {
            Matcher key = PLS_KEY.matcher(line);
            if (key.matches() && !key.group(3).isEmpty()) {
                boolean isFile = key.group(1).equalsIgnoreCase("File");
                (isFile ? files : titles).put(Integer.parseInt(key.group(2)), key.group(3));
            }
        }
        return files.entrySet().stream()
                .map(file -> new Entry(
                        resolve(base, file.getValue()),
                        titles.getOrDefault(file.getKey(), "")))
                .toList();
    }

    private static String resolve(String base, String source) {
        if (source.startsWith("file:")) {
            return pathOf(source);
        }
        if (Entry.isUrl(source)) {
            return source;
        }
        return Entry.isUrl(base) ? resolveUrl(base, source) : resolvePath(base, source);
    }

    /** The path that a file's URL names; the URL itself when it names none. */
    static String pathOf(String url) {
        try {
            return Path.of(new URI(url)).toString();
        } catch (URISyntaxException | IllegalArgumentException e) {
            return url;
        }
    }

    private static String resolveUrl(String base, String source) {
        try {
            return new URI(base).resolve(new URI(null, null, source, null)).toString();
        } catch (URISyntaxException e) {
            return source;
        }
    }

    // Lists made on Windows separate folders by backslashes, which are letters elsewhere.
    private static String resolvePath(String base, String source) {
        try {
            Path path = Path.of(base).resolve(source);
            Path other = Path.of(base).resolve(source.replace('\\', '/'));
            return (Files.exists(path) || !Files.exists(other) ? path : other)
                    .normalize()
                    .toString();
        } catch (InvalidPathException e) {
            return source;
        }
    }
}
