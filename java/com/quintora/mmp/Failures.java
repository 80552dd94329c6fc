// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;
import java.util.Optional;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** Turns what the native half throws into sentences that name the cause. */
final class Failures {
    // How the native half ends a message: "Prepare failed.: status=0xFFFFFC14".
    private static final Pattern STATUS = Pattern.compile("status=0x([0-9A-F]{1,8})$");

    private static final String FILE_URL = "file://";

    // In the order of the engine's numbers.
    private static final List<String> FORMATS = List.of(
            "a file of a known format", "an MP4 file", "a Matroska file", "an AVI file",
            "an MPEG transport stream", "an MPEG program stream", "an FLV file", "an ASF file",
            "an Ogg file", "a WAV file", "a FLAC file", "an MP3 file", "an AAC file",
            "an AIFF file");
    private static final int MAX_FORMAT = 99;

    private Failures() {}

    /**
     * The failure of a source.
     *
     * @param source a path, a URL or words for another source
     * @param root what the source itself threw, or null
     */
    static MediaException explain(String source, Exception thrown, Throwable root) {
        int status = status(thrown);
        if (root == null) {
            String name = source.isEmpty() ? "" : source + ": ";
            return new MediaException(name + sentence(source, status), status, thrown);
        }
        MediaException told = new MediaException(
                source + ": the source failed: " + root, MediaException.STATUS_IO, root);
        told.addSuppressed(thrown);
        return told;
    }

    /** A refusal for want of permission. */
    static SecurityException denied(String source, SecurityException thrown) {
        return new SecurityException(source + ": permission denied", thrown);
    }

    /** A refusal by the engine in its present state, for calls that have no other failure. */
    static IllegalStateException refused(String call, Exception thrown) {
        String why = thrown.getMessage() == null ? "" : ": " + thrown.getMessage();
        return new IllegalStateException("the engine refused " + call + why, thrown);
    }

    static int status(Exception thrown) {
        if (thrown.getMessage() == null) {
            return MediaException.STATUS_UNKNOWN;
        }
        Matcher matcher = STATUS.matcher(thrown.getMessage());
        return matcher.find()
                ? Integer.parseUnsignedInt(matcher.group(1), 16)
                : MediaException.STATUS_UNKNOWN;
    }

    private static String sentence(String source, int status) {
        return switch (status) {
            case MediaException.STATUS_NOT_FOUND -> "no such file";
            case MediaException.STATUS_BAD_VALUE -> badValue(source);
            case MediaException.STATUS_IO -> unreadable(source);
            case MediaException.STATUS_MALFORMED -> "unknown format";
            case MediaException.STATUS_UNSUPPORTED -> "has no track that can be played";
            case MediaException.STATUS_EMPTY -> "is empty";
            case MediaException.STATUS_TIMED_OUT -> "was not ready in time";
            case MediaException.STATUS_UNKNOWN -> "the engine failed";
            default -> ServerFailures.sentence(source, status)
                    .or(() -> nothingInside(status))
                    .orElse("the engine failed with status " + status);
        };
    }

    private static Optional<String> nothingInside(int status) {
        int format = MediaException.STATUS_NOTHING_INSIDE - status;
        if (format < 0 || format > MAX_FORMAT) {
            return Optional.empty();
        }
        String name = format < FORMATS.size() ? FORMATS.get(format) : FORMATS.get(0);
        return Optional.of("is " + name
                + " in which nothing can be played: it is empty, cut short or damaged");
    }

    private static String badValue(String source) {
        Path path = localPath(source);
        if (source.isEmpty()) {
            return "the path is empty";
        }
        return path != null && Files.isDirectory(path)
                ? "is a directory"
                : "is not open, or a value is out of range";
    }

    private static String unreadable(String source) {
        Path path = localPath(source);
        return path != null && isUrl(source) && Files.notExists(path)
                ? "no such file"
                : "cannot be opened or read";
    }

    static boolean isUrl(String source) {
        return source.contains("://");
    }

    // The engine takes what follows file:// as it stands.
    private static Path localPath(String source) {
        String path = source.startsWith(FILE_URL) ? source.substring(FILE_URL.length()) : source;
        try {
            return isUrl(path) ? null : Path.of(path);
        } catch (InvalidPathException e) {
            return null;
        }
    }
}
