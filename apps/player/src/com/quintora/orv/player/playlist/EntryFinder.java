// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import com.quintora.orv.player.Failure;
import java.io.IOException;
import java.io.InputStream;
import java.net.URI;
import java.net.URLConnection;
import java.nio.file.AccessDeniedException;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;

/** What a user names to be played: media, folders of them, and playlists. */
public final class EntryFinder {
    // A playlist beyond that is none.
    private static final int MOST_BYTES = 4 * 1024 * 1024;
    private static final int TIMEOUT_MS = 10_000;
    // Playlists may name playlists, and by mistake each other.
    private static final int MOST_NESTED = 4;

    private EntryFinder() {}

    /**
     * The media that those sources stand for, in their order. Blocks while folders and playlists
     * are read, also from a network. What does not exist is not looked for here, but when it plays.
     *
     * @throws Failure for a folder or a playlist that cannot be read or has nothing to play
     */
    public static List<Entry> find(List<String> sources) throws Failure {
        List<Entry> found = new ArrayList<>();
        for (String source : sources) {
            found.addAll(expand(new Entry(source), 0));
        }
        return found;
    }

    private static List<Entry> expand(Entry entry, int depth) throws Failure {
        String source = entry.source();
        try {
            if (source.startsWith("file:")) {
                return expand(new Entry(PlaylistFile.pathOf(source), entry.title()), depth);
            }
            if (isFolder(source)) {
                return require(
                        MediaFolder.list(Path.of(source)), "'" + source + "' has no media files");
            }
            return isPlaylist(source) ? expandPlaylist(entry, depth) : List.of(entry);
        } catch (IOException e) {
            throw new Failure("cannot read '" + source + "': " + reason(e), e);
        }
    }

    private static List<Entry> expandPlaylist(Entry list, int depth) throws Failure, IOException {
        String source = list.source();
        if (depth == MOST_NESTED) {
            throw new Failure("'" + source + "' is a playlist in a playlist, again and again");
        }
        String text = PlaylistFile.textOf(read(source));
        if (PlaylistFile.isOfSegments(text)) {
            return List.of(list);
        }
        List<Entry> entries = new ArrayList<>();
        for (Entry entry : PlaylistFile.parse(nameOf(source), text, baseOf(source))) {
            entries.addAll(expand(entry, depth + 1));
        }
        return require(entries, "the playlist '" + source + "' has no entries");
    }

    private static List<Entry> require(List<Entry> entries, String sentence) throws Failure {
        if (entries.isEmpty()) {
            throw new Failure(sentence);
        }
        return entries;
    }

    private static boolean isFolder(String source) {
        try {
            return !source.isEmpty() && !Entry.isUrl(source) && Files.isDirectory(Path.of(source));
        } catch (InvalidPathException e) {
            return false;
        }
    }

    // Addresses of such lists that end in m3u8 are always of segments.
    private static boolean isPlaylist(String source) throws IOException {
        if (Entry.isUrl(source)) {
            String name = nameOf(source);
            return source.startsWith("http") && PlaylistFile.isNamedSo(name)
                    && !name.endsWith(".m3u8");
        }
        try {
            return PlaylistFile.isNamedSo(source) && Files.isRegularFile(Path.of(source));
        } catch (InvalidPathException e) {
            return false;
        }
    }

    /** Without what follows an address's path. */
    private static String nameOf(String source) {
        return Entry.isUrl(source) ? source.replaceFirst("[?#].*", "") : source;
    }

    private static String baseOf(String source) {
        if (Entry.isUrl(source)) {
            return source;
        }
        Path folder = Path.of(source).getParent();
        return folder == null ? "" : folder.toString();
    }

    private static byte[] read(String source) throws IOException {
        try (InputStream in = open(source)) {
            byte[] bytes = in.readNBytes(MOST_BYTES + 1);
            if (bytes.length > MOST_BYTES) {
                throw new IOException("it is too large for a playlist");
            }
            return bytes;
        }
    }

    private static InputStream open(String source) throws IOException {
        if (!Entry.isUrl(source)) {
            return Files.newInputStream(Path.of(source));
        }
        try {
            URLConnection connection = URI.create(source).toURL().openConnection();
            connection.setConnectTimeout(TIMEOUT_MS);
            connection.setReadTimeout(TIMEOUT_MS);
            return connection.getInputStream();
        } catch (IllegalArgumentException e) {
            throw new IOException("it is not a valid address", e);
        }
    }

    private static String reason(IOException problem) {
        return problem instanceof AccessDeniedException
                ? "that is not allowed"
                : problem.getMessage();
    }
}
