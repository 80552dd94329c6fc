// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.failure;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import org.jetbrains.annotations.Nullable;

/** Turns what the native half throws into sentences that name the cause. */
public final class Failures {
    // How the native half ends a message: "Prepare failed.: status=0xFFFFFC14".
    private static final Pattern STATUS = Pattern.compile("status=0x([0-9A-F]{1,8})$");

    private static final String FILE_URL = "file://";

    // In the order of the engine's numbers.
    private static final List<String> FORMATS = List.of(
            "a file of a known format", "an MP4 file", "a Matroska file", "an AVI file",
            "an MPEG transport stream", "an MPEG program stream", "an FLV file", "an ASF file",
            "an Ogg file", "a WAV file", "a FLAC file", "an MP3 file", "an AAC file",
            "an AIFF file");

    private Failures() {}

    /**
     * The failure of a source.
     *
     * @param source a path, a URL or words for another source
     * @param root what the source itself threw, or null
     */
    public static MediaException explain(
            String source, Exception thrown, @Nullable Throwable root) {
        int status = status(thrown);
        if (root == null) {
            String name = source.isEmpty() ? "" : source + ": ";
            return new MediaException(name + sentence(source, status), status, thrown);
        }
        MediaException explained =
                new MediaException(source + ": the source failed: " + root, MediaError.IO, root);
        explained.addSuppressed(thrown);
        return explained;
    }

    /** The failure of media that were given up while they were being opened. */
    public static MediaException aborted(String source, @Nullable Throwable thrown) {
        return new MediaException(source + ": reset or released while it was being opened",
                MediaError.ABORTED, thrown);
    }

    /** The failure of a file of subtitles, for which the engine gives no reason. */
    public static MediaException subtitles(String source) {
        Path path = localPath(source);
        return path != null && Files.notExists(path)
                ? new MediaException(source + ": no such file", MediaError.NOT_FOUND, null)
                : new MediaException(
                        source + ": has no subtitles that can be read", MediaError.IO, null);
    }

    /** A refusal for want of permission. */
    public static SecurityException denied(String source, SecurityException thrown) {
        return new SecurityException(source + ": permission denied", thrown);
    }

    /** A refusal by the engine in its present state, for calls that have no other failure. */
    public static IllegalStateException refused(String call, Exception thrown) {
        String why = thrown.getMessage() == null ? "" : ": " + thrown.getMessage();
        return new IllegalStateException("the engine refused " + call + why, thrown);
    }

    static int status(Exception thrown) {
        if (thrown.getMessage() == null) {
            return MediaError.UNKNOWN.status();
        }
        Matcher matcher = STATUS.matcher(thrown.getMessage());
        return matcher.find()
                ? Integer.parseUnsignedInt(matcher.group(1), 16)
                : MediaError.UNKNOWN.status();
    }

    private static String sentence(String source, int status) {
        return switch (MediaError.of(status)) {
            case NOT_FOUND -> "no such file";
            case BAD_VALUE -> badValue(source);
            case IO -> unreadable(source);
            case MALFORMED -> "unknown format";
            case UNSUPPORTED -> "has no track that can be played";
            case EMPTY -> "is empty";
            case TIMED_OUT -> "was not ready in time";
            case NOTHING_INSIDE -> nothingInside(status);
            case UNKNOWN, ABORTED -> status == MediaError.UNKNOWN.status()
                    ? "the engine failed"
                    : "the engine failed with status " + status;
            default -> ServerFailures.sentence(source, status);
        };
    }

    private static String nothingInside(int status) {
        int format = MediaError.NOTHING_INSIDE.status() - status;
        return "is " + FORMATS.get(format < FORMATS.size() ? format : 0)
                + " in which nothing can be played: it is empty, cut short or damaged";
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

    public static boolean isUrl(String source) {
        return source.contains("://");
    }

    // The engine takes what follows file:// as it stands.
    private static @Nullable Path localPath(String source) {
        String path = source.startsWith(FILE_URL) ? source.substring(FILE_URL.length()) : source;
        try {
            return isUrl(path) ? null : Path.of(path);
        } catch (InvalidPathException e) {
            return null;
        }
    }
}
